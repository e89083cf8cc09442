// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/atrig/bitwise_choice.hpp"
#include "scalar/complex/double_double.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Both parts zero, or one of them an infinity or a NaN.
template <typename R>
LUMEN_MAIN uint_of<R> has_special_root(std::complex<R> z) {
  const uint_of<R> a = bits(fabs(z.real())), b = bits(fabs(z.imag()));
  const uint_of<R> m = select(a > b, a, b);
  return flag_if<R>(m == 0, m >= format<R>::special);
}

/// The root of these numbers. Of -infinity beside a NaN the imaginary part is a large number, as
/// callers have come to expect.
template <typename R>
LUMEN_DEVICE inline std::complex<R> special_root(std::complex<R> z) {
  const R x = z.real(), y = z.imag();
  const R a = fabs(x), b = fabs(y);
  if (a == 0 && b == 0) return {R(0), fma(y, R(1), R(0))};
  constexpr R infinity = value(format<R>::special);
  if (is_infinite(y)) return {infinity, y};
  if (is_infinite(x) && sign_bit(x) == 0) return {x, is_nan(y) ? y * R(0) : or_sign(R(0), y)};
  if (is_infinite(x)) {
    const R large = static_cast<R>(value(std::uint64_t{0x43dffc0000000000}));
    return {b * R(0), is_nan(y) ? large : or_sign(infinity, y)};
  }
  const R nan = value((bits(a) > bits(b) ? bits(a) : bits(b)) | format<R>::nan);
  return {nan, nan};
}

/// The root from w = sqrt((|z| + |x|)/2) and |y|/(2w): these are its real and its imaginary part in
/// the right half-plane, and the other way round in the left one, where the sum would cancel.
template <typename R>
LUMEN_MAIN std::complex<R> root_of_halves(std::complex<R> z, R w, R other) {
  const auto left = mask_of<R>(z.real() < 0);
  return {chosen(left, other, w), value(bits(chosen(left, w, other)) ^ sign_bit(z.imag()))};
}

/// sqrt(z) for complex float, every tier, status 0; each part within 0.5000001 ulp. In double,
/// where nothing overflows and the squares are exact.
struct sqrt_c : scalar_v11<sqrt_c, std::complex<float>> {
  using complex = std::complex<float>;

  LUMEN_MAIN main_result<complex> main(complex z) {
    const double x = z.real(), y = z.imag();
    const double t = sqrt(mad(x, x, y * y));
    const double w = sqrt((t + fabs(x)) * 0.5);
    const double other = divide(fabs(y) * 0.5, w);
    return {root_of_halves(z, static_cast<float>(w), static_cast<float>(other)),
            has_special_root(z)};
  }

  LUMEN_RARE std::uint32_t rare(complex z, complex* y) {
    *y = special_root(z);
    return mask(code::none);
  }
};

/// sqrt(z) for complex double, every tier, status 0; each part within 0.5001 ulp, a denormal one
/// within 0.75.
///
/// z is scaled by an even power of two, so that the larger part is in [1/2, 2) or not far from it.
/// Roots are in two words: a float reciprocal root r of S leaves e = (Sr² - 1)/2 below 2^-22, and
/// the series 1 - e + 3/2 e² of the reciprocal root corrects it. The other part is a quotient by
/// the root in two words as well, of y itself: its scaled value may underflow.
struct sqrt_z : scalar_v11<sqrt_z, std::complex<double>> {
  using complex = std::complex<double>;

  LUMEN_MAIN main_result<complex> main(complex z) {
    const double a = fabs(z.real()), b = fabs(z.imag());
    const std::uint64_t m = select(bits(a) > bits(b), bits(a), bits(b));
    const std::uint64_t odd = (m >> 52) | 1;
    const std::uint64_t k = select(odd < 0x7fd, odd, std::uint64_t{0x7fd});
    const double scale = value(0x7fe0000000000000u - (k << 52));
    const double sa = fma(a, scale, 0.0), sb = fma(b, scale, 0.0);

    const double_double modulus =
        root(sum_of_products(two_product(sa, sa), two_product(sb, sb))).root;
    const double_double sum = two_sum(sa, modulus.high);
    const auto v = root({sum.high * 0.5, (sum.low + modulus.low) * 0.5});
    const double w = v.root.high + v.root.low;
    const std::uint64_t scale_back = (k << 51) + 0xe008000000000000u;
    const double scaled_w = value(bits(w) + scale_back);

    // 1/(2w): w is v.root.high·(1 + d), the reciprocal v.reciprocal·(1 - d') with a small d'.
    const double inverse = v.reciprocal;
    const double residual = fma(-v.root.low, inverse, fma(-v.root.high, inverse, 1.0));
    const double correction = inverse * fma(residual, residual, residual);
    const double half_scale = value(0x3fe0000000000000u - scale_back);
    const double up = select(b < 1.0, value(0x43f0000000000000u), 1.0);    // 2^64
    const double down = select(b < 1.0, value(0x3bf0000000000000u), 1.0);  // 2^-64
    const double numerator = b * up * half_scale;
    const double other = fma(numerator, inverse, numerator * correction) * down;
    return {root_of_halves(z, scaled_w, other), has_special_root(z)};
  }

  LUMEN_RARE std::uint32_t rare(complex z, complex* y) {
    *y = special_root(z);
    return mask(code::none);
  }

 private:
  struct two_word_root {
    double_double root;
    double reciprocal;  ///< of the root, to 23 bits
  };

  /// Within 2^-68.
  LUMEN_MAIN two_word_root root(double_double s) {
    const auto r = static_cast<double>(divide(1.0f, sqrt(static_cast<float>(s.high))));
    const double h = fma(s.high, r, 0.0);
    const double rest = fma(s.high, r, -h) + s.low * r;
    const double e = fma(rest, r, fma(h, r, -1.0)) * 0.5;
    const double series = fma(-1.5 * e, e, e);
    return {fast_two_sum(h, fma(-h, series, rest)), r};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
