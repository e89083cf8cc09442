// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/exp/exp.hpp"
#include "scalar/horner.hpp"
#include "scalar/log/reduction.hpp"
#include "scalar/pow/nolut_polynomial.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The form that serves a tier: `ha` has one of its own, `la` and `ep` share one.
constexpr tier nolut_form(tier t) { return t == tier::ha ? tier::ha : tier::la; }

/// x^y at double without a table: for positive normal x and |y·ln x| < 708.396.
///
/// R, the integer of 4..8 next to the reciprocal of the mantissa, leaves t with |t| <= 1/9; its
/// logarithm comes out of three selects and holds the exponent's bias. ln(1 + t) has its first two
/// terms and the leading part of the third one in two words, and a polynomial of degree 16 for the
/// rest, of degree 18 at `ha`. The sum is in two words, exact in the exponent's part. The
/// exponential is that of exp.
template <tier t>
struct nolut_power_d {
  static constexpr int interleave = 4;

  LUMEN_MAIN main_result<double> main(double x, double y) {
    const words l = ln_of(x);
    const double p = fma(y, l.high, 0.0);
    double p_low = fma(y, l.high, -p);
    p_low = fma(y, l.low, p_low);
    const double high = p + p_low;
    const double low = (p - high) + p_low;
    const auto power = half_step_factors_d<t>::of(high, low);
    const double scale = value(power.scale);
    const bool large = (bits(high) & format<double>::magnitude) >= 0x4086232b00000000u;
    return {fma(scale, power.rest, scale), flag_if<double>(not_positive_normal(x), large)};
  }

 private:
  struct words {
    double high;
    double low;
  };

  /// -ln(R/8) - 1023 ln 2 for R = 4..8, with the two words of ln 2 that the exponent is multiplied
  /// by.
  LUMEN_MAIN words row_of(double integer) {
    const bool is_4 = integer == 4.0;
    const bool is_8 = integer == 8.0;
    const bool low_bit = (integer == 5.0) | (integer == 7.0);
    const bool above_5 = integer > 5.0;
    const std::uint64_t high_odd = select(above_5, 0xc08627a5f55256f4u, 0xc08624f4dcf7348du);
    const std::uint64_t high_even = select(is_4, 0xc086232bdd7abae4u, 0xc086266a41f852d7u);
    const std::uint64_t high = select(low_bit, high_odd, high_even);
    const std::uint64_t low_odd = select(above_5, 0xbdcee71edfaeeae4u, 0xbdceedff94235c6bu);
    const std::uint64_t low_even = select(is_4, 0xbdcee3dde7fd844cu, 0xbdcee475cd6a9f39u);
    const std::uint64_t low = select(low_bit, low_odd, low_even);
    return {value(select<std::uint64_t>(is_8, 0xc08628b76e3a7972u, high)),
            value(select<std::uint64_t>(is_8, 0xbdceeb9abde27626u, low))};
  }

  LUMEN_MAIN words ln_of(double x) {
    const double m = mantissa_at(0x3fc0000000000000u, x);  // 2^-3
    const auto integer = static_cast<double>(rint(quick_reciprocal(m)));
    const words row = row_of(integer);
    const double exponent = small_integer(bits(x) >> 52);
    const double r = fma(integer, m, -1.0);
    const double q = polynomial(r);
    // r - r²/2 = u + l.
    const double h = r * 0.5;
    const double u = fma(-r, h, r);
    const double l = fma(-r, h, r - u);
    // (r²/2)·(2r/3 + …) = cubic + cubic_low.
    const double two_thirds_constant = value(0x3fe5555555555555u);
    const double g = fma(two_thirds_constant, r, 0.0);
    const double g_low = fma(two_thirds_constant, r, -g);
    const double third = fma(q, r, g_low);
    const double square = fma(r, h, 0.0);
    const double square_low = fma(r, h, -square);
    const double cubic = fma(square, g, 0.0);
    double cubic_low = fma(square, g, -cubic);
    cubic_low = fma(square_low, g, cubic_low);
    cubic_low = fma(square, third, cubic_low);

    const double a = fma(exponent, value(0x3fe62e42fefa3800u), row.high);  // exact
    const double a_low = fma(exponent, value(0x3d2ef35793c76800u), row.low);
    const double s1 = a + u;
    const double t1 = (a - s1) + u;
    const double s2 = s1 + cubic;
    const double t2 = (s1 - s2) + cubic;
    const double low = ((a_low + l) + (t1 + t2)) + cubic_low;
    const double high = s2 + low;
    return {high, (s2 - high) + low};
  }

  LUMEN_MAIN double polynomial(double r) {
    if constexpr (t == tier::ha) {
      double p = value(nolut_power_polynomial[0]);
      for (int k = 1; k < 16; ++k) p = fma(p, r, value(nolut_power_polynomial[k]));
      return p;
    } else {
      return horner(r, 0xbfc0eb775ed0d53fu, 0x3fc1ea5c772d0f69u, 0xbfc243278b687c88u,
                    0x3fc3ac83f2e91adfu, 0xbfc55569367812bfu, 0x3fc745de6106c97eu,
                    0xbfc99999760c1f82u, 0x3fcc71c70a4bb945u, 0xbfd00000001076dau,
                    0x3fd24924924f345du, 0xbfd5555555554e88u, 0x3fd9999999999815u,
                    0xbfe0000000000000u, 0x3c8751507e77d245u);
    }
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
