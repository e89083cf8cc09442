// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/pow/scaled_result.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/spow.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// |x|^y at float in double-word arithmetic, the rare path of `ep`; largest error 0.55 ulp,
/// denormal results included. Code 3 for an infinite result, code 4 for a zero one, none for
/// denormals.
///
/// The mantissa is multiplied by two factors, each from a table by the leading bits of the product
/// so far, until it is C(1 + e) with |e| < 2^-10.9, C = 1.44269 being close to 1/ln 2. What the
/// products round off is exact by fma, and kept. The logarithm is the sum of the exponent and the
/// two rows, and of a polynomial of degree 4 in the rest, whose coefficient of degree 1 is close to
/// 1.
struct two_stage_power {
  /// x finite and not 0, its sign ignored, y finite and not 0; `sign` is that of the result.
  LUMEN_DEVICE static std::uint32_t of(float x, float y, std::uint32_t sign, float* r) {
    const words l = log2_of(fabs(x));
    const float p = y * l.high;
    // |y·log2 x| is 256 or more, or so small that the power is 1. The product may overflow.
    if (!(fabs(p) < 256.0f)) {
      const bool down = (l.high < 0) != (y < 0);
      *r = value(sign | (down ? 0u : format<float>::special));
      return mask(down ? code::underflow : code::overflow);
    }
    if (fabs(p) < value(0x30800000u)) {  // 2^-30
      *r = value(sign | format<float>::one);
      return mask(code::none);
    }
    const float p_low = fma(y, l.high, -p) + y * l.low;
    const float shifter = value(0x48c00000u);  // 3·2^17, unit 1/32
    const float shifted = p + shifter;
    const float n = shifted - shifter;
    const float f = (p - n) + p_low;
    const auto steps = static_cast<std::int32_t>(bits(shifted) - bits(shifter));
    const std::uint32_t* root = table() + 293 + 2 * (steps & 0x1f);
    float g = coefficient(8);
    for (int k = 7; k >= 5; --k) g = mad(g, f, coefficient(k));
    const float root_low = value(root[0]);
    const float root_high = value(root[1]);
    *r = scaled_result(root_high, mad(g * f, root_high, root_low), steps >> 5, sign);
    if (*r == 0) return mask(code::underflow);
    return mask(is_infinite(*r) ? code::overflow : code::none);
  }

 private:
  struct words {
    float high;
    float low;
  };

  LUMEN_DEVICE static constexpr const std::uint32_t* table() { return __spow_ep_CoutTab; }

  /// Word 357 on: C, the polynomials of log2 and of the power of two from the lowest term up.
  LUMEN_DEVICE static constexpr float coefficient(int k) { return value(table()[357 + k]); }

  LUMEN_DEVICE static words log2_of(float x) {
    const bool denormal = bits(x) < 0x00800000u;
    const float scaled = denormal ? x * value(0x4b800000u) : x;  // 2^24
    const int exponent = static_cast<int>(bits(scaled) >> 23) - (denormal ? 151 : 127);
    const float m = value((bits(scaled) & format<float>::fraction) | format<float>::one);
    const auto i1 = static_cast<std::int32_t>(((bits(m) & 0x7e0000u) + 0x20000u) >> 18);
    const float c1 = value(table()[i1]);
    const float x1 = c1 * m;
    const float e1 = fma(c1, m, -x1);
    const auto i2 = static_cast<std::int32_t>(((bits(x1) & 0x7f000u) + 0x1000u) >> 13);
    const float c2 = value(table()[99 + i2]);
    const float x2 = x1 * c2;
    const float e2 = fma(x1, c2, -x2) + e1 * c2;
    const float d = x2 - coefficient(0);  // exact

    const std::uint32_t* row1 = table() + 33 + 2 * i1;
    const std::uint32_t* row2 = table() + 164 + 2 * i2;
    const float a = static_cast<float>(exponent) + value(row1[0]);  // exact
    const float b = a + value(row2[0]);
    const float b_low = (a - b) + value(row2[0]);
    const float t = d + e2;
    const float t_low = (d - t) + e2;
    float q = coefficient(4);
    for (int k = 3; k >= 1; --k) q = mad(q, t, coefficient(k));
    const float s = b + t;
    const float rows_low = (value(row1[1]) + value(row2[1])) + b_low;
    const float low = mad(q, t, ((b - s) + t) + (rows_low + t_low));
    const float high = s + low;
    return {high, low - (high - s)};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
