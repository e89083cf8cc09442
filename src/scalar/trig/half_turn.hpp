// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The short reduction to the nearest multiple of pi, for the main paths of sine and cosine.
#pragma once

#include <cstdint>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// pi in parts, of which each rounds what the ones before leave.
template <typename T>
struct pi_parts;
template <>
struct pi_parts<float> {
  static constexpr std::uint32_t inverse = 0x3ea2f983;
  static constexpr std::uint32_t first = 0x40490fdb, second = 0xb3bbbd2e, third = 0xa7772ced;
  static constexpr std::uint32_t half = 0x3fc90fdb;     // pi/2
  static constexpr std::uint32_t shifter = 0x4b400000;  // 3·2^22
};
template <>
struct pi_parts<double> {
  static constexpr std::uint64_t inverse = 0x3fd45f306dc9c883;
  static constexpr std::uint64_t first = 0x400921fb54442d18, second = 0x3ca1a62633145c06,
                                 third = 0x395c1cd129024e09;
  static constexpr std::uint64_t half = 0x3ff921fb54442d18;     // pi/2
  static constexpr std::uint64_t shifter = 0x4338000000000000;  // 3·2^51
};

/// How many parts the tiers below `ha` take.
template <tier t>
inline constexpr int parts_of_pi = t == tier::la ? 3 : 2;

/// x + n pi, with pi in two or three parts.
template <int parts, typename T>
LUMEN_MAIN T plus_half_turns(T n, T x) {
  using pi = pi_parts<T>;
  T r = fma(n, value(pi::first), x);
  r = fma(n, value(pi::second), r);
  if constexpr (parts == 3) r = fma(n, value(pi::third), r);
  return r;
}

/// The rest of an angle to the nearest multiple n pi, negated where n is odd: the sine of the angle
/// is that of the rest. |rest| <= pi/2 and a little.
template <typename T>
LUMEN_MAIN T negated_if_odd(T rest, T shifted) {
  constexpr int to_sign = 8 * sizeof(T) - 1;
  return value(bits(rest) ^ (bits(shifted) << to_sign));
}

/// a >= 0 as n pi + rest. Two parts leave 2^-48 of pi at float and 2^-105 at double.
template <int parts, typename T>
LUMEN_MAIN T rest_of_half_turns(T a) {
  using pi = pi_parts<T>;
  const T shifted = fma(a, value(pi::inverse), value(pi::shifter));
  const T n = shifted - value(pi::shifter);
  return negated_if_odd(plus_half_turns<parts>(-n, a), shifted);
}

/// For the cosine, the same of a quarter turn next to a: cos a = sin of the rest. `quarter` is
/// pi/2 - a at double and a + pi/2 at float, rounded; where it is pi/2 itself, a is too small for
/// the cosine to differ from 1.
template <typename T>
struct quarter_turn_next {
  T quarter;
  T rest;
};
template <int parts>
LUMEN_MAIN quarter_turn_next<float> rest_of_quarter_turn_next(float a) {
  using pi = pi_parts<float>;
  const float quarter = a + value(pi::half);
  const float shifted = fma(quarter, value(pi::inverse), value(pi::shifter));
  const float n = (shifted - value(pi::shifter)) - 0.5f;
  return {quarter, negated_if_odd(plus_half_turns<parts>(-n, a), shifted)};
}
template <int parts>
LUMEN_MAIN quarter_turn_next<double> rest_of_quarter_turn_next(double a) {
  using pi = pi_parts<double>;
  const double quarter = value(pi::half) - a;
  const double shifted = fma(quarter, value(pi::inverse), value(pi::shifter));
  const double n = 0.5 - (shifted - value(pi::shifter));
  return {quarter, negated_if_odd(plus_half_turns<parts>(n, -a), shifted)};
}

/// 1 where the quarter turn hides a.
template <typename T>
LUMEN_MAIN T one_if_hidden(const quarter_turn_next<T>& a, T cosine) {
  return select(bits(a.quarter) == pi_parts<T>::half, T(1), cosine);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
