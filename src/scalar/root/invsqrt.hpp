// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/horner.hpp"
#include "scalar/inverse_root.hpp"
#include "scalar/protocol.hpp"
#include "scalar/root/careful_inverse_root.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// invsqrt, float. Code 2 for zeros, code 1 for negative numbers and -infinity, code 0 for every
/// NaN. Denormals, which the main path does not serve, are within 0.51 ulp.
///
/// `la` and `ep`: one step of Newton's method from the reciprocal of the root; within 1.54 ulp.
/// `ha`: the same start cut to 9 bits, so that its square is exact, and degree 3 in what that
/// leaves; within 0.52 ulp.
template <tier t>
struct invsqrt_s : scalar_v11<invsqrt_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float c = inverse_root(x);
    return {refined(x, c), flag_if<float>(not_positive_normal(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) { return invsqrt_of_any(x, y); }

 private:
  LUMEN_MAIN float refined(float x, float c) {
    if constexpr (t == tier::ha) {
      const float start = value(bits(c) & 0xffff8000u);
      const float w = fma(start, start, 0.0f);
      const float e = fma(w, x, -1.0f);
      float p = horner(e, 0xbea00000u, 0x3ec00000u, 0xbf000000u);
      p = fma(p, e, 0.0f);
      return fma(p, start, start);
    } else {
      const float a = fma(c, x, 0.0f);
      const float d = fma(a, c, -3.0f);
      const float h = fma(c, -0.5f, 0.0f);
      return fma(h, d, 0.0f);
    }
  }

  LUMEN_MAIN bool not_positive_normal(float x) {
    return static_cast<std::int32_t>(bits(x) + 0x7f800000u) > -0x01000001;
  }
};

/// invsqrt, double; codes as at float. Within 0.51, 1.50, 507 ulp for `ha`, `la`, `ep`.
///
/// A float reciprocal root y of the leading bits leaves e = 1 - xy² below 2^-22; the series of
/// (1 - e)^(-1/2) has degree 4 at `la` and `ha`, 2 at `ep`. `ha` adds the leading 1 of the series
/// in the last step, and its main path begins at 2^-970 instead of 2^-1020.
template <tier t>
struct invsqrt_d : scalar_v11<invsqrt_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const std::uint64_t b = bits(x);
    const std::uint64_t unit = 0x0010000000000000u;
    const std::uint64_t parity = (b & unit) ^ unit;
    // x by a power of four as a float in [1, 4), cut.
    const std::uint64_t leading = (parity + 0x07f0000000000000u) | (b & 0x001fffffe0000000u);
    const float m = value(static_cast<std::uint32_t>(leading >> 29));
    const auto c = static_cast<double>(divide(1.0f, sqrt(m)));
    const std::uint64_t scale = (parity + 0xbfd0000000000000u - (b & format<double>::special)) >> 1;
    const double y = fma(c, value(scale), 0.0);
    const double w = fma(y, y, 0.0);
    const double e = fma(-w, x, 1.0);
    return {refined(e, y), flag_if<double>(is_extreme(b))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) { return invsqrt_of_any(x, y); }

 private:
  LUMEN_MAIN double refined(double e, double y) {
    if constexpr (t == tier::ep) {
      const double p = horner(e, 0x3fd80000c4cd9197u, 0x3fe000004379adb7u, 0x3fefffffffffff4fu);
      return fma(p, y, 0.0);
    } else {
      const double p = horner(e, 0x3fd1800032338cbbu, 0x3fd40000b13001d9u, 0x3fd80000000000f6u,
                              0x3fdffffffffffe71u);
      if constexpr (t == tier::ha) return fma(e * p, y, y);
      return fma(fma(e, p, 1.0), y, 0.0);
    }
  }

  /// Not a number from 2^-1020, at `ha` from 2^-970, to below 2^1022.
  LUMEN_MAIN bool is_extreme(std::uint64_t b) {
    const std::uint64_t shift = t == tier::ha ? 0x7cb0000000000000u : 0x7fd0000000000000u;
    const std::int64_t last = t == tier::ha ? -0x0380000000000001 : -0x0060000000000001;
    return static_cast<std::int64_t>(b + shift) > last;
  }
};

/// invsqrt, half: the float body of `ep` in every tier.
using invsqrt_h = half_v11<invsqrt_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
