// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The logarithm of the modulus and the angle of a complex double without tables, in two words up
/// to the last sum.
#pragma once

#include <cstdint>

#include "scalar/atrig/arctangent_polynomial.hpp"
#include "scalar/atrig/bitwise_choice.hpp"
#include "scalar/complex/double_double.hpp"
#include "scalar/complex/ln_constants.hpp"
#include "scalar/complex/logarithm_parts.hpp"
#include "scalar/horner.hpp"
#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// ln of the modulus, times 2^offset. larger² + smaller² = 2^j (1 + t) with 1 + t in [√½, √2];
/// ln(1 + t)/2 = artanh f with f = t/(2 + t), of which only f itself is long.
LUMEN_MAIN double two_word_logarithm(const scaled_magnitudes& m, int offset) {
  const double_double mm = two_product(m.larger, m.larger);
  const double_double nn = two_product(m.smaller, m.smaller);
  const std::uint64_t j = (bits(mm.high + nn.high) - 0x3fe6a09e667f3bcdu) >> 52;
  const double scale = value(format<double>::one - (j << 52));
  const double_double excess =
      sum_of_squares_less_1({mm.high * scale, mm.low * scale}, {nn.high * scale, nn.low * scale});
  const double_double t = fast_two_sum(excess.high, excess.low);

  const double d = t.high + 2.0;
  const double d_low = (t.high - (d - 2.0)) + t.low;
  const double reciprocal = divide(1.0, d);
  const double f = t.high * reciprocal;
  const double f_low = (fma(-f, d, t.high) + fma(-f, d_low, t.low)) * reciprocal;
  const double w = f * f;
  const double rest = fma(horner_of(w, artanh_rest), w * f, f_low);

  // n ln 2/2; the product with the first word is exact.
  const double n = number_of(2 * m.field + j, 2 * format<double>::bias) + 2 * offset;
  const double high = n * value(0x3fd62e42fefa0000u);
  const double_double sum = fast_two_sum(high, f);
  return sum.high + (sum.low + fma(n, value(0x3d6cf79abc9e3b3au), rest));
}

/// The angle of (larger, smaller) plus the base of its quadrant, by the segments arctan k +
/// arctan((n - km)/(m + kn)) with k = 0, 1/2, 1; the numerator is exact, and so is the denominator
/// in its two words.
LUMEN_MAIN double two_word_angle(const quadrant<double>& p, const scaled_magnitudes& magnitudes) {
  const double m = magnitudes.larger, n = magnitudes.smaller;
  const auto second = mask_of<double>(n > 0.4375 * m), third = mask_of<double>(n > 0.6875 * m);
  const auto of_k = [=](std::uint64_t half, std::uint64_t one) {
    return value((second & ~third & half) | (third & one));
  };
  const double k = of_k(0x3fe0000000000000u, 0x3ff0000000000000u);
  const double first = of_k(0x3fddac670561bb4fu, 0x3fe921fb54442d18u);
  const double first_low = of_k(0x3c7a2b7f222f65e2u, 0x3c81a62633145c07u);
  const double above = fma(-k, m, n);
  const double below = fma(k, n, m);
  const double below_low = fma(k, n, m - below);
  const double reciprocal = divide(1.0, below);
  const double t = above * reciprocal;
  const double t_low = fma(-t, below_low, fma(-t, below, above)) * reciprocal;
  const double z = t * t;
  const double rest = fma(arctangent_rest_of_segment(z), z * t, t_low);

  const double base = base_of_reflected(p, pi_words<double>::half, pi_words<double>::whole);
  const double base_low =
      base_of_reflected(p, pi_words<double>::half_low, pi_words<double>::whole_low);
  const double_double inner = fast_two_sum(first, t);
  const double_double outer = fast_two_sum(base, inner.high);
  return outer.high + (outer.low + (inner.low + (rest + (first_low + base_low))));
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
