// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/atrig/half_angle.hpp"
#include "scalar/atrig/quadrant.hpp"
#include "scalar/complex/double_double.hpp"
#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// A complex number by the magnitudes of its parts as larger·2^exponent and smaller·2^exponent,
/// 1 <= larger < 2. The larger magnitude is a normal number below 2^1022.
struct scaled_magnitudes {
  double larger;
  double smaller;
  std::uint64_t field;  ///< exponent + 1023

  LUMEN_MAIN scaled_magnitudes of(const quadrant<double>& p) {
    const std::uint64_t exponent = bits(p.larger) & format<double>::special;
    const double scale = value(0x7fe0000000000000u - exponent);
    return {value((bits(p.larger) & format<double>::fraction) | format<double>::one),
            fma(p.smaller, scale, 0.0), exponent >> format<double>::fraction_bits};
  }
};

/// u² + v² - 1 for a sum of squares in [1/2, 2]: what the squares and their sum round away is added
/// to the difference without error, since all of it may cancel.
LUMEN_MAIN double_double sum_of_squares_less_1(double_double u_square, double_double v_square) {
  const double_double s = two_sum(u_square.high, v_square.high);
  return sum_of_products({s.high - 1.0, u_square.low}, {s.low, v_square.low});
}

/// An integer below 2^52, less `bias`, as a double.
LUMEN_MAIN double number_of(std::uint64_t n, double bias) {
  return value(n | 0x4330000000000000u) - (0x1p52 + bias);
}

/// The angle of a point from the one of (larger, smaller): their sum with the base, reflected.
template <typename T>
LUMEN_MAIN T reflected(T sum, const quadrant<T>& p, T y) {
  return value(bits(sum) ^ p.down() ^ sign_bit(y));
}

/// What an angle of (larger, smaller) is added to before it is reflected, by the words of pi/2 and
/// pi.
template <typename T>
LUMEN_MAIN T base_of_reflected(const quadrant<T>& p, uint_of<T> quarter, uint_of<T> half) {
  return value(bits(p.base(quarter, half)) ^ p.down());
}

/// ln(z) where both parts are zero or one of them is an infinity or a NaN.
template <typename R>
LUMEN_DEVICE inline std::complex<R> special_logarithm(std::complex<R> z) {
  constexpr R infinity = value(format<R>::special);
  const R x = z.real(), y = z.imag();
  const auto p = quadrant<R>::of(y, x);
  if (is_nan(p.larger)) {
    const R nan = x + y;
    return {is_infinite(p.smaller) ? infinity : nan, nan};
  }
  if (is_infinite(p.smaller)) {
    constexpr double quarter_of_pi = value(std::uint64_t{0x3fe921fb54442d18});
    constexpr double three_quarters_of_pi = value(std::uint64_t{0x4002d97c7f3321d2});
    const double diagonal = p.left != 0 ? three_quarters_of_pi : quarter_of_pi;
    return {infinity, or_sign(static_cast<R>(diagonal), y)};
  }
  const R base = p.base(pi_words<R>::half, pi_words<R>::whole);
  return {p.larger == 0 ? -infinity : infinity, or_sign(base, y)};
}

/// Both parts zero, or one of them an infinity or a NaN.
template <typename R>
LUMEN_MAIN bool has_special_logarithm(const quadrant<R>& p) {
  const auto larger = bits(p.larger);
  return (larger == 0) | (larger >= format<R>::special);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
