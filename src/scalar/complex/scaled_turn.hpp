// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// e^x (cos y + i sin y) at double, to the last bit but a part of a unit, for all that is finite.
#pragma once

#include <complex>
#include <cstdint>

#include "scalar/complex/double_double.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/trig/fixed_turn.hpp"
#include "scalar/trig/parity.hpp"
#include "scalar/trig/quarter_turn.hpp"
#include "scalar/trig/quarter_turn_kernels.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Below 2^24 the half turns that the short reduction counts have a product with the second part of
/// pi that is exact.
LUMEN_MAIN bool is_short_turn(double a) { return a < value(0x4170000000000000u); }

/// The real and the imaginary part of a number on the unit circle, from those of the rest to the
/// nearest quarter turn and the number of these.
LUMEN_MAIN double real_of_turn(std::uint64_t quarters, double cosine, double sine) {
  const double c = select(is_odd(quarters), sine, cosine);
  return value(bits(c) ^ (((quarters << 62) ^ (quarters << 63)) & format<double>::sign));
}
LUMEN_MAIN double imaginary_of_turn(std::uint64_t quarters, double cosine, double sine, double y) {
  const double s = select(is_odd(quarters), cosine, sine);
  return value(bits(s) ^ (((quarters << 62) ^ bits(y)) & format<double>::sign));
}

/// e^x as (1 + r + rest) times 2^(1/2) if `odd`, and two powers of two that make up its exponent
/// less that of `reserve`: a number multiplied by the reserve, the factors, and then the powers
/// is rounded only in the last step, whether it is denormal at the start or at the end.
struct scaled_exponential {
  double r;
  double rest;
  std::uint64_t odd;  ///< all bits set, or none
  double first;
  double second;

  static constexpr std::uint64_t reserve = 0x4c70000000000000;  // 2^200

  /// For -1200 <= x <= 1500: beyond, every product with a sine or a cosine has left the range.
  LUMEN_MAIN scaled_exponential of(double x) {
    const double shifter = value(0x4328000000000e6cu);  // unit 1/2, 3·2^50 + 2·1023 - 200
    const double shifted = fma(x, value(0x3ff71547652b82feu), shifter);
    const double n = shifted - shifter;
    const double exact = fma(value(0xbfe62e42fefa39efu), n, x);
    const double r = fma(value(0xbc7abc9e3b39803fu), n, exact);
    const double r_low = fma(value(0xbc7abc9e3b39803fu), n, exact - r);
    const double p = horner(r, 0x3ec722bccc270959u, 0x3efa072e44b58159u, 0x3f2a019f7560fba3u,
                            0x3f56c16b8144bd5bu, 0x3f811111111ac486u, 0x3fa55555556228ceu,
                            0x3fc5555555555462u, 0x3fdffffffffffe76u);
    const std::uint64_t halves = bits(shifted) & 0x1fffu;
    const std::uint64_t fields = halves >> 1;
    const std::uint64_t half = fields >> 1;
    return {r, fma(p, r * r, r_low), 0u - (halves & 1u), value(half << 52),
            value((fields - half) << 52)};
  }

  /// e^x (s.high + s.low).
  LUMEN_DEVICE double times(double_double s) const {
    const double high = s.high * value(reserve), low = s.low * value(reserve);
    const double_double product = two_product(high, r);
    const double_double sum = fast_two_sum(high, product.high);
    const double sum_low = sum.low + (product.low + fma(high, rest, fma(low, r, low)));
    const double root = value(format<double>::one ^ (odd & 0x0006a09e667f3bcdu));  // √2
    const double root_low = value(odd & 0xbc9bdd3413b26456u);
    const double_double scaled = two_product(sum.high, root);
    const double scaled_low = fma(sum_low, root, fma(sum.high, root_low, scaled.low));
    return (scaled.high + scaled_low) * first * second;
  }
};

/// e^x (cos y + i sin y) for y = quarters pi/2 + (rest + rest_low) but for its sign, within 0.85
/// ulp.
LUMEN_MAIN std::complex<double> scaled_turn(double x, double y, std::uint64_t quarters, double rest,
                                            double rest_low) {
  const double z = rest * rest;
  const double q = quarter_turn_series::of_sine(z) * z;
  const double b = fma(-rest, rest, 2.0);
  const double_double sine = fast_two_sum(rest, fma(rest, q, rest_low * (b * 0.5)));
  const double error = fma(fma(rest, rest, b - 2.0), 0.5, rest * rest_low);
  const double_double cosine =
      fast_two_sum(b * 0.5, fma(z, quarter_turn_series::of_cosine(z) * z, -error));
  const auto e = scaled_exponential::of(x);
  const double c = e.times(cosine), s = e.times(sine);
  return {real_of_turn(quarters, c, s), imaginary_of_turn(quarters, c, s, y)};
}

/// e^x (cos y + i sin y) for all finite x and y.
LUMEN_DEVICE inline std::complex<double> careful_turn(double x, double y) {
  const double below = x < 1500.0 ? x : 1500.0;
  const double clamped = below > -1200.0 ? below : -1200.0;
  const double a = fabs(y);
  if (is_short_turn(a)) {
    const auto s = short_quarter_turn::by_products(a);
    return scaled_turn(clamped, y, s.quarters, s.rest, s.rest_low);
  }
  const auto s = quarter_turn::nearest(a);
  return scaled_turn(clamped, y, s.quarters, s.rest, s.rest_low);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
