// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The two reductions of the logarithms' main paths: to [2/3, 4/3) without a table, and by an
/// integer reciprocal that leads to a row of a table.
#pragma once

#include <cstdint>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// An integer below 2^52 as a double, without a conversion from 64 bits where there is none of
/// whole vectors.
LUMEN_MAIN double small_integer(std::uint64_t n) {
  if constexpr (wide_vectors) return static_cast<double>(static_cast<std::int64_t>(n));
  return value(n | 0x4330000000000000u) - value(0x4330000000000000u);  // 2^52
}

/// Not in the closed range between two numbers given as patterns, or a NaN; without a branch.
template <typename T>
LUMEN_MAIN bool is_outside(T x, uint_of<T> lowest, uint_of<T> highest) {
  const bool below = !(x >= value(lowest));
  const bool above = !(x <= value(highest));
  return below | above;
}

/// Not a positive normal number.
LUMEN_MAIN bool not_positive_normal(float x) {
  return static_cast<std::int32_t>(bits(x) + 0x00800000u) < 0x01000000;
}
LUMEN_MAIN bool not_positive_normal(double x) {
  return static_cast<std::int64_t>(bits(x) + 0x0010000000000000u) < 0x0020000000000000;
}

/// x = 2^k·(1 + r) with 1 + r in [2/3, 4/3); r is exact.
template <typename T>
struct two_thirds;

/// For positive normal numbers.
template <>
struct two_thirds<float> {
  std::uint32_t exponent;  ///< k in the place of the exponent field
  float k;
  float r;

  LUMEN_MAIN two_thirds of(float x) {
    const std::uint32_t i = bits(x) + 0xc0d55555u;
    const float m = value((i & 0x007fffffu) + 0x3f2aaaabu);
    const auto k = static_cast<float>(static_cast<std::int32_t>(i) >> 23);
    return {i & 0xff800000u, k, m - 1.0f};
  }
};

/// For positive finite numbers, denormals included.
template <>
struct two_thirds<double> {
  double k;
  double m;  ///< 1 + r
  double r;

  LUMEN_MAIN two_thirds of(double x) {
    const bool denormal = bits(x) < 0x0010000000000000u;
    const double scaled = select(denormal, x * value(0x43b0000000000000u), x);  // 2^60
    const std::uint64_t e = bits(scaled) + 0x000aaaaaaaaaaaaau;
    const double bias = select(denormal, 1083.0, 1023.0);
    const double m = value(bits(scaled) + format<double>::one - (e & 0xfff0000000000000u));
    return {small_integer(e >> 52) - bias, m, m - 1.0};
  }
};

/// The mantissa of a double at the exponent of `scale`, a power of two.
LUMEN_MAIN double mantissa_at(std::uint64_t scale, double x) {
  return value((bits(x) & format<double>::fraction) | scale);
}

/// 1/x as quickly as it can be had, as a float: a body that rounds it to an integer is exact for
/// the integer that comes out, whatever it is.
LUMEN_MAIN float quick_reciprocal(double x) { return divide(1.0f, static_cast<float>(x)); }

/// `x` to the nearest integer, |x| < 2^51.
LUMEN_MAIN double rounded_by_shifter(double x) {
  const double shifter = value(0x4338000000000000u);  // 3·2^51
  return (x + shifter) - shifter;
}

/// A positive normal number as 2^(exponent - 1023)·m, m in [1, 2), and R, an integer of 512..1024
/// close to 1024/m, with t = mR/1024 - 1. The rows of a table cover ln m: -log(R/512) up to R = 724
/// and, with one more 2 in the exponent, -log(R/1024) above.
struct integer_reciprocal {
  double exponent;  ///< biased
  double integer;   ///< R
  double t;

  LUMEN_MAIN integer_reciprocal of(double x) {
    const double m = mantissa_at(0x3f50000000000000u, x);  // 2^-10
    const double integer = rounded_by_shifter(static_cast<double>(quick_reciprocal(m)));
    return {small_integer(bits(x) >> 52), integer, fma(m, integer, -1.0)};
  }

  /// The exponent of two that goes with a row of single values.
  LUMEN_MAIN double exponent_of_row(const integer_reciprocal& a) {
    return a.exponent - select(a.integer > 724.0, 1023.0, 1022.0);
  }
  /// The word of a single value: R - 512.
  LUMEN_MAIN std::int32_t single_word(const integer_reciprocal& a) {
    return static_cast<std::int32_t>((bits(a.integer) >> 43) - 0x81000u);
  }
  /// The first word of a pair: 2(R - 512).
  LUMEN_MAIN std::int32_t pair_word(const integer_reciprocal& a) {
    return static_cast<std::int32_t>((bits(a.integer) >> 42) - 0x102000u);
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
