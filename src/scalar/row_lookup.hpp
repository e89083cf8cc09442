// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/ops.hpp"

#if defined(__AVX512F__)
#include <immintrin.h>
#endif

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The two columns of a table of 128 rows.
struct float_columns {
  alignas(64) float first[128];
  alignas(64) float second[128];
};

/// Rows for a block of row numbers, of which the lowest seven bits count. Vectors of 512 bits hold
/// the columns and are permuted, in a third of the steps that two gathers take. log1p at float: 36
/// cycles a vector instead of 47 on a core that also runs another thread, 32 instead of 31 alone.
template <const float_columns& table>
class row_lookup {
 public:
  template <std::int64_t Length>
  [[gnu::always_inline]] static inline void rows(const std::uint32_t* number, float* first,
                                                 float* second) {
#if defined(__AVX512F__)
    for (std::int64_t i = 0; i < Length; i += 16) {
      const __m512i n = _mm512_loadu_si512(number + i);
      _mm512_storeu_ps(first + i, permuted(table.first, n));
      _mm512_storeu_ps(second + i, permuted(table.second, n));
    }
#else
    for (std::int64_t i = 0; i < Length; ++i) {
      first[i] = table.first[number[i] & 0x7f];
      second[i] = table.second[number[i] & 0x7f];
    }
#endif
  }

#if defined(__AVX512F__)
 private:
  [[gnu::always_inline]] static inline __m512 permuted(const float* column, __m512i number) {
    const __mmask16 odd = _mm512_test_epi32_mask(number, _mm512_set1_epi32(1 << 5));
    const __mmask16 upper = _mm512_test_epi32_mask(number, _mm512_set1_epi32(1 << 6));
    return _mm512_mask_blend_ps(
        upper, _mm512_mask_blend_ps(odd, quarter(column, number), quarter(column + 32, number)),
        _mm512_mask_blend_ps(odd, quarter(column + 64, number), quarter(column + 96, number)));
  }

  /// Of 32 rows, by the lowest five bits.
  [[gnu::always_inline]] static inline __m512 quarter(const float* column, __m512i number) {
    return _mm512_permutex2var_ps(_mm512_load_ps(column), number, _mm512_load_ps(column + 16));
  }
#endif
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
