// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/complex/careful_magnitude.hpp"
#include "scalar/complex/double_double.hpp"
#include "scalar/complex/quotient_recovery.hpp"
#include "scalar/complex/scaled_products.hpp"
#include "scalar/complex/status.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The flag of a quotient: a part that is infinite or a NaN, by overflow, by a zero divisor, or by
/// a special operand.
template <typename R>
LUMEN_DEVICE inline uint_of<R> is_special_quotient(std::complex<R> q) {
  return flag_if<R>(is_special(q.real()), is_special(q.imag()));
}

/// The quotient in double of complex floats, where products are exact: each part of the numerator
/// and the divisor's square have one rounding.
struct widened_quotient {
  double re;
  double im;
  double square;

  LUMEN_MAIN widened_quotient of(std::complex<float> x, std::complex<float> y) {
    const double a = x.real(), b = x.imag(), c = y.real(), d = y.imag();
    return {fma(a, c, fma(b, d, 0.0)), fma(b, c, -fma(a, d, 0.0)), fma(c, c, fma(d, d, 0.0))};
  }

  LUMEN_DEVICE std::complex<float> times(double reciprocal) const {
    return {static_cast<float>(fma(re, reciprocal, 0.0)),
            static_cast<float>(fma(im, reciprocal, 0.0))};
  }
};

/// div(x, y) for complex float, la and ha: each part within 0.5000001 ulp, whatever cancels. Code 3
/// if a part is infinite and no part of an operand is, for a zero divisor too; special operands by
/// C99 Annex G. A part that is exactly zero is +0.
struct div_c : scalar_v21<div_c, std::complex<float>> {
  using complex = std::complex<float>;

  LUMEN_MAIN main_result<complex> main(complex x, complex y) {
    const complex q = quotient(x, y);
    return {q, is_special_quotient(q)};
  }

  LUMEN_RARE std::uint32_t rare(complex x, complex y, complex* r) {
    const bool zero = y.real() == 0 && y.imag() == 0;
    *r = is_finite(x) && is_finite(y) && !zero ? quotient(x, y) : recovered_quotient(x, y);
    return overflow_mask(x, y, *r);
  }

 private:
  LUMEN_MAIN complex quotient(complex x, complex y) {
    const auto q = widened_quotient::of(x, y);
    return q.times(divide(1.0, q.square));
  }
};

/// div(x, y) for complex float, ep: the same with the reciprocal of the divisor's square in float;
/// each part within 2.5 ulp where the square is in [2^-126, 2^126]. Status 0.
///
/// The square is not scaled: for |y| from 2^64 on the quotient is 0. Where it underflows, the
/// quotient is infinite or a NaN at first, and that is repaired.
struct div_c_ep : scalar_v21<div_c_ep, std::complex<float>> {
  using complex = std::complex<float>;

  LUMEN_MAIN main_result<complex> main(complex x, complex y) {
    const auto n = widened_quotient::of(x, y);
    const complex q = n.times(divide(1.0f, static_cast<float>(n.square)));
    return {q, is_special_quotient(q)};
  }

  LUMEN_RARE std::uint32_t rare(complex x, complex y, complex* r) {
    div_c::rare(x, y, r);
    return mask(code::none);
  }
};

/// n·4^-e / s for a numerator and a divisor in two words each, with one rounding.
LUMEN_DEVICE inline double rounded_quotient(const scaled_double_double& n, const scaled_sum& s) {
  const double q = divide(n.sum.high, s.sum.high);
  const double rest = (fma(-q, s.sum.high, n.sum.high) + n.sum.low) - q * s.sum.low;
  return scaled_back(fast_two_sum(q, divide(rest, s.sum.high)), n.exponent - 2 * s.exponent);
}

/// div(x, y) for complex double, la and ha: each part within 0.5000001 ulp, whatever cancels. Code
/// 3 if a part is infinite and no part of an operand is, for a zero divisor too; special operands
/// by C99 Annex G. A part that is exactly zero is +0.
///
/// The numerator's parts and the divisor's square are in two words. A part outside [2^-459,
/// 1.19·2^471], a zero among them, takes the rare path, which takes the exponents out.
struct div_z : scalar_v21<div_z, std::complex<double>> {
  using complex = std::complex<double>;
  static constexpr int interleave = 2;

  LUMEN_MAIN main_result<complex> main(complex x, complex y) {
    const double a = x.real(), b = x.imag(), c = y.real(), d = y.imag();
    const double_double n = sum_of_products(two_product(c, c), two_product(d, d));
    const double q = divide(1.0, n.high);
    const double correction = fma(fma(-n.low, q, fma(-n.high, q, 1.0)), q, 0.0);
    const double_double re = sum_of_products(two_product(a, c), two_product(b, d));
    const double_double im = sum_of_products(two_product(b, c), two_product(a, -d));
    return {
        {times(re, q, correction), times(im, q, correction)},
        flag_if<double>(needs_scaling(a), needs_scaling(b), needs_scaling(c), needs_scaling(d))};
  }

  LUMEN_RARE std::uint32_t rare(complex x, complex y, complex* r) {
    const double a = x.real(), b = x.imag(), c = y.real(), d = y.imag();
    if (!is_finite(x) || !is_finite(y) || (c == 0 && d == 0)) {
      *r = recovered_quotient(x, y);
    } else {
      const scaled_sum square = scaled_sum_of_squares(c, d);
      *r = {rounded_quotient(scaled_sum_of_products(a, c, b, d), square),
            rounded_quotient(scaled_sum_of_products(b, c, a, -d), square)};
    }
    return overflow_mask(x, y, *r);
  }

 private:
  LUMEN_MAIN double times(double_double n, double q, double correction) {
    const double low = fma(n.high, correction, fma(n.low, q, 0.0));
    return fma(n.high, q, low);
  }

  LUMEN_DEVICE static bool needs_scaling(double part) {
    constexpr std::uint64_t shift = 0x5cc0000000000000;
    constexpr std::uint64_t bound = 0xba2306fdffffffff;
    return static_cast<std::int64_t>(bits(fabs(part)) + shift) > static_cast<std::int64_t>(bound);
  }
};

/// div(x, y) for complex double, ep: the textbook formula on operands brought to the exponent 0 by
/// their larger parts, so that a part may lose all its bits where it cancels; |error| within
/// 2^-50.5 |x/y|. Special operands and zero divisors as at la and ha. Status 0.
struct div_z_ep : scalar_v21<div_z_ep, std::complex<double>> {
  using complex = std::complex<double>;
  static constexpr int interleave = 2;

  LUMEN_MAIN main_result<complex> main(complex x, complex y) {
    const std::uint64_t sx = common_scale(x), sy = common_scale(y);
    const double a = x.real() * value(sx), b = x.imag() * value(sx);
    const double c = y.real() * value(sy), d = y.imag() * value(sy);
    const double q = divide(1.0, mad(c, c, d * d));
    // sy/sx in two factors of half the exponent each, the product of which may leave the range.
    const std::uint64_t ratio = (sy + 0x7fe0000000000000u) - sx;
    const std::uint64_t half = (ratio >> 1) & format<double>::special;
    const double first = value(half), second = value(ratio - half);
    const complex r = {mad(a, c, b * d) * q * first * second,
                       mad(b, c, -(a * d)) * q * first * second};
    return {r, is_special_quotient(r)};
  }

  LUMEN_RARE std::uint32_t rare(complex x, complex y, complex* r) {
    div_z::rare(x, y, r);
    return mask(code::none);
  }

 private:
  /// The reciprocal of the power of two below a part; of the first or last exponents of doubles,
  /// that of the nearest power that has one.
  LUMEN_MAIN std::uint64_t scale(double part) {
    const std::uint64_t field = bits(part) & format<double>::special;
    const std::uint64_t lowest = 0x0010000000000000u, highest = 0x7fd0000000000000u;
    const std::uint64_t above = select(field < lowest, lowest, field);
    return 0x7fe0000000000000u - select(above > highest, highest, above);
  }
  LUMEN_MAIN std::uint64_t common_scale(complex z) {
    const std::uint64_t of_re = scale(z.real()), of_im = scale(z.imag());
    return select(of_re < of_im, of_re, of_im);
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
