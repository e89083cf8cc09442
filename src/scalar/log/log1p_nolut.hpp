// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// log1p at double whose main path has no table.
#pragma once

#include <cstdint>

#include "scalar/log/log1p_nolut_constants.hpp"
#include "scalar/log/log1p_parts.hpp"
#include "scalar/log/reduction.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// 1 + x = 2^exponent·(1 + r), 1 + r in [3/4, 3/2), all exact; and the coarse factor 1/(1 - k) of
/// 1 + r, k a multiple of 3/32, so that (1 + r)(1 - k) = 1 - a with |a| < 1/8.
struct coarse_factor {
  double exponent;
  double r;
  double k;
  double a;
  double first_order;  ///< k - a, which is r(1 - k)

  LUMEN_MAIN coarse_factor of(double x) {
    const double eighth = fma(0.125, x, 0.0) + 0.125;  // (1 + x)/8
    const double to_one = reciprocal_power(eighth);
    const double z = fma(to_one, eighth, 0.0) + 0.5;
    const double scale = fma(reciprocal_power(z), fma(to_one, 0.125, 0.0), 0.0);
    // 1573890 and a double whose last bits before the point are the exponent field of 8·scale.
    const double field = value((bits(fma(scale, 8.0, 0.0)) >> 20) | 0x4138000000000000u);
    const double r = fma(scale, x, -(1.0 - scale));
    const double shifter = value(0x4308000000000000u);  // 3·2^48, unit 1/8
    const double k = fma((r + shifter) - shifter, 0.75, 0.0);
    return {value(0x4138040200000000u) - field, r, k, fma(r, k, k - r), fma(r, 1.0 - k, 0.0)};
  }

 private:
  /// A power of two that brings v, a positive normal number below 2^1023, to [1, 2).
  LUMEN_MAIN double reciprocal_power(double v) {
    return value(0x7fe0000000000000u - (bits(v) & format<double>::special));
  }
};

/// -ln(1 - k)/k² - 1/k at the multiples of 3/32 in [-3/16, 3/8].
LUMEN_MAIN double rest_of_coarse_factor(double k) {
  const double k2 = fma(k, k, 0.0);
  double a = fma(k2, value(0x3fd2d69f78622232u), value(0x3fc8c588ce05a097u));
  double b = fma(k2, value(0x3fc2896ff3f66bbdu), value(0x3fd013265a806008u));
  a = fma(k2, a, value(0x3fd55613246dd7cfu));
  b = fma(k2, b, value(0x3fdfffdc599639e8u));
  return fma(k, a, b);
}

/// What the main paths of the tiers share with log1p_d: the range and the rare path.
template <typename Body, tier t>
struct log1p_nolut_paths : scalar_v11<Body, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    return {or_sign(Body::logarithm(coarse_factor::of(x)), x),
            flag_if<double>(is_outside(x, 0xbfefffffffffffffu, 0x7fefffffffffffffu))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    return breakpoint_log<natural_path_d>(x + 1.0, y, log1p_rare_table<t>());
  }
};

/// log1p, double, without a table on the main path; `la` and `ep` are one body but for the name of
/// the rare path's table. Special values as log1p_d. Largest error 1.7 ulp.
template <tier t>
struct log1p_d_nolut : log1p_nolut_paths<log1p_d_nolut<t>, t> {
  LUMEN_MAIN double logarithm(const coarse_factor& f) {
    const double k2 = fma(f.k, f.k, 0.0);
    const double a2 = fma(f.a, f.a, 0.0);
    const double a4 = fma(a2, a2, 0.0);
    double d1 = fma(a4, value(0xbfbabc3280883f85u), value(0xbfc00011b12ec07fu));
    double d2 = fma(a4, value(0x3fb7569b705ccf22u), value(0x3fc2492404508eb2u));
    double d3 = fma(a4, value(0xbfb98321c986c73fu), value(0xbfc5555548c81da2u));
    const double d4 = fma(a4, value(0x3fbc725277fd96beu), value(0x3fc9999999f242c7u));
    d1 = fma(a4, d1, value(0xbfd000000001dd61u));
    d2 = fma(a4, d2, value(0x3fd5555555554d65u));
    d3 = fma(a4, d3, value(0xbfdfffffffffffd9u));
    const double m = fma(a2, d1, d3);
    const double n = fma(a2, d4, d2);
    // ln(1 - a) + a; the odd terms are those of -a.
    const double q = fma(fma(-f.a, n, m), a2, 0.0);
    const double sum = f.first_order + fma(rest_of_coarse_factor(f.k), k2, q);
    return fma(f.exponent, value(0x3fe62e42fefa39efu), sum);
  }
};

/// `ha`: one term more in both polynomials, and the sum in two words. Its leading word is exact:
/// exponent·ln 2, k and k²/2 are multiples of 2^-36. Largest error 0.65 ulp.
template <>
struct log1p_d_nolut<tier::ha> : log1p_nolut_paths<log1p_d_nolut<tier::ha>, tier::ha> {
  LUMEN_MAIN double logarithm(const coarse_factor& f) {
    const double k2 = fma(f.k, f.k, 0.0);
    const double leading = fma(f.exponent, value(0x3fe62e42fefa0000u), fma(k2, 0.5, f.k));
    // -a in two words: r(1 - k) - k, of which the difference is exact.
    const double a = f.first_order - f.k;
    const double a_low = fma(f.r, 1.0 - f.k, -f.first_order);
    const double sum = leading + a;
    const double e = a - (sum - leading);
    const double low = fma(f.exponent, value(0x3d7cf79abc9e0000u), a_low + e);
    const double q = fma(fine(f.a), fma(f.a, f.a, 0.0), low);
    return fma(coarse(f.k), k2 * f.k, q) + sum;
  }

 private:
  LUMEN_MAIN double coarse(double k) {
    const auto& c = log1p_nolut_ha_coarse;
    const double k2 = fma(k, k, 0.0);
    const double even = fma(fma(value(c[4]), k2, value(c[2])), k2, value(c[0]));
    const double odd = fma(fma(value(c[5]), k2, value(c[3])), k2, value(c[1]));
    return fma(k, odd, even);
  }

  LUMEN_MAIN double fine(double a) {
    const auto& c = log1p_nolut_ha_fine;
    const double a2 = fma(a, a, 0.0);
    const double a4 = fma(a2, a2, 0.0);
    double d1 = fma(a4, value(c[10]), value(c[6]));
    double d2 = fma(a4, value(c[9]), value(c[5]));
    double d3 = fma(a4, value(c[8]), value(c[4]));
    double d4 = fma(a4, value(c[11]), value(c[7]));
    d1 = fma(a4, d1, value(c[2]));
    d2 = fma(a4, d2, value(c[1]));
    d3 = fma(a4, d3, value(c[0]));
    d4 = fma(a4, d4, value(c[3]));
    return fma(a, fma(a2, d4, d2), fma(a2, d1, d3));
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
