// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/complex/careful_magnitude.hpp"
#include "scalar/ops.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dhypot.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The root of a sum of squares from 1 to below 8, in two words; half of it if the sum is
/// quartered.
struct hypot_root {
  double_double words;
  bool quartered;

  /// s, the sum or a quarter of it, is below 4. A row of the table gives T close to 1/sqrt(s) and
  /// its square, both short; e = 1 - T²s, |e| < 2^-6, and sqrt(s) = Ts·(1 - e)^(-1/2) by the series
  /// to degree 9, the product Ts in two words.
  LUMEN_MAIN hypot_root of(double_double sum) {
    const bool quartered = sum.high >= 4.0;
    const double unit = select(quartered, 0.25, 1.0);
    const double_double s = {sum.high * unit, sum.low * unit};
    // The lowest bit of the exponent, which is 1 from 1 to 2, and seven bits of the fraction.
    const auto row = static_cast<std::int32_t>((bits(s.high) >> 45) & 0xff) ^ 0x80;
    const double t = value(_arrdHypotHATab[2 * row]);
    const double square = value(_arrdHypotHATab[2 * row + 1]);
    const double e = fma(-square, s.high, 1.0) - square * s.low;
    // (1 - e)^(-1/2) = 1 + e·p.
    const double p = horner(e, 0x3fc7bd8000000000u, 0x3fc9230000000000u, 0x3fcad00000000000u,
                            0x3fcce00000000000u, 0x3fcf800000000000u, 0x3fd1800000000000u,
                            0x3fd4000000000000u, 0x3fd8000000000000u, 0x3fe0000000000000u);
    const double_double product = two_product(t, s.high);
    const double rest = fma(product.high, e * p, fma(t, s.low, product.low));
    return {fast_two_sum(product.high, rest), quartered};
  }
};

/// sqrt(a² + b²) of finite numbers that are not both zero, of any size: within 0.51 ulp, denormal
/// results included.
LUMEN_DEVICE inline double careful_hypot(double a, double b) {
  const scaled_sum squares = scaled_sum_of_squares(a, b);
  const hypot_root root = hypot_root::of(squares.sum);
  return scaled_back(root.words, squares.exponent + (root.quartered ? 1 : 0));
}

/// The same of any numbers without a branch, or a flag: for denormals, infinities and NaNs, and
/// where the result may overflow.
LUMEN_MAIN main_result<double> normal_hypot(double a, double b) {
  constexpr int fraction_bits = format<double>::fraction_bits;
  const std::uint64_t ax = bits(fabs(a)), bx = bits(fabs(b));
  const std::uint64_t larger = select(ax > bx, ax, bx);
  const std::uint64_t smaller = select(ax > bx, bx, ax);
  const double m = value((larger & format<double>::fraction) | format<double>::one);
  const double n = value((smaller & format<double>::fraction) | format<double>::one);
  // Further down the smaller counts as a sticky bit only.
  const std::uint64_t distance = (larger >> fraction_bits) - (smaller >> fraction_bits);
  const std::uint64_t down = select(distance < 200, distance, std::uint64_t{200});
  const double scale = value(format<double>::one - (down << fraction_bits));
  const double scaled = select(smaller == 0, 0.0, n * scale);
  const double_double sum = sum_of_products(two_product(m, m), two_product(scaled, scaled));
  const hypot_root root = hypot_root::of(fast_two_sum(sum.high, sum.low));
  constexpr std::uint64_t twice = std::uint64_t{1} << fraction_bits;
  const std::uint64_t exponent = (larger & format<double>::special) - format<double>::one +
                                 select(root.quartered, twice, std::uint64_t{0});
  constexpr std::uint64_t too_large = format<double>::special - twice;
  constexpr std::uint64_t denormals = format<double>::fraction;
  const double result = value(bits(root.words.high) + exponent);
  return {select(larger == 0, 0.0, result),
          flag_if<double>(larger - 1 < denormals, smaller - 1 < denormals, larger >= too_large)};
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
