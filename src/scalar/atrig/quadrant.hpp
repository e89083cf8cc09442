// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/atrig/bitwise_choice.hpp"
#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// A point by its larger and its smaller magnitude.
template <typename T>
struct quadrant {
  T smaller;
  T larger;
  uint_of<T> steep;  ///< all bits set if the ordinate is the larger one
  uint_of<T> left;   ///< all bits set if the abscissa has its sign bit set

  LUMEN_MAIN quadrant of(T y, T x) {
    const uint_of<T> ay = bits(fabs(y)), ax = bits(fabs(x));
    const auto steep = mask_of<T>(static_cast<int_of<T>>(ax) < static_cast<int_of<T>>(ay));
    const uint_of<T> exchanged = (ax ^ ay) & steep;
    const auto left = mask_of<T>(static_cast<int_of<T>>(bits(x)) < 0);
    return {value(ay ^ exchanged), value(ax ^ exchanged), steep, left};
  }

  /// An angle's sign bit where the angle counts down from its base.
  LUMEN_DEVICE uint_of<T> down() const { return (steep ^ left) & format<T>::sign; }

  /// The angle that it counts from: 0, a quarter or a half turn, given as patterns.
  LUMEN_DEVICE T base(uint_of<T> quarter, uint_of<T> half) const {
    return value((steep & quarter) | (~steep & left & half));
  }
};

/// A double whose exponent a quotient may not survive: below 2^-1020, from 2^993, infinities, NaNs.
LUMEN_MAIN bool is_extreme(double x) {
  const auto high = static_cast<std::uint32_t>(bits(fabs(x)) >> 32);
  return static_cast<std::int32_t>(high + 0x7fd00000u) > static_cast<std::int32_t>(0xfdcfffffu);
}

/// A point with an extreme coordinate, but not one whose other coordinate is a zero: the quotient
/// of these is 0. The origin has no quotient.
LUMEN_MAIN bool is_extreme_point(double y, double x) {
  const bool extreme_y = is_extreme(y), extreme_x = is_extreme(x);
  const bool zero_y = y == 0, zero_x = x == 0;
  const bool nan_y = is_nan(y), nan_x = is_nan(x);
  const bool on_axis = (zero_y != zero_x) & !(nan_y | nan_x);
  return (extreme_y | extreme_x) & !on_axis;
}

/// t with |t| <= 1, so that base + arctan t is the angle of (|x|, |y|): the base is a quarter turn
/// where the quotient is inverted, otherwise 0.
template <typename T>
struct true_quotient {
  T t;
  uint_of<T> inverted;  ///< all bits set if it is

  LUMEN_MAIN true_quotient of(T y, T x) { return of(y, x, !(fabs(y) < fabs(x))); }

  /// The same for a choice of the caller where |y| = |x|.
  LUMEN_MAIN true_quotient of(T y, T x, bool inverted) {
    const uint_of<T> ay = bits(fabs(y)), ax = bits(fabs(x));
    const auto m = mask_of<T>(inverted);
    const uint_of<T> exchanged = (ax ^ ay) & m;
    return {divide(value((ay ^ exchanged) | (m & format<T>::sign)), value(ax ^ exchanged)), m};
  }

  /// The base, for a quarter turn given as a pattern.
  LUMEN_DEVICE T base(uint_of<T> quarter) const { return value(inverted & quarter); }
};

/// The angle of (|x|, |y|) turned to that of (x, y), for a half turn given as a pattern.
template <typename T>
LUMEN_MAIN T turned(T angle, T y, T x, uint_of<T> half) {
  const auto left = mask_of<T>(static_cast<int_of<T>>(bits(x)) < 0);
  return or_sign(value(bits(angle) ^ sign_bit(x)) + value(left & half), y);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
