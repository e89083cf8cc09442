// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/complex/careful_magnitude.hpp"
#include "scalar/ops.hpp"
#include "scalar/tables/dhypot.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// sqrt(a² + b²) of finite numbers that are not both zero, of any size: within 0.51 ulp, denormal
/// results included.
///
/// The sum of squares is s·4^n, s in [1, 4) in two words. A row of the table gives T close to
/// 1/sqrt(s) and its square, both short; e = 1 - T²s, |e| < 2^-6, and sqrt(s) = Ts·(1 - e)^(-1/2)
/// by the series to degree 9, the product Ts in two words.
LUMEN_DEVICE inline double careful_hypot(double a, double b) {
  const scaled_sum squares = scaled_sum_of_squares(a, b);
  const int quarter = squares.sum.high >= 4.0 ? 1 : 0;
  const double unit = quarter != 0 ? 0.25 : 1.0;
  const double_double s = {squares.sum.high * unit, squares.sum.low * unit};
  // The lowest bit of the exponent, which is 1 from 1 to 2, and seven bits of the fraction.
  const auto row = static_cast<std::int32_t>((bits(s.high) >> 45) & 0xff) ^ 0x80;
  const double t = value(_arrdHypotHATab[2 * row]);
  const double e = fma(-value(_arrdHypotHATab[2 * row + 1]), s.high, 1.0) -
                   value(_arrdHypotHATab[2 * row + 1]) * s.low;
  // (1 - e)^(-1/2) = 1 + e·p.
  const double p = horner(e, 0x3fc7bd8000000000u, 0x3fc9230000000000u, 0x3fcad00000000000u,
                          0x3fcce00000000000u, 0x3fcf800000000000u, 0x3fd1800000000000u,
                          0x3fd4000000000000u, 0x3fd8000000000000u, 0x3fe0000000000000u);
  const double_double product = two_product(t, s.high);
  const double rest = fma(product.high, e * p, fma(t, s.low, product.low));
  return scaled_back(fast_two_sum(product.high, rest), squares.exponent + quarter);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
