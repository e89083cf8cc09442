// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/atrig/half_angle.hpp"
#include "scalar/complex/double_double.hpp"
#include "scalar/complex/scaled_double.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/datan2.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The units of an angle: the rows of arctan(j/64), the angle of a half turn, and what the unit's
/// multiple of an arctangent is, in two words.
struct radians {
  LUMEN_DEVICE static const std::uint64_t* rows() { return __datan2_la_CoutTab; }
  LUMEN_DEVICE static double_double half_turn() {
    return {value(pi_words<double>::whole), value(pi_words<double>::whole_low)};
  }
  LUMEN_DEVICE static double_double of_radians(double_double x) { return x; }
};
struct half_turns {
  LUMEN_DEVICE static const std::uint64_t* rows() { return __datan2pi_la_CoutTab; }
  LUMEN_DEVICE static double_double half_turn() { return {1.0, 0.0}; }
  LUMEN_DEVICE static double_double of_radians(double_double x) {
    const double inverse = value(pi_words<double>::inverse);
    const double_double p = two_product(x.high, inverse);
    const double low = fma(x.high, value(pi_words<double>::inverse_low), x.low * inverse);
    return fast_two_sum(p.high, p.low + low);
  }
};

/// The angle of the point (x, y) in `Unit`, for operands of any size: within 0.501 ulp, denormal
/// results too. A NaN for a NaN; zeros and infinities by their signs, as the limits are.
///
/// The smaller magnitude n and the larger m lose their exponents, j is n/m rounded to 1/64, and
/// the angle is the row's plus arctan((n - cm)/(m + cn)) with c = j/64, all in two words. Where n/m
/// is so small that the first term of the series is the angle, it is scaled back with one rounding.
template <typename Unit>
LUMEN_DEVICE inline double careful_angle(double y, double x) {
  if (is_nan(x) || is_nan(y)) return x + y;
  const double ax = fabs(x), ay = fabs(y);
  const bool negative = sign_bit(x) != 0;
  const bool steep = ax < ay;
  const double_double half_turn = Unit::half_turn();
  // The angle of (|x|, |y|)'s octant is base + or - arctan(n/m).
  const double quarters = steep ? 0.5 : (negative ? 1.0 : 0.0);
  const double_double base{quarters * half_turn.high, quarters * half_turn.low};
  const double sign = steep != negative ? -1.0 : 1.0;
  if (is_infinite(x) && is_infinite(y)) {
    return or_sign((negative ? 0.75 : 0.25) * half_turn.high, y);
  }
  if (is_infinite(x) || is_infinite(y) || ax == 0 || ay == 0) {
    return or_sign(base.high, y);
  }
  const scaled_double larger = scaled_double::of(steep ? ay : ax);
  const scaled_double smaller = scaled_double::of(steep ? ax : ay);
  const int exponent = smaller.exponent - larger.exponent;
  const double m = larger.significand;
  constexpr int series_from = -60;  // the next term is below 2^-119 relative
  constexpr int lost_from = -120;   // beside a base
  if (exponent < (quarters == 0 ? series_from : lost_from)) {
    if (quarters != 0) return or_sign(base.high, y);
    const double q = divide(smaller.significand, m);
    const double q_low = divide(fma(-q, m, smaller.significand), m);
    return or_sign(scaled_back(Unit::of_radians({q, q_low}), exponent), y);
  }
  const double n = smaller.significand * power_of_two(exponent);
  const double index = rint(64.0 * divide(n, m));
  const double c = index * 0.015625;
  const double_double cm = two_product(c, m), cn = two_product(c, n);
  const double_double above = two_sum(n, -cm.high), below = two_sum(m, cn.high);
  const double above_low = above.low - cm.low, below_low = below.low + cn.low;
  const double t = divide(above.high, below.high);
  const double rest = fma(-t, below_low, fma(-t, below.high, above.high) + above_low);
  const double z = t * t;
  const double series = horner(z, 0xbfb745d1745d1746u, 0x3fbc71c71c71c71cu, 0xbfc2492492492492u,
                               0x3fc999999999999au, 0xbfd5555555555555u);
  const double_double small =
      Unit::of_radians(fast_two_sum(t, fma(series * z, t, divide(rest, below.high))));
  const std::uint64_t* row = Unit::rows() + 2 * static_cast<std::int32_t>(index);
  const double_double first = two_sum(base.high, sign * value(row[0]));
  const double_double second = two_sum(first.high, sign * small.high);
  const double low = (first.low + second.low) + (base.low + sign * (value(row[1]) + small.low));
  return or_sign(second.high + low, y);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
