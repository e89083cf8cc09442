// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/complex/scaled_turn.hpp"
#include "scalar/complex/status.hpp"
#include "scalar/exp/exp.hpp"
#include "scalar/protocol.hpp"
#include "scalar/trig/quarter_turn_kernels.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// exp(x + iy) where x or y is an infinity or a NaN, or y is 0; status 0. A NaN beside a finite
/// number other than 0 gives zeros whose sign is opposite to that of y.
template <typename R>
LUMEN_DEVICE inline std::complex<R> special_exponential(R x, R y) {
  if (y == 0) {
    if (is_special(x)) return {is_infinite(x) && x < 0 ? R(0) : x + x, y};
    return {static_cast<R>(careful_turn(x, 0.0).real()), y};
  }
  if (is_nan(x)) {
    const R part = is_special(y) ? x * x : y * R(-0.0);
    return {part, part};
  }
  if (!is_special(y)) {
    // Infinities or zeros, by the signs of the cosine and the sine.
    const std::complex<double> turn = careful_turn(0.0, y);
    const R magnitude = x > 0 ? x : R(0);
    return {magnitude * static_cast<R>(turn.real()), magnitude * static_cast<R>(turn.imag())};
  }
  const R nan = y - y;
  if (!is_infinite(x)) return {nan, nan};
  return x > 0 ? std::complex<R>(x, nan) : std::complex<R>(R(0), R(0));
}

/// exp(z) for complex float; each part within 0.61 ulp. One body for all tiers, in double with
/// polynomials of 28 bits; what cannot be a float is one already far beyond its range.
///
/// Code 3 at la and ha if a part is infinite and no part of z is.
template <tier t>
struct exp_c : scalar_v11<exp_c<t>, std::complex<float>> {
  using complex = std::complex<float>;

  LUMEN_MAIN main_result<complex> main(complex z) {
    const float below = select(z.real() < 700.0f, z.real(), 700.0f);
    const double x = select(below > -700.0f, below, -700.0f);
    const double a = fabs(static_cast<double>(z.imag()));
    const auto s = short_quarter_turn::in_one_word<3>(a);
    const double square = s.rest * s.rest;
    const exponential_factors e = short_factors(x);
    const double scale = value(e.scale);
    const double cosine = scale * short_cosine_series(square);
    const double sine = scale * short_sine_series(s.rest, square);
    const double scaled_cosine = fma(cosine, e.rest, cosine);
    const double scaled_sine = fma(sine, e.rest, sine);
    const auto re = static_cast<float>(real_of_turn(s.quarters, scaled_cosine, scaled_sine));
    const auto im =
        static_cast<float>(imaginary_of_turn(s.quarters, scaled_cosine, scaled_sine, z.imag()));
    const bool is_long = !is_short_turn(a);
    return {{re, im},
            flag_if<float>(is_long, is_special(z.real()), is_special(re), is_special(im))};
  }

  LUMEN_RARE std::uint32_t rare(complex z, complex* y) {
    const bool special = is_special(z.real()) || is_special(z.imag());
    if (special) {
      *y = special_exponential(z.real(), z.imag());
      return mask(code::none);
    }
    const std::complex<double> r = careful_turn(z.real(), z.imag());
    *y = {static_cast<float>(r.real()), static_cast<float>(r.imag())};
    return t == tier::ep ? mask(code::none) : overflow_mask(*y);
  }
};

/// exp(x + iy) for complex double. The main path has -708.3955 < x < 1064 and |y| < 2^24.
///
/// `la` and `ep` are one body: e^x with half steps, sine and cosine to the last bit. Each part
/// within 2.7 ulp. `ha`: the product and its factors in two words; within 0.9 ulp.
///
/// Code 3 at la and ha if a part is infinite and no part of z is, but not for y = 0 with x >= 1064.
template <tier t>
struct exp_z : scalar_v11<exp_z<t>, std::complex<double>> {
  using complex = std::complex<double>;
  static constexpr int interleave = 2;

  LUMEN_MAIN main_result<complex> main(complex z) {
    const complex r = product(z);
    return {r, flag_if<double>(!is_ordinary(z), is_special(r.real()), is_special(r.imag()))};
  }

  LUMEN_RARE std::uint32_t rare(complex z, complex* y) {
    const double x = z.real();
    const bool ordinary = is_ordinary(z);
    if (!ordinary && (is_special(x) || is_special(z.imag()) || z.imag() == 0)) {
      *y = special_exponential(x, z.imag());
      return mask(code::none);
    }
    *y = ordinary ? product(z) : careful_turn(x, z.imag());
    return t == tier::ep ? mask(code::none) : overflow_mask(*y);
  }

 private:
  LUMEN_MAIN bool is_ordinary(complex z) {
    const bool above = z.real() > value(0xc086232a00000000u);
    const bool below = z.real() < value(0x4090a00000000000u);
    const bool is_short = is_short_turn(fabs(z.imag()));
    return above & below & is_short;
  }

  LUMEN_MAIN complex product(complex z) {
    const auto s = short_quarter_turn::by_products(fabs(z.imag()));
    if constexpr (t == tier::ha) {
      return scaled_turn(z.real(), z.imag(), s.quarters, s.rest, s.rest_low);
    } else {
      const double square = s.rest * s.rest;
      const double sine =
          sine_kernel(s.rest, s.rest_low, quarter_turn_series::of_sine(square) * square);
      const double cosine = cosine_kernel(s.rest, s.rest_low, square,
                                          quarter_turn_series::of_cosine(square) * square);
      const auto e = half_step_factors_d<tier::la>::of(z.real());
      // From 2^1024 on the exponent has wrapped; then 2^512 is a factor of its own.
      const bool beyond = e.scale >= format<double>::special;
      const double scale = value(e.scale - select(beyond, 0x2000000000000000u, std::uint64_t{0}));
      const double power = select(beyond, value(0x5ff0000000000000u), 1.0);
      const double c = scale * cosine, d = scale * sine;
      const double re = fma(c, e.rest, c) * power, im = fma(d, e.rest, d) * power;
      return {real_of_turn(s.quarters, re, im), imaginary_of_turn(s.quarters, re, im, z.imag())};
    }
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
