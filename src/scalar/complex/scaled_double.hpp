// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <bit>
#include <cstdint>

#include "scalar/complex/double_double.hpp"
#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// 2^exponent, for the exponents of normal numbers.
LUMEN_DEVICE inline double power_of_two(int exponent) {
  return value(static_cast<std::uint64_t>(exponent + format<double>::bias)
               << format<double>::fraction_bits);
}

/// A finite double as significand·2^exponent, 1 <= |significand| < 2, denormals included. A zero
/// has an exponent so low that its product with any number counts as the smaller one.
struct scaled_double {
  double significand;
  int exponent;

  static constexpr int exponent_of_zero = -10000;

  LUMEN_DEVICE static scaled_double of(double x) {
    const std::uint64_t ax = bits(fabs(x));
    if (ax == 0) return {x, exponent_of_zero};
    const int leading = std::countl_zero(ax);
    const int shift = leading > 11 ? leading - 11 : 0;
    const int field = shift > 0 ? 1 - shift : static_cast<int>(ax >> format<double>::fraction_bits);
    const std::uint64_t fraction = (ax << shift) & format<double>::fraction;
    return {value(sign_bit(x) | format<double>::one | fraction), field - format<double>::bias};
  }
};

/// (x.high + x.low)·2^exponent with one rounding, denormal results included. The low part is at
/// most half a unit in the last place of the high part, which is not denormal.
LUMEN_DEVICE inline double scaled_back(double_double x, int exponent) {
  constexpr int fraction_bits = format<double>::fraction_bits;
  const std::uint64_t pattern = bits(fabs(x.high));
  if (pattern == 0) return x.high;
  const int field = static_cast<int>(pattern >> fraction_bits) + exponent;
  if (field > 2 * format<double>::bias) {
    return value(sign_bit(x.high) | format<double>::special);
  }
  if (field >= 1) {
    return value(sign_bit(x.high) | (pattern & format<double>::fraction) |
                 (static_cast<std::uint64_t>(field) << fraction_bits));
  }
  // A denormal: the significand loses its last `dropped` bits. The low part matters only where
  // these are exactly halfway, so that its sign, two bits further down, stands for it.
  const int dropped = 1 - field;
  if (dropped > fraction_bits + 1) return value(sign_bit(x.high));
  const std::uint64_t significand =
      (pattern & format<double>::fraction) | (std::uint64_t{1} << fraction_bits);
  const bool away = x.low != 0 && sign_bit(x.low) == sign_bit(x.high);
  const bool towards = x.low != 0 && !away;
  const std::uint64_t extended = 4 * significand + away - towards;
  const int shift = dropped + 2;
  const std::uint64_t half = std::uint64_t{1} << (shift - 1);
  const std::uint64_t rest = extended & (2 * half - 1);
  std::uint64_t rounded = extended >> shift;
  if (rest > half || (rest == half && (rounded & 1) != 0)) ++rounded;
  return value(sign_bit(x.high) | rounded);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
