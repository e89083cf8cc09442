// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/atrig/out_of_domain.hpp"
#include "scalar/inverse_root.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// pi/2, pi and 1/pi in two words.
template <typename T>
struct pi_words;
template <>
struct pi_words<float> {
  static constexpr std::uint32_t half = 0x3fc90fdb, half_low = 0xb33bbd2e;
  static constexpr std::uint32_t whole = 0x40490fdb, whole_low = 0xb3bbbd2e;
  static constexpr std::uint32_t inverse = 0x3ea2f983, inverse_low = 0x325c9c88;
};
template <>
struct pi_words<double> {
  static constexpr std::uint64_t half = 0x3ff921fb54442d18, half_low = 0x3c91a62633145c07;
  static constexpr std::uint64_t whole = 0x400921fb54442d18, whole_low = 0x3ca1a62633145c07;
  static constexpr std::uint64_t inverse = 0x3fd45f306dc9c883, inverse_low = 0xbc76b01ec5417056;
};

/// The reduction that all inverse sines and cosines share, for a = |x|:
///
///     arcsin a = a Q(a²)                    for a <= 1/2, the direct case,
///     arcsin a = pi/2 - 2√y Q(y)            for a > 1/2, with y = (1 - a)/2, exact there.
///
/// The root is y times 1/√y, which is finite at y = 0, where the product is 0.
template <typename T>
struct half_angle {
  T a;
  T y;
  T z;        ///< argument of Q: x² or y
  T inverse;  ///< 1/√y
  T root;     ///< -2√y
  bool direct;
  uint_of<T> outside;  ///< not 0 if |x| > 1, or a NaN: code 1

  LUMEN_MAIN half_angle of(T x) {
    const T a = fabs(x);
    const T y = fma(T(-0.5), a, T(0.5));
    const bool direct = a <= T(0.5);
    const T square = x * x;
    const T z = select(wide_vectors ? direct : square < y, square, y);
    const auto [root, inverse] = roots(y);
    return {a, y, z, T(inverse), root_of(y, T(inverse)), direct, is_outside(y, root)};
  }

  /// 2√y with the sign of x, and with that of -x.
  [[gnu::always_inline]] LUMEN_DEVICE float root_like(float x) const {
    return (or_sign(1.0f, x) - x) * inverse;
  }
  [[gnu::always_inline]] LUMEN_DEVICE float root_unlike(float x) const {
    return (x - or_sign(1.0f, x)) * inverse;
  }
  [[gnu::always_inline]] LUMEN_DEVICE double root_like(double x) const {
    return value(bits(-root) ^ sign_bit(x));
  }
  [[gnu::always_inline]] LUMEN_DEVICE double root_unlike(double x) const {
    return value(bits(root) ^ sign_bit(x));
  }

  /// What a word `u` for 2√y or -2√y lacks, added to `low`.
  [[gnu::always_inline]] LUMEN_DEVICE T rest_of_root(T u, T low) const {
    const T w = u * T(0.5);
    const T d = fma(-w, w, y);
    return fma(value(bits(d) ^ sign_bit(u)), inverse, low);
  }

 private:
  /// √y and 1/√y. Of doubles a vector holds half as many, which the divider has time for.
  LUMEN_MAIN root_and_inverse roots(float y) {
    if constexpr (wide_vectors) return root_and_inverse::by_steps(y);
    return root_and_inverse::by_division(y);
  }
  LUMEN_MAIN root_and_inverse roots(double y) {
    return root_and_inverse::by_division(static_cast<float>(y));
  }

  LUMEN_MAIN float root_of(float y, float inverse) { return -2.0f * y * inverse; }

  /// The root from the float seed, with 1 + e/2 + 3e²/8 for its error.
  LUMEN_MAIN double root_of(double y, double inverse) {
    const double h = y * inverse;
    const double g = -2.0 * h;
    const double e = fma(-inverse, h, 1.0);
    return fma(fma(0.375, e, 0.5) * e, g, g);
  }

  /// The root of the negative number is a NaN, the roots of all others lack this bit.
  LUMEN_MAIN std::uint32_t is_outside(float, float root) {
    if constexpr (wide_vectors) return flag_if<float>(root != root);
    return bits(root) & 0x40000000u;
  }
  LUMEN_MAIN std::uint64_t is_outside(double y, float) {
    return flag_if<double>(is_outside_unit_interval(y));
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
