// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/exp/exp.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// x^y at float without a table: e^(y·ln x) for positive normal x and |y·ln x| <= 87.857. The
/// logarithm is 2·artanh((m - 1)/(m + 1)) in two words, m in [0.707, 1.414), with a polynomial of
/// degree 3 in the square of the quotient; the exponential is that of exp.
///
/// From |y·ln x| = 87.33654 on the exponential's scale is applied in two factors, with status 0:
/// results there may be denormal.
struct artanh_power_s {
  LUMEN_MAIN main_result<float> main(float x, float y) {
    const product a = exponent_of(x, y);
    const bool not_served = static_cast<std::int32_t>(bits(x) + 0x00800000u) < 0x01000000;
    const bool large = bits(fabs(a.first)) > natural_base_s::normal_limit;
    const bool scaled = bits(fabs(a.high)) > natural_base_s::normal_limit;
    return {factors::power(factors::of(a.high, a.low)), flag_if<float>(not_served, large, scaled)};
  }

  /// Writes the result of operands between the two limits.
  LUMEN_DEVICE static bool serve_band(float x, float y, float* r) {
    if (static_cast<std::int32_t>(bits(x) + 0x00800000u) < 0x01000000) return false;
    const product a = exponent_of(x, y);
    if (bits(fabs(a.first)) > 0x42afb6dfu) return false;  // 87.857
    const factors f = factors::of(a.high, a.low);
    const bool normal = bits(fabs(a.high)) <= natural_base_s::normal_limit;
    *r = normal ? factors::power(f) : factors::scaled_power(f);
    return true;
  }

 private:
  using factors = half_step_factors<natural_base_s>;

  /// y·ln x: the product of the leading word, and the whole in two words.
  struct product {
    float first;
    float high;
    float low;
  };

  LUMEN_MAIN product exponent_of(float x, float y) {
    const float fraction = value((bits(x) & 0x807fffffu) | 0x3f000000u);  // [0.5, 1)
    const auto field = static_cast<std::int32_t>(bits(x) >> 23);
    const bool small = fraction < value(0x3f350000u);  // 0.70703125
    const float m = select(small, fraction + fraction, fraction);
    const auto k = static_cast<float>(field - select(small, 127, 126));

    const float a = m + 1.0f;
    const float d = m - 1.0f;
    const float reciprocal = divide(1.0f, a);
    const float s = fma(d, reciprocal, 0.0f);
    float rest = fma(s, -2.0f, d);
    rest = fma(s, -d, rest);
    const float s_low = fma(reciprocal, rest, 0.0f);
    const float s2 = s * s;
    const float p = horner(s2, 0x3e046000u, 0x3e1166f0u, 0x3e4cd0b0u, 0x3eaaaaa8u);
    // The square and the cube of the quotient in two words.
    float square_low = fma(s, s, -s2);
    square_low = fma(s, s_low + s_low, square_low);
    const float cube = fma(s2, s, 0.0f);
    float cube_low = fma(s2, s, -cube);
    cube_low = fma(square_low, s, cube_low);
    cube_low = fma(s2, s_low, cube_low);
    float u = fma(p, cube_low, s_low);
    u = fma(p, cube, u);

    // Half the logarithm, the exponent's part exact in the leading word; then the whole.
    const float half_ln2 = value(0x3eb17218u);
    const float h = fma(half_ln2, k, s);
    const float h_low = s - fma(-half_ln2, k, h);
    const float g = fma(value(0xb082e308u), k, h_low + u);
    const float v = fma(2.0f, g, h + h);
    const float v_low = fma(2.0f, g, (h + h) - v);

    const float product_high = fma(v, y, 0.0f);
    float product_low = fma(v, y, -product_high);
    product_low = fma(v_low, y, product_low);
    const float high = product_high + product_low;
    return {product_high, high, (product_high - high) + product_low};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
