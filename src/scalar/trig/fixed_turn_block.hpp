// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Sine, cosine and tangent of floats at `ha` by whole blocks, in doubles: on processors this takes
/// half the time of the fixed point and has the same bits.
///
/// What x leaves to the nearest half or quarter turn comes from the same 65 digits of 1/pi. The
/// product with the first 27 digits and the difference are exact; the one rounding, to 53 bits, is
/// behind the 31 bits that the fixed point keeps. They are cut off in the same direction, and the
/// highest coefficients act in float on the same argument. What is two floats there is a double
/// here: both differ by less than 2^-44 of the value, so that it rounds to the same float unless it
/// lies within 2^-17 ulp of the middle between two. A block with such a value, or with an argument
/// from 2^21 on, is left to the main path. Below 2^-12 the function is the argument, to which the
/// value rounds. That the one rounding never reaches the 31 bits where it would be seen, every
/// float has shown.
#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/trig/fixed_turn.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

struct fixed_turn_block {
  static constexpr double inverse_pi = 0x1.45f306dc9c883p-2;

  /// A coefficient that the fixed point has in two floats.
  LUMEN_MAIN constexpr double coefficient(std::uint32_t high, std::uint32_t low) {
    return static_cast<double>(value(high)) + static_cast<double>(value(low));
  }

  /// x/pi - n and x/pi - n - 1/2, by those digits of 1/pi that `fixed_turn` has.
  LUMEN_MAIN double rest(double x, double n) {
    return fma(x, lower_digits, fma(x, upper_digits, -n));
  }
  LUMEN_MAIN double rest_of_next_quarter(double x, double n) {
    return fma(x, lower_digits, fma(x, upper_digits, -n) - 0.5);
  }

  /// The 31 bits of a rest that the fixed point keeps; the others are cut off, away from zero if
  /// `up`.
  LUMEN_MAIN double cut(double rest, bool up) {
    constexpr std::uint64_t behind = 0x3fffff;
    const std::uint64_t p = bits(rest) + select(up, behind, std::uint64_t{0});
    return value(p & ~behind);
  }

  LUMEN_MAIN bool differ_in_sign(double x, double y) {
    return static_cast<std::int64_t>(bits(x) ^ bits(y)) < 0;
  }

  /// Whether y is so close to the middle between two floats that two words of float might round
  /// the other way.
  LUMEN_MAIN bool is_near_middle(double y) {
    constexpr std::uint64_t reach = 0x1000, middle = 0x10000000, behind = 2 * middle - 1;
    return ((bits(y) + (reach - middle)) & (behind & ~(2 * reach - 1))) == 0;
  }

  /// A flag for loops to or together. As an integer it has two bits: those are anded into place,
  /// where a compiler shifts a single one.
  template <typename T>
  LUMEN_MAIN loop_flag<T> mark_if(bool condition) {
    return select(condition, static_cast<loop_flag<T>>(3), loop_flag<T>{0});
  }

 private:
  static constexpr double upper_digits = 0x517cc1bp-28;     // 27 digits
  static constexpr double lower_digits = 0x39391054a8p-67;  // the following 38
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
