// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/trig/fixed_turn_block.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// `half_turn_sine` by whole blocks: whether the results are in y.
struct half_turn_sine_block : private fixed_turn_block {
  template <std::int64_t Length>
  static bool sine(const float* __restrict x, float* __restrict y) {
    double t[Length];
    float u[Length];
    for (std::int64_t i = 0; i < Length; ++i) {
      const double a = x[i];
      const double shifted = fma(a, inverse_pi, shifter);
      const double r = rest(a, shifted - shifter);
      t[i] = value(bits(cut(r, differ_in_sign(r, a))) ^ (bits(shifted) << 63));
      u[i] = static_cast<float>(t[i]);
    }
    loop_flag<float> unserved = 0;
    for (std::int64_t i = 0; i < Length; ++i) {
      unserved |= mark_if<float>(is_above_fixed_turn(x[i]));
      u[i] = polynomial(u[i]);
    }
    return round_sines<Length>(t, u, y) && unserved == 0;
  }

  template <std::int64_t Length>
  static bool cosine(const float* __restrict x, float* __restrict y) {
    double t[Length];
    float u[Length];
    for (std::int64_t i = 0; i < Length; ++i) {
      const double a = fabs(static_cast<double>(x[i]));
      const double shifted = fma(a, inverse_pi, -0.5) + shifter;
      const double r = rest_of_next_quarter(a, shifted - shifter);
      t[i] = value(bits(cut(r, r < 0)) ^ (~bits(shifted) << 63));
      u[i] = static_cast<float>(t[i]);
    }
    loop_flag<float> unserved = 0;
    for (std::int64_t i = 0; i < Length; ++i) {
      unserved |= mark_if<float>(is_above_fixed_turn(x[i]));
      unserved |= mark_if<float>(is_short_of_one(x[i]));
      u[i] = polynomial(u[i]);
    }
    return round_sines<Length>(t, u, y) && unserved == 0;
  }

 private:
  static constexpr double shifter = 0x1.8p52;

  /// Arguments below 2^-12 at which the polynomial does not round to 1.
  LUMEN_MAIN bool is_short_of_one(float x) {
    constexpr std::uint32_t first = 0x397496b1;
    return bits(fabs(x)) - first < fixed_turn_range::lowest - first;
  }

  LUMEN_MAIN float polynomial(float u) {
    return horner(u * u, 0xbbe61a2du, 0x3da807fcu, 0xbf196889u, 0x402335e0u);
  }

  /// sin(pi t) with the polynomial of the highest terms in p. Inlined, where t and p are known to
  /// lie apart from y.
  template <std::int64_t Length>
  [[gnu::always_inline]] static inline bool round_sines(const double* t, const float* p, float* y) {
    loop_flag<double> near_middle = 0;
    for (std::int64_t i = 0; i < Length; ++i) {
      const double v = t[i] * t[i];
      const double c2 = fma(static_cast<double>(p[i]), v, coefficient(0xc0a55de7u, 0xb39e345au));
      const double c1 = fma(c2, v, coefficient(0x40490fdbu, 0xb3bbe1b6u));
      const double sine = c1 * t[i];
      y[i] = static_cast<float>(sine);
      near_middle |= mark_if<double>(is_near_middle(sine));
    }
    return near_middle == 0;
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
