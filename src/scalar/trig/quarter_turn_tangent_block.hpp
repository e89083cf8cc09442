// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/trig/fixed_turn_block.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The tangent of floats at `ha` by whole blocks: whether the results are in y. Sine and cosine of
/// the rest to the nearest quarter turn, and their quotient by a reciprocal in float and one step
/// of Newton's method in double.
struct quarter_turn_tangent_block : private fixed_turn_block {
  template <std::int64_t Length>
  static bool tangent(const float* __restrict x, float* __restrict y) {
    double t[Length], numerator[Length], denominator[Length];
    float p[Length], q[Length];
    for (std::int64_t i = 0; i < Length; ++i) {
      const double a = x[i];
      const double shifter = 0x1.8p51;  // to halves: n/2 quarter turns of pi/2
      const double shifted = fma(a, inverse_pi, shifter);
      const double r = rest(a, shifted - shifter);
      const double kept = cut(r, differ_in_sign(r, a));
      p[i] = static_cast<float>(kept);
      // The lowest bit says whether n is odd. Set before, it would decide ties.
      t[i] = value(bits(kept) | (bits(shifted) & 1));
    }
    loop_flag<float> out_of_range = 0;
    for (std::int64_t i = 0; i < Length; ++i) {
      out_of_range |= mark_if<float>(is_above_fixed_turn(x[i]));
      const float v = p[i] * p[i];
      p[i] = horner(v, 0x3da5e12bu, 0xbf196543u, 0x402335ddu);
      q[i] = horner(v, 0x3e6ce1b2u, 0xbfaae2beu, 0x4081e0eeu);
    }
    for (std::int64_t i = 0; i < Length; ++i) {
      const double v = t[i] * t[i];
      const double s2 = fma(static_cast<double>(p[i]), v, coefficient(0xc0a55de7u, 0));
      const double s1 = fma(s2, v, coefficient(0x40490fdbu, 0xb3bbc50au));
      const double sine = s1 * t[i];
      const double c2 = fma(static_cast<double>(q[i]), v, coefficient(0xc09de9e6u, 0xb3e646a5u));
      const double cosine = fma(c2, v, 1.0);
      const bool odd = (bits(t[i]) & 1) != 0;
      numerator[i] = select(odd, -cosine, sine);
      denominator[i] = select(odd, sine, cosine);
      q[i] = static_cast<float>(denominator[i]);
    }
    for (std::int64_t i = 0; i < Length; ++i) q[i] = divide(1.0f, q[i]);
    loop_flag<double> near_middle = 0;
    for (std::int64_t i = 0; i < Length; ++i) {
      const double c = q[i];
      const double quotient = numerator[i] * c;
      const double tangent = fma(quotient, fma(-denominator[i], c, 1.0), quotient);
      y[i] = static_cast<float>(tangent);
      near_middle |= mark_if<double>(is_near_middle(tangent));
    }
    return out_of_range == 0 && near_middle == 0;
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
