// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of the tangent at float.

#include "real.hpp"
#include "table.hpp"
#include "turns.hpp"

namespace arbor::lumen::tables {
namespace {

table reduction_rows() {
  table t{"internal_stan_la_reduction_data",
          "Row e, for the biased exponent e of a float: floor(2^96 frac(2^(e - 150)/(2 pi))), the\n"
          "first word the most significant one.",
          32,
          3,
          {}};
  const binary_digits turns = binary_digits::over_pi(0.5);
  for (int e = 0; e < 256; ++e) {
    for (int word = 0; word < 3; ++word) t.words.push_back(turns.word(e - 150 + 1 + 32 * word, 32));
  }
  return t;
}

/// The Taylor coefficients c0..c4 of tan at t, less those of 1/(b - r) for a pole at distance b.
std::vector<real> taylor(const real& t, bool near_pole, const real& b) {
  const real one(1.0), two(2.0), three(3.0);
  const real f = tan(t);
  const real d = one + f * f;
  std::vector<real> c = {f, d, f * d, d * (one + three * f * f) / three,
                         f * d * (two + three * f * f) / three};
  if (near_pole) {
    real power = one / b;
    for (real& x : c) {
      x = x - power;
      power = power / b;
    }
  }
  return c;
}

/// At the pole itself: those of 1/r - cot r.
std::vector<real> taylor_at_pole() {
  return {0.0, real::ratio(1, 3), 0.0, real::ratio(1, 45), 0.0};
}

table rows_of_128() {
  table t{
      "internal_stan_la_data",
      "Row j = 0..127, t = pi j/128: (B, Blo, tau, C0, C0lo, C1, C1b, C2, C3, C4) with B + Blo\n"
      "the distance pi/2 - t of the pole, tau 1 in the rows 32..95 and 0 elsewhere, and for\n"
      "|r| <= pi/256 tan(t + r) = tau/(B - r) + C0 + C0lo + (C1 + C1b) r + C2 r^2 + C3 r^3 + C4\n"
      "r^4. The coefficients are Taylor's, C1 a power of two; the one of r^3 at the pole is\n"
      "0.0222027 instead of 1/45, worth 5e-13 of the tangent.",
      32,
      10,
      {}};
  for (int j = 0; j < 128; ++j) {
    const real angle = real::ratio(j, 128) * real::pi();
    const real b = j == 64 ? real(0.0) : real::ratio(64 - j, 128) * real::pi();
    const bool near_pole = 32 <= j && j <= 95;
    const std::vector<real> c = j == 64 ? taylor_at_pole() : taylor(angle, near_pole, b);
    const real b_high(static_cast<double>(b.to_float()));
    const real c0_high(static_cast<double>(c[0].to_float()));
    const real c1_head = nearest_power_of_two(c[1]);
    t.words.insert(
        t.words.end(),
        {b.float_word(), (b - b_high).float_word(), near_pole ? 0x3f800000u : 0u, c[0].float_word(),
         (c[0] - c0_high).float_word(), c1_head.float_word(), (c[1] - c1_head).float_word(),
         c[2].float_word(), j == 64 ? 0x3cb5e28bu : c[3].float_word(), c[4].float_word()});
  }
  return t;
}

const registration stan("stan", [] { return std::vector<table>{reduction_rows(), rows_of_128()}; });

}  // namespace
}  // namespace arbor::lumen::tables
