// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Conversion of arrays between half and float on a processor: its own instructions where it has
/// them, eight elements at a time, with the results of `widen` and `narrow`.
#pragma once

#include <cstdint>

#if defined(__F16C__) && !defined(__SYCL_DEVICE_ONLY__) && !defined(__CUDA_ARCH__)
#include <immintrin.h>
#define LUMEN_HALF_INSTRUCTIONS
#endif

#include "scalar/half.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

template <half_element Element>
inline void widen_block(const Element* from, float* to, std::int64_t n) {
  std::int64_t i = 0;
#ifdef LUMEN_HALF_INSTRUCTIONS
  const __m128i special = _mm_set1_epi16(0x7c00);
  for (; n - i >= 8; i += 8) {
    const __m128i x = _mm_loadu_si128(reinterpret_cast<const __m128i*>(from + i));
    // The instruction quietens signalling NaNs, so specials go another way.
    if (_mm_movemask_epi8(_mm_cmpeq_epi16(_mm_and_si128(x, special), special)) != 0) [[unlikely]] {
      for (std::int64_t k = i; k < i + 8; ++k) to[k] = load_half(from + k);
    } else {
      _mm256_storeu_ps(to + i, _mm256_cvtph_ps(x));
    }
  }
#endif
  for (; i < n; ++i) to[i] = load_half(from + i);
}

template <half_element Element>
inline void narrow_block(const float* from, Element* to, std::int64_t n) {
  std::int64_t i = 0;
#ifdef LUMEN_HALF_INSTRUCTIONS
  for (; n - i >= 8; i += 8) {
    const __m128i y = _mm256_cvtps_ph(_mm256_loadu_ps(from + i), _MM_FROUND_TO_NEAREST_INT);
    _mm_storeu_si128(reinterpret_cast<__m128i*>(to + i), y);
  }
#endif
  for (; i < n; ++i) store_half(to + i, from[i]);
}

#undef LUMEN_HALF_INSTRUCTIONS

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
