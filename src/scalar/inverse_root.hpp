// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/ops.hpp"

#if defined(__AVX512F__)
#include <immintrin.h>
#endif

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// 1/s, the bits of the division, for the rounded root s of a normal y: what a loop computes while
/// the divider takes the next root. Finite for y = 0.
///
/// The bits of y give r with e = 1 - rs below 0.036, before the root is there. The series of
/// 1/(1 - e) to e⁴ leaves less than an ulp, and a last step gives the nearest float. The fraction
/// of all ones, whose reciprocal is just above the middle between two floats, needs an excess
/// before that step: the addend 2e-6, or any from 1.5e-6 to 3e-6.
LUMEN_MAIN float inverse_of_root(float y, float s) {
  const float r = value(0x5f376000u - (bits(y) >> 1));
  const float e = fma(-s, r, 1.0f);
  const float q = fma(e, e, e);
  const float close = fma(r, fma(q, fma(e, e, 2e-6f), q), r);
  return fma(close, fma(-s, close, 1.0f), close);
}

/// 1/√y for a normal y, both operations rounded.
LUMEN_MAIN float inverse_root(float y) {
  const float root = sqrt(y);
  if constexpr (wide_vectors)
    return inverse_of_root(y, root);
  else
    return divide(1.0f, root);
}

/// The root of x, rounded, from an estimate of 1/√x within 2^-14 of itself. One step of Newton's
/// method for the root and the inverse leaves 2^-27 of each and the rounding; the rest to x is then
/// exact, from x = 2^-102 on, and the last step rounds as the root does: shown for every fraction
/// and estimates across their range.
LUMEN_MAIN float root_by_estimate(float x, float estimate) {
  const float s = x * estimate;
  const float h = 0.5f * estimate;
  const float e = fma(-h, s, 0.5f);
  const float root = fma(s, e, s);
  const float half_inverse = fma(h, e, h);
  return fma(fma(-root, root, x), half_inverse, root);
}

/// Estimates of 1/√x within 2^-14 of themselves, for whole blocks; of numbers that are not positive
/// and normal they mean nothing.
template <std::int64_t Length>
inline void estimate_inverse_roots(const float* x, float* estimate) {
#if defined(__AVX512F__)
  for (std::int64_t i = 0; i < Length; i += 16)
    _mm512_storeu_ps(estimate + i, _mm512_rsqrt14_ps(_mm512_loadu_ps(x + i)));
#else
  for (std::int64_t i = 0; i < Length; ++i) estimate[i] = inverse_root(x[i]);
#endif
}

/// √y and 1/√y for y = 0, where the inverse is finite, or y from 2^-99.
struct root_and_inverse {
  float root;
  float inverse;

  LUMEN_MAIN root_and_inverse by_division(float y) {
    const float root = sqrt(y + value(0x01800000u));  // 2^-124, lost beside any other y
    return {root, divide(1.0f, root)};
  }

  LUMEN_MAIN root_and_inverse by_steps(float y) {
    const float root = sqrt(y);
    return {root, inverse_of_root(y, root)};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
