// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/complex/careful_magnitude.hpp"
#include "scalar/complex/status.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The magnitude of a number with an infinite part is +infinity, also beside a NaN.
template <typename R>
LUMEN_DEVICE inline R special_magnitude(std::complex<R> z) {
  return has_infinity(z) ? value(format<R>::special) : z.real() + z.imag();
}

/// abs(z) for complex float, every tier, status 0 also on overflow; within 0.95 ulp.
///
/// The larger part is brought to [1/2, 1) or [2, 4), by a power of two whose inverse is normal too,
/// so that no square overflows and none that matters underflows; one step of Newton corrects the
/// root taken from the reciprocal root.
struct abs_c : scalar_v11<abs_c, std::complex<float>, float> {
  LUMEN_MAIN main_result<float> main(std::complex<float> z) {
    const float a = fabs(z.real());
    const float b = fabs(z.imag());
    const float m = select(a > b, a, b);
    const float n = select(a > b, b, a);
    const std::uint32_t scale =
        (((bits(m) >> 6) & 0x01000000u) | 0x7e800000u) - (bits(m) & format<float>::special);
    const float scaled_m = fma(m, value(scale), 0.0f);
    const float scaled_n = fma(n, value(scale), 0.0f);
    const float sum = fma(scaled_m, scaled_m, fma(scaled_n, scaled_n, 0.0f));
    const float r = divide(1.0f, sqrt(sum));
    const float h = fma(sum, r, 0.0f);
    const float root = fma(fma(r, 0.5f, 0.0f), fma(h, -h, sum), h);
    const float result = fma(root, value(0x7f000000u - scale), 0.0f);
    return {select(sum == 0, 0.0f, result), flag_if<float>(is_special(a), is_special(b))};
  }

  LUMEN_RARE std::uint32_t rare(std::complex<float> z, float* y) {
    *y = special_magnitude(z);
    return mask(code::none);
  }
};

/// abs(z) for complex double, every tier, status 0 also on overflow; within 1.21 ulp where the sum
/// of squares S is in [2^-67, 2^66] (two roundings of S, halved by the root, and that of the
/// result), within 0.5000001 ulp elsewhere.
///
/// A float reciprocal root r of S leaves e = Sr² - 1 below 2^-22, and the binomial series of
/// (1 + e)^(-1/2) turns Sr into the root.
struct abs_z : scalar_v11<abs_z, std::complex<double>, double> {
  LUMEN_MAIN main_result<double> main(std::complex<double> z) {
    const double s = fma(z.real(), z.real(), fma(z.imag(), z.imag(), 0.0));
    const double r = static_cast<double>(divide(1.0f, sqrt(static_cast<float>(s))));
    const double e = fma(s, r * r, -1.0);
    const double p = mad(mad(mad(c4, e, c3), e, c2), e, c1);
    return {fma(s, r, p * e * r * s), flag_if<double>(!in_band(s))};
  }

  LUMEN_RARE std::uint32_t rare(std::complex<double> z, double* y) {
    if (is_special(z.real()) || is_special(z.imag())) {
      *y = special_magnitude(z);
    } else if (z.real() == 0 && z.imag() == 0) {
      *y = 0;
    } else {
      *y = careful_magnitude(z.real(), z.imag());
    }
    return mask(code::none);
  }

 private:
  static constexpr double c1 = -0.5;
  static constexpr double c2 = value(std::uint64_t{0x3fd8000000000000});  // 3/8
  static constexpr double c3 = value(std::uint64_t{0xbfd4000000000000});  // -5/16
  static constexpr double c4 = value(std::uint64_t{0x3fd1800000000000});  // 35/128

  /// The high word of s between those of 2^-67 and 2^66.
  LUMEN_DEVICE static bool in_band(double s) {
    return bits(s) + 0xc440000000000000 < 0x0850000100000000;
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
