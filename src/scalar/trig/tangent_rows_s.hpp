// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/protocol.hpp"
#include "scalar/tables/stan.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// tan of a float a >= 0 of the rare path: a row of 96 bits of 1/(2 pi) for its exponent,
/// multiplied by its mantissa in parts of 16 bits, gives the place in the turn; a row of a table
/// for one of 256 steps of the turn gives tan(t + r). Within 1.5 ulp.
struct tangent_rows_s {
  LUMEN_DEVICE static float tangent(float a) {
    const step s = nearest_step(a);
    const std::uint32_t* row = internal_stan_la_data + 10 * s.row;
    const float b = value(row[0]), tau = value(row[2]), c0 = value(row[3]), c1 = value(row[5]);
    const reciprocal inverse = of_pole(b, value(row[1]), s.r);

    // tau R + c0 + c1 r, of which the last product is exact, and what the sums round away.
    const float line = c1 * s.r;
    const float pole = tau * inverse.high;
    const float_pair first = two_sum(c0, line);
    const float_pair sum = two_sum(pole, first.high);
    const float low = fma(tau, inverse.low, value(row[4]) + (first.low + sum.low));

    const float square = s.r * s.r;
    const float p =
        fma(square, fma(value(row[9]), s.r, value(row[8])), fma(value(row[7]), s.r, value(row[6])));
    return sum.high + fma(p, s.r, low);
  }

 private:
  struct float_pair {
    float high;
    float low;
  };
  LUMEN_DEVICE static float_pair two_sum(float a, float b) {
    const float s = a + b;
    const float b_part = s - a;
    return {s, (a - (s - b_part)) + (b - b_part)};
  }

  /// a = 2 pi row/256 + r, but for half turns.
  struct step {
    std::int32_t row;  ///< 0..127
    float r;
  };

  LUMEN_DEVICE static step nearest_step(float a) {
    const std::uint32_t* w = internal_stan_la_reduction_data + 3 * (bits(a) >> 23);
    const std::uint32_t m_high = ((bits(a) >> 16) & 0x7fu) | 0x80u;
    const std::uint32_t m_low = bits(a) & 0xffffu;
    // The product's digits, of 16 bits, from the fifth up, those of m_high·w one place higher; the
    // carries are added on the way. What is above the first two does not count.
    const std::uint32_t w0 = w[0] >> 16, w1 = w[0] & 0xffffu, w2 = w[1] >> 16, w3 = w[1] & 0xffffu,
                        w4 = w[2] >> 16, w5 = w[2] & 0xffffu;
    const std::uint32_t c4 = m_high * w4 + ((m_low * w4) >> 16);
    const std::uint32_t c3 = m_high * w3 + ((m_low * w3) >> 16);
    const std::uint32_t c2 = m_high * w2 + ((m_low * w2) >> 16);
    const std::uint32_t c1 = m_high * w[0] + ((m_low * w1) >> 16);
    const std::uint32_t d3 = ((m_low * w3) & 0xffffu) + c4;
    const std::uint32_t d2 = ((m_low * w2) & 0xffffu) + c3;
    const std::uint32_t d1 = ((m_low * w1) & 0xffffu) + c2;
    const std::uint32_t d0 = m_low * w0 + c1;
    const std::uint32_t e3 = ((m_high * w5) >> 16) + d3;
    const std::uint32_t e2 = (e3 >> 16) + d2;
    const std::uint32_t e1 = (e2 >> 16) + d1;
    const std::uint32_t turn = e1 + (d0 << 16);              // frac(a/(2 pi)) 2^32
    const std::uint32_t next = (e2 << 16) | (e3 & 0xffffu);  // the following 32 bits
    const float v = value((turn >> 9) | 0x3f800000u);        // 1 + the turn
    const float u = v + value(0x47400000u);                  // 3·2^14, unit 1/256
    const float h = v - (u - value(0x47400000u));
    const std::uint32_t middle = ((turn << 14) & 0x007fc000u) | (next >> 18);
    const float g2 = value(middle | 0x34000000u) - value(0x34000000u);  // 2^-23
    const float g1 =
        value(((next << 5) & 0x007fffe0u) | 0x28800000u) - value(0x28800000u);  // 2^-46
    const float s = h + g2;
    const float t = ((h - s) + g2) + g1;
    const float two_pi = value(0x40c90fdbu);
    const float z = fma(s, two_pi, 0.0f);
    const float z_low = fma(t, two_pi, fma(s, value(0xb43bbd2eu), fma(s, two_pi, -z)));
    return {static_cast<std::int32_t>(bits(u) & 127u), z_low + z};
  }

  /// 1/((b + b_low) - r) to 36 bits: a short reciprocal R of a short divisor d, and
  /// R e (1 + ...) for what both leave.
  struct reciprocal {
    float high;
    float low;
  };

  LUMEN_DEVICE static reciprocal of_pole(float b, float b_low, float r) {
    const float d = b - r;
    const float d_short = value(bits(d) & 0xfffff000u);
    const float d_rest = ((b - d) - r) + ((d - d_short) + b_low);
    const float high = value(bits(divide(1.0f, d_short)) & 0xfffff000u);
    const float e = fma(-d_short, high, 1.0f);
    const float full = fma(high, e, high) * fma(e, e, 1.0f);
    const float f = d_rest * full;
    return {high, fma(f, f, -(f - e)) * full};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
