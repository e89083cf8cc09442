// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <bit>
#include <cstdint>

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// A finite non-zero magnitude as an integer: significand·2^(exponent - bias - fraction_bits), the
/// leading bit of the significand at the place of the implicit one, also of a denormal.
template <typename T>
struct unpacked {
  uint_of<T> significand;
  int exponent;

  LUMEN_DEVICE static unpacked of(uint_of<T> magnitude) {
    const int field = static_cast<int>(magnitude >> format<T>::fraction_bits);
    const uint_of<T> fraction = magnitude & format<T>::fraction;
    if (field != 0) return {fraction | implicit_bit, field};
    return normalized(fraction, 1);
  }

  /// The same number with the leading bit of its significand in place.
  LUMEN_DEVICE static unpacked normalized(uint_of<T> significand, int exponent) {
    const int shift = std::countl_zero(significand) - std::countl_zero(implicit_bit);
    return {significand << shift, exponent - shift};
  }

  /// The magnitude pattern; the number must be representable.
  LUMEN_DEVICE uint_of<T> pack() const {
    if (exponent < 1) return significand >> (1 - exponent);
    return (static_cast<uint_of<T>>(exponent) << format<T>::fraction_bits) |
           (significand & format<T>::fraction);
  }

  static constexpr uint_of<T> implicit_bit = format<T>::fraction + 1;
};

/// |x| = quotient·|y| + remainder, 0 <= remainder < |y|.
template <typename T>
struct division {
  T remainder;
  bool odd;  ///< the parity of the quotient; unspecified where the remainder is zero
};

/// Exact division of finite magnitudes |x| > |y| > 0, given as patterns, for any distance of their
/// exponents: the significands are divided as integers. A step shifts in as many bits of the
/// dividend as 64 bits hold above a significand: 40 at float, 11 at double, so at most 7 or 191
/// steps.
template <typename T>
LUMEN_DEVICE inline division<T> long_division(uint_of<T> ax, uint_of<T> ay) {
  constexpr int step_bits = 64 - (format<T>::fraction_bits + 1);
  const unpacked<T> x = unpacked<T>::of(ax);
  const unpacked<T> y = unpacked<T>::of(ay);
  const std::uint64_t divisor = y.significand;
  std::uint64_t rest = x.significand;
  bool odd = rest >= divisor;
  if (odd) rest -= divisor;
  for (int left = x.exponent - y.exponent; left > 0 && rest != 0; left -= step_bits) {
    const std::uint64_t dividend = rest << (left < step_bits ? left : step_bits);
    const std::uint64_t quotient = dividend / divisor;
    odd = (quotient & 1) != 0;
    rest = dividend - quotient * divisor;
  }
  if (rest == 0) return {T(0), odd};
  const auto r = unpacked<T>::normalized(static_cast<uint_of<T>>(rest), y.exponent);
  return {value(r.pack()), odd};
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
