// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Angles given as parts of a turn: an exact reduction to an eighth of a turn.
#pragma once

#include <cmath>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

/// An angle is `quarters` quarter turns and `rest`, in the unit of the argument.
template <typename T>
struct reduced_angle {
  int quarters;  ///< 0, 1, 2, 3 or 4
  T rest;        ///< at most an eighth of a turn
};

/// |x| for finite x, by the length of a quarter turn: 90 for degrees, 1/2 for multiples of pi. All
/// steps are exact.
template <typename T>
reduced_angle<T> reduce_angle(T x, T quarter) {
  const T within = std::fmod(std::fabs(x), 4 * quarter);
  const T n = std::rint(within / quarter);
  return {static_cast<int>(n), within - n * quarter};
}

template <typename T>
struct degrees {
  static constexpr T quarter = 90;
  static constexpr wide<T> radians = wide<T>(0.0174532925199432957692369076848861271L);
};
template <typename T>
struct half_turns {
  static constexpr T quarter = T(0.5);
  static constexpr wide<T> radians = wide<T>(3.14159265358979323846264338327950288L);
};

/// The sine of |x| increased by `offset` quarter turns.
template <template <typename> typename Unit, typename T>
wide<T> sine_of_turn(T x, int offset) {
  const reduced_angle<T> angle = reduce_angle(x, Unit<T>::quarter);
  const int quadrant = (angle.quarters + offset) & 3;
  const wide<T> radians = widen(angle.rest) * Unit<T>::radians;
  const wide<T> value = (quadrant & 1) != 0 ? std::cos(radians) : std::sin(radians);
  return (quadrant & 2) != 0 ? -value : value;
}

/// Sine with zeros of the sign of x, infinities and NaN included.
template <template <typename> typename Unit, typename T>
T sine_in(T x) {
  if (!std::isfinite(x)) return x - x;
  const wide<T> value = sine_of_turn<Unit>(x, 0);
  return std::copysign(T(1), x) * narrow<T>(value == 0 ? wide<T>(0) : value);
}

/// Cosine with zeros +0.
template <template <typename> typename Unit, typename T>
T cosine_in(T x) {
  if (!std::isfinite(x)) return x - x;
  const wide<T> value = sine_of_turn<Unit>(x, 1);
  return narrow<T>(value == 0 ? wide<T>(0) : value);
}

/// Tangent. At the odd quarter turns an infinity; this and the zeros take their signs in turn, as
/// IEEE 754 has it for tanPi.
template <template <typename> typename Unit, typename T>
T tangent_in(T x) {
  if (!std::isfinite(x)) return x - x;
  const reduced_angle<T> angle = reduce_angle(x, Unit<T>::quarter);
  const wide<T> t = std::tan(widen(angle.rest) * Unit<T>::radians);
  wide<T> value = t;
  if ((angle.quarters & 1) != 0) value = t == 0 ? std::numeric_limits<wide<T>>::infinity() : -1 / t;
  if (t == 0 && (angle.quarters & 2) != 0) value = -value;
  return std::copysign(T(1), x) * narrow<T>(value);
}

}  // namespace arbor::lumen::vm::detail::library
