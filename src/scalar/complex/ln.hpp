// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/atrig/arctangent_polynomial.hpp"
#include "scalar/complex/double_double.hpp"
#include "scalar/complex/ln_constants.hpp"
#include "scalar/complex/logarithm_parts.hpp"
#include "scalar/complex/two_word_logarithm.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// ln(z) for complex float, every tier, status 0; each part within 0.55 ulp.
///
/// In double. |z|² = 4^(e + k)(1 + t) with k = 0 or 1, so that t is 0 at |z| = 1, and t itself has
/// one rounding: u² - 1 is exact, u being the larger part. ln(1 + t)/2 = artanh(t/(2 + t)). The
/// argument of this and that of the arctangent share one division.
struct ln_c : scalar_v11<ln_c, std::complex<float>> {
  using complex = std::complex<float>;

  LUMEN_MAIN main_result<complex> main(complex z) {
    const double x = z.real(), y = z.imag();
    const auto p = quadrant<double>::of(y, x);
    const auto m = scaled_magnitudes::of(p);
    const double square = fma(m.smaller, m.smaller, m.larger * m.larger);
    const std::uint64_t k = (bits(square) + 0xc020000000000000u) >> 53;
    const double half = select(k != 0, 0.5, 1.0);
    const double u = m.larger * half, v = m.smaller * half;
    const double t = fma(v, v, fma(u, u, -1.0));

    const double d = t + 2.0;
    const double reciprocal = divide(1.0, m.larger * d);
    const double f = t * m.larger * reciprocal;
    const double q = m.smaller * d * reciprocal;
    const double w = f * f;
    const double artanh = fma(horner_of(w, artanh_rest_c), w * f, f);
    const double n = number_of(m.field + k, format<double>::bias);
    const double re = fma(n, value(0x3fe62e42fefa39efu), artanh);

    const double angle = arctangent_factor_ep(q * q) * q;
    const double base = base_of_reflected(p, pi_words<double>::half, pi_words<double>::whole);
    const double im = reflected(angle + base, p, y);
    return {{static_cast<float>(re), static_cast<float>(im)},
            flag_if<float>(has_special_logarithm(p))};
  }

  LUMEN_RARE std::uint32_t rare(complex z, complex* y) {
    *y = special_logarithm(z);
    return mask(code::none);
  }
};

/// ln(z) for complex double at la and ep, one body, status 0; each part within 3 ulp.
///
/// |z|² = 4^(e + k)(1 + t) with k = 0 or 1, so that t is 0 at |z| = 1, where it comes from a sum of
/// squares in two words. The angle is arctan q of the ratio q of the parts, counted from 0, pi/2 or
/// pi. Larger parts that are denormal or from 2^1022 on are scaled on the rare path.
template <tier t>
struct ln_z : scalar_v11<ln_z<t>, std::complex<double>> {
  using complex = std::complex<double>;

  LUMEN_MAIN main_result<complex> main(complex z) {
    const auto p = quadrant<double>::of(z.imag(), z.real());
    return {logarithm(p, z.imag(), 0.0), flag_if<double>(needs_scaling(p))};
  }

  LUMEN_RARE std::uint32_t rare(complex z, complex* y) {
    auto p = quadrant<double>::of(z.imag(), z.real());
    if (has_special_logarithm(p)) {
      *y = special_logarithm(z);
      return mask(code::none);
    }
    const bool large = p.larger > 1.0;
    const double scale = large ? 0x1p-3 : 0x1p64;
    p.larger *= scale;
    p.smaller *= scale;
    *y = logarithm(p, z.imag(), large ? 3.0 : -64.0);
    return mask(code::none);
  }

 private:
  LUMEN_MAIN bool needs_scaling(const quadrant<double>& p) {
    return bits(p.larger) + 0x8030000000000000u <= 0x8040000000000000u;
  }

  LUMEN_MAIN complex logarithm(const quadrant<double>& p, double y, double offset) {
    const auto m = scaled_magnitudes::of(p);
    const double q = ratio(m);
    const double base = base_of_reflected(p, pi_words<double>::half, pi_words<double>::whole);
    const double im = reflected(fma(arctangent_rest_of_ratio(q * q), q, q) + base, p, y);

    const double square = fma(m.smaller, m.smaller, m.larger * m.larger);
    const std::uint64_t k = (bits(square) + 0xc020000000000000u) >> 53;
    const double half = select(k != 0, 0.5, 1.0);
    const double u = fma(m.larger, half, 0.0), v = fma(m.smaller, half, 0.0);
    const double_double excess = sum_of_squares_less_1(two_product(u, u), two_product(v, v));
    const double r = excess.high + excess.low;
    const double n = number_of(m.field + k, format<double>::bias) + offset;
    const double re = fma(n, value(0x3fe62e42fefa39efu), fma(half_log1p_rest(r), r, r * 0.5));
    return {re, im};
  }

  /// smaller/larger by a float reciprocal of 1 <= larger < 2 and its correction.
  LUMEN_MAIN double ratio(const scaled_magnitudes& m) {
    const auto r = static_cast<double>(divide(1.0f, static_cast<float>(m.larger)));
    const double c = fma(-m.larger, r, 1.0);
    return fma(m.smaller, r, fma(fma(m.smaller, r, 0.0), fma(c, c, c), 0.0));
  }

  /// arctan(q)/q - 1 on [0, 1] from z = q².
  LUMEN_MAIN double arctangent_rest_of_ratio(double z) {
    return horner(
        z, 0xbef569394e296094u, 0x3f2d6c9e8bb2574au, 0xbf532c3371b8654bu, 0x3f6fb727ba0e2b22u,
        0xbf82dd4cbf264d6du, 0x3f916b3381f008acu, 0xbf9a79f3da7a18b1u, 0x3fa173db1d2d182au,
        0xbfa4f587a1285370u, 0x3fa7eeaa84db2a13u, 0xbfaad343d329f13eu, 0x3fae1783d68e7b15u,
        0xbfb1108994449af6u, 0x3fb3b12b10aa6c1eu, 0xbfb745d01d48a5edu, 0x3fbc71c7093d8e06u,
        0xbfc2492491f4cbc4u, 0x3fc99999999810dau, 0xbfd55555555553eau, 0xbc7bf826fb4d7dfau);
  }

  /// (ln(1 + r) - r)/(2r) on [-1/2, 1], in three blocks of coefficients for a shorter chain.
  LUMEN_MAIN double half_log1p_rest(double r) {
    const double r2 = r * r, r4 = r2 * r2, r8 = r4 * r4;
    const double r10 = r8 * r2;
    const double high = fma(horner_of(r, half_log1p_high), r10, horner_of(r, half_log1p_middle));
    return fma(high, r10 * r, horner_of(r, half_log1p_low));
  }
};

/// ha, without tables: both parts in two words, within 0.8 ulp.
///
/// Also the smaller part is left to the rare path where it is below 2^-900 of the larger one: the
/// angle may be denormal, and is the quotient of the parts itself.
template <>
struct ln_z<tier::ha> : scalar_v11<ln_z<tier::ha>, std::complex<double>> {
  using complex = std::complex<double>;

  LUMEN_MAIN main_result<complex> main(complex z) {
    const auto p = quadrant<double>::of(z.imag(), z.real());
    const auto m = scaled_magnitudes::of(p);
    const bool needs_scaling = bits(p.larger) + 0x8030000000000000u <= 0x8040000000000000u;
    const bool tiny_angle = (m.smaller < 0x1p-900) & (p.smaller != 0);
    return {logarithm(p, m, z.imag(), 0), flag_if<double>(needs_scaling, tiny_angle)};
  }

  LUMEN_RARE std::uint32_t rare(complex z, complex* y) {
    const auto p = quadrant<double>::of(z.imag(), z.real());
    if (has_special_logarithm(p)) {
      *y = special_logarithm(z);
      return mask(code::none);
    }
    const bool large = p.larger >= 0x1p1000;
    const bool small = p.larger < 0x1p-1000;
    const double scale = large ? 0x1p-64 : small ? 0x1p64 : 1.0;
    const int offset = large ? 64 : small ? -64 : 0;
    const quadrant<double> scaled{p.smaller * scale, p.larger * scale, p.steep, p.left};
    *y = logarithm(scaled, scaled_magnitudes::of(scaled), z.imag(), offset);
    if ((p.steep | p.left) == 0 && p.smaller < p.larger * 0x1p-30) {
      y->imag(or_sign(divide(p.smaller, p.larger), z.imag()));
    }
    return mask(code::none);
  }

 private:
  LUMEN_MAIN complex logarithm(const quadrant<double>& p, const scaled_magnitudes& m, double y,
                               int offset) {
    return {two_word_logarithm(m, offset), reflected(two_word_angle(p, m), p, y)};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
