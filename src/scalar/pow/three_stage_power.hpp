// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// |x|^y at double with nearly correct rounding: what the main paths at double leave over, and
/// those of powx at float, `ep`.
#pragma once

#include <cstdint>

#include "scalar/pow/scaled_result.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dpow.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// 2^exponent·(high + low), high next to [1, 2); or how the power lies where it is not computed.
struct two_word_power {
  enum class range { within, too_large, too_small, one };
  range where;
  double high = 1.0;
  double low = 0.0;
  int exponent = 0;
};

/// The mantissa is multiplied by three factors, each from a table by the leading bits of the
/// product so far, until it is C(1 + e) with |e| < 2^-15.9, C = 1.4427 being close to 1/ln 2. What
/// the products round off is exact by fma, and kept. The logarithm is the sum of the exponent and
/// the three rows, which is exact in the high words, and of a polynomial of degree 4 in the rest,
/// whose coefficient of degree 1 is close to 1.
///
/// x positive and finite, y finite, neither of them 0.
LUMEN_DEVICE inline two_word_power three_stage_power(double x, double y) {
  using range = two_word_power::range;
  const auto* table = __dpow_ha_CoutTab;
  const bool denormal = bits(x) < 0x0010000000000000u;
  const double scaled = denormal ? x * value(0x4c70000000000000u) : x;  // 2^200
  const int exponent = static_cast<int>(bits(scaled) >> 52) - (denormal ? 1223 : 1023);
  const double m = value((bits(scaled) & format<double>::fraction) | format<double>::one);

  const auto upper = [](double u) { return static_cast<std::uint32_t>(bits(u) >> 32); };
  const auto i1 = static_cast<std::int32_t>(((upper(m) & 0xfc000u) + 0x4000u) >> 15);
  const double c1 = value(table[i1]);
  const double x1 = c1 * m;
  const double e1 = fma(c1, m, -x1);
  const auto i2 = static_cast<std::int32_t>(((upper(x1) & 0xfc00u) + 0x400u) >> 11);
  const double c2 = value(table[0x63 + i2]);
  const double x2 = x1 * c2;
  const double e2 = fma(x1, c2, -x2) + e1 * c2;
  const auto i3 = static_cast<std::int32_t>(((upper(x2) & 0xff0u) + 0x10u) >> 5);
  const double c3 = value(table[0xc6 + i3]);
  const double x3 = x2 * c3;
  const double e3 = fma(x2, c3, -x3) + e2 * c3;
  const double d = x3 - value(0x3ff7154740000000u);  // exact

  const std::uint64_t* row1 = table + 0x21 + 2 * i1;
  const std::uint64_t* row2 = table + 0x84 + 2 * i2;
  const std::uint64_t* row3 = table + 0x147 + 2 * i3;
  const double a = ((exponent + value(row1[0])) + value(row2[0])) + value(row3[0]);  // exact
  const double rows_low = (value(row1[1]) + value(row2[1])) + value(row3[1]);
  const double t = d + e3;
  const double t_low = (d - t) + e3;
  double q = value(0xbfb550472a9012d8u);
  q = mad(q, t, value(0x3fc47fd462b6dee1u));
  q = mad(q, t, value(0xbfd62e4346694107u));
  q = mad(q, t, value(0x3e79c3a6966457e8u));
  // log2 x in two words.
  const double s = a + t;
  const double low = mad(q, t, ((a - s) + t) + (rows_low + t_low));
  const double log_high = s + low;
  const double log_low = low - (log_high - s);

  // By the exponents alone: |y·log2 x| is at least 2^11, or less than 2^-60.
  const auto field = [](double u) { return static_cast<int>((bits(u) >> 52) & 0x7ff); };
  const int fields = field(log_high) + field(y);
  if (fields >= 0x809) {
    return {(log_high < 0) == (y < 0) ? range::too_large : range::too_small};
  }
  if (fields <= 0x7c0) return {range::one};
  const double p = y * log_high;
  const double p_low = fma(y, log_high, -p) + y * log_low;

  const double shifter = value(0x42c8000000000000u);  // 3·2^44, unit 1/128
  const double shifted = p + shifter;
  const double n = shifted - shifter;
  const double f = (p - n) + p_low;
  const auto steps = static_cast<std::int32_t>(static_cast<std::uint32_t>(bits(shifted)));
  const std::uint64_t* root = table + 584 + 2 * (steps & 0x7f);
  double g = value(0x3f55d87fe78a6731u);
  g = mad(g, f, value(0x3f83b2ab6fba4e77u));
  g = mad(g, f, value(0x3fac6b08d704a0c0u));
  g = mad(g, f, value(0x3fcebfbdff82c58fu));
  g = mad(g, f, value(0x3fe62e42fefa39efu));
  const double root_low = value(root[0]);
  const double root_high = value(root[1]);
  const double rest = mad(g * f, root_high, root_low);
  return {range::within, root_high, rest, steps >> 7};
}

/// The same as the rare path at double. Largest error 0.53 ulp, denormal results included. Code 3
/// only where the exponents of y and log2 x tell that the result is infinite; others that come out
/// infinite, zeros and denormals have none.
struct careful_power_d {
  LUMEN_DEVICE static std::uint32_t of(double x, double y, std::uint64_t sign, double* r) {
    using range = two_word_power::range;
    const two_word_power p = three_stage_power(fabs(x), y);
    switch (p.where) {
      case range::too_large:
        *r = value(sign | format<double>::special);
        return mask(code::overflow);
      case range::too_small:
        *r = value(sign);
        return mask(code::none);
      case range::one:
        *r = value(sign | format<double>::one);
        return mask(code::none);
      case range::within:
        break;
    }
    *r = scaled_result(p.high, p.low, p.exponent, sign);
    return mask(code::none);
  }
};

/// And as a rare path at float, narrowed; largest error 0.501 ulp. Code 3 for an infinite
/// result, code 4 for a zero one, as in the integer path of the other tiers.
struct careful_power_s {
  LUMEN_DEVICE static std::uint32_t of(float x, float y, std::uint32_t sign, float* r) {
    double wide;
    careful_power_d::of(fabs(double{x}), double{y}, 0, &wide);
    const auto result = static_cast<float>(wide);
    *r = value(sign | bits(result));
    if (result == 0) return mask(code::underflow);
    return mask(is_infinite(result) ? code::overflow : code::none);
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
