// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Where the remainder of x by y can be had from a rounded quotient.
///
/// The divisor must be large enough that the last bit of a remainder is normal and, since an
/// exponent field of all ones may not pass as that of x, small enough that the largest distance
/// allowed above it stays finite. The distance of the exponents keeps the quotient below 2^26 at
/// double and 2^23 at float: there its rounding error is at most a quarter, so that an integer
/// taken from it is wrong by at most one, and a quotient halfway between two integers is exact.
template <typename T>
struct quotient_range;
template <>
struct quotient_range<float> {
  static constexpr std::uint32_t smallest_divisor = 0x0c000000;  // 2^-103
  static constexpr std::uint32_t largest_divisor = 0x747fffff;   // below 2^106
  static constexpr int distance = 22;
};
template <>
struct quotient_range<double> {
  static constexpr std::uint64_t smallest_divisor = 0x0330000000000000;  // 2^-972
  static constexpr std::uint64_t largest_divisor = 0x7e4fffffffffffff;   // below 2^998
  static constexpr int distance = 25;
};

/// The flag of the rare path. Not set: x is finite, and the quotient serves.
template <typename T>
LUMEN_DEVICE inline typename rare_flag<T>::type needs_long_division(T x, T y) {
  using range = quotient_range<T>;
  using sint = int_of<T>;
  constexpr auto shift = format<T>::sign - range::smallest_divisor;
  const auto ax = bits(fabs(x));
  const auto ay = bits(fabs(y));
  const bool divisor_out_of_range =
      static_cast<sint>(ay + shift) > static_cast<sint>(range::largest_divisor + shift);
  const sint ex = static_cast<sint>(ax >> format<T>::fraction_bits);
  const sint ey = static_cast<sint>(ay >> format<T>::fraction_bits);
  return flag_if<T>(divisor_out_of_range, ex - ey > range::distance);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
