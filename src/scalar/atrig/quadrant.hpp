// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// A point by its larger and its smaller magnitude.
template <typename T>
struct quadrant {
  T smaller;
  T larger;
  bool steep;     ///< the ordinate is the larger one
  bool negative;  ///< the abscissa has its sign bit set

  LUMEN_MAIN quadrant of(T y, T x) {
    const T ay = fabs(y), ax = fabs(x);
    const bool steep = bits(ax) < bits(ay);
    return {select(steep, ax, ay), select(steep, ay, ax), steep, sign_bit(x) != 0};
  }

  /// An angle's sign bit where the angle counts down from its base.
  LUMEN_DEVICE uint_of<T> down() const {
    return select(steep != negative, format<T>::sign, uint_of<T>{0});
  }

  /// The angle that it counts from: 0, a quarter or a half turn.
  LUMEN_DEVICE T base(T quarter, T half) const {
    return select(steep, quarter, select(negative, half, T(0)));
  }
};

/// A double whose exponent a quotient may not survive: below 2^-1020, from 2^993, infinities, NaNs.
LUMEN_MAIN bool is_extreme(double x) {
  const auto high = static_cast<std::uint32_t>(bits(fabs(x)) >> 32);
  return static_cast<std::int32_t>(high + 0x7fd00000u) > static_cast<std::int32_t>(0xfdcfffffu);
}

/// t with |t| <= 1, so that base + arctan t is the angle of (|x|, |y|): the base is a quarter turn
/// where the quotient is inverted, otherwise 0.
template <typename T>
struct true_quotient {
  T t;
  bool inverted;

  LUMEN_MAIN true_quotient of(T y, T x) { return of(y, x, !(fabs(y) < fabs(x))); }

  /// The same for a choice of the caller where |y| = |x|.
  LUMEN_MAIN true_quotient of(T y, T x, bool inverted) {
    const T ay = fabs(y), ax = fabs(x);
    return {divide(select(inverted, -ax, ay), select(inverted, ay, ax)), inverted};
  }
};

/// The angle of (|x|, |y|) turned to that of (x, y), for a half turn of the given size.
template <typename T>
LUMEN_MAIN T turned(T angle, T y, T x, T half_turn) {
  const T reflected = value(bits(angle) ^ sign_bit(x));
  return or_sign(reflected + select(sign_bit(x) != 0, half_turn, T(0)), y);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
