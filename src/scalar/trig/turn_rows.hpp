// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The reduction of doubles of every size to one of 512 steps of the turn, by a row of 192 bits of
/// 1/(2 pi) for each exponent; and sine and cosine from there, by a row of a table for each step.
#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dsin.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// x = 2 pi step/512 + (rest + rest_low), but for full turns; |rest| <= pi/512 and a little. Of a
/// negative x step and rest are negative: the step is modulo 512.
struct turn_step {
  std::int32_t step;
  double rest;
  double rest_low;

  /// For finite x.
  LUMEN_MAIN turn_step nearest(double x) {
    const std::uint64_t sign = sign_bit(x);
    const fraction f = fraction_of_turn(fabs(x));
    const double v = value((f.first >> 12) | format<double>::one | sign);  // ±(1 + the turn)
    const double shifter = value(0x42a8000000000000u);                     // 3·2^42, unit 1/512
    const double u = v + shifter;
    const double h = v - (u - shifter);
    const double g2 = digits(f.second, 0x3cb0000000000000u | sign);  // 2^-52
    const double g1 = digits(f.third, 0x3970000000000000u | sign);   // 2^-104
    const double s = h + g2;
    const double t = ((h - s) + g2) + g1;
    const double two_pi = value(0x401921fb54442d18u);
    const double z = fma(s, two_pi, 0.0);
    const double error = fma(s, two_pi, -z);
    const double z_low = fma(t, two_pi, fma(s, value(0x3cb1a62633145c07u), error));
    return {static_cast<std::int32_t>(bits(u) & 511u), z, z_low};
  }

 private:
  /// 128 bits of frac(a/(2 pi)): the first 64, of which 52 are read here, then 52 and 24 as the
  /// fractions of doubles.
  struct fraction {
    std::uint64_t first;
    std::uint64_t second;
    std::uint64_t third;
  };

  /// The double of the exponent in `unit` with that fraction, less 1 of its exponent.
  LUMEN_MAIN double digits(std::uint64_t fraction, std::uint64_t unit) {
    return value(fraction | unit) - value(unit);
  }

  /// The 53 bits of a by its row, in digits of 32 bits. What is above the turn does not count, and
  /// products below the sixth digit only by their carry.
  LUMEN_MAIN fraction fraction_of_turn(double a) {
    const std::uint64_t* row = internal_dsin_la_reduction_data + 3 * (bits(a) >> 52);
    const std::uint64_t m_high = ((bits(a) >> 32) & 0x000fffffu) | 0x00100000u;
    const std::uint64_t m_low = bits(a) & low_half;
    const std::uint64_t w0 = row[0] >> 32, w1 = row[0] & low_half, w2 = row[1] >> 32,
                        w3 = row[1] & low_half, w4 = row[2] >> 32, w5 = row[2] & low_half;
    const std::uint64_t c4 = m_high * w4 + ((m_low * w4) >> 32);
    const std::uint64_t c3 = m_high * w3 + ((m_low * w3) >> 32);
    const std::uint64_t c2 = m_high * w2 + ((m_low * w2) >> 32);
    const std::uint64_t c1 = m_high * row[0] + ((m_low * w1) >> 32);
    const std::uint64_t d3 = ((m_low * w3) & low_half) + c4;
    const std::uint64_t d2 = ((m_low * w2) & low_half) + c3;
    const std::uint64_t d1 = ((m_low * w1) & low_half) + c2;
    const std::uint64_t d0 = m_low * w0 + c1;
    const std::uint64_t e3 = ((m_high * w5) >> 32) + d3;
    const std::uint64_t e2 = (e3 >> 32) + d2;
    const std::uint64_t e1 = (e2 >> 32) + d1;
    const std::uint64_t next = (e2 << 32) | (e3 & 0xff000000u);
    return {e1 + (d0 << 32), ((e1 << 40) & 0x000fff0000000000u) | (next >> 24),
            (e3 << 28) & 0x000ffffff0000000u};
  }

  static constexpr std::uint64_t low_half = 0xffffffffu;
};

/// The sine of 2 pi (step + shift)/512 + rest, within 0.51 ulp; with a shift of a quarter turn,
/// 128, the cosine of the argument.
LUMEN_MAIN double sine_of_step(const turn_step& a, std::int32_t shift) {
  const std::uint64_t* row = internal_dsin_la_data_ha + 4 * ((a.step + shift) & 511);
  // H + D is the derivative of S + T; H is a power of two, so that z H is exact.
  const double d = value(row[0]), h = value(row[1]), s = value(row[2]), t = value(row[3]);
  const double z = a.rest;
  const double first = fma(z, h, s);
  const double sum = fma(d, z, first);
  const double error = fma(d, z, first - sum) + fma(z, h, s - first);
  const double w = z * z;
  const double ps = (fma(value(0x3f81110fabb3551cu), w, value(0xbfc5555555554448u)) * w) * z;
  const double c = d + h;
  const double pc = horner(w, 0xbf56c16ab163b2d7u, 0x3fa5555555554ccfu, 0xbfe0000000000000u) * w;
  const double higher = fma(pc, s, fma(ps, c, error));
  const double of_low = fma(a.rest_low, fma(-z, s, c), t);
  return sum + (higher + of_low);
}

/// NaNs and infinities of the bodies that reduce by rows: 0·x with code 1 for an infinity.
LUMEN_DEVICE inline std::uint32_t product_of_special(double x, double* y) {
  *y = is_nan(x) ? x * x : 0.0 * x;
  return mask(is_nan(x) ? code::none : code::domain);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
