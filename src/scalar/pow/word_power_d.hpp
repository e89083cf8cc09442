// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/log/reduction.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dpow.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The operands that the main paths at double with tables leave to the rare path, but for those of
/// a large product: x not positive and normal, and |y| >= 2^1017, infinite or NaN.
LUMEN_MAIN bool not_for_main_path(double x, double y) {
  const bool y_not_served = (bits(y) & 0x7f80000000000000u) == 0x7f80000000000000u;
  return not_positive_normal(x) | y_not_served;
}

/// x^y at double in words of two doubles: for positive normal x, |y·log2 x| < 999.9998 and
/// |y| < 2^1017.
///
/// The mantissa m in [1, 2) rounded to 2^-10 leads to r of 26 bits, close to C/m, and to the row of
/// r's logarithm; C = 1.4427, close to 1/ln 2, makes the difference mr - C, exact in two words, the
/// leading term of the logarithm to base 2. From m = 1.4995 on a row has 1 less, and the exponent
/// is one more, so that next to 1 the sum has no cancellation. The product with y is exact by
/// halves of the words; 2^(i/128) is a row of two words, its polynomial of degree 5 summed from the
/// highest terms down.
struct word_power_d {
  LUMEN_MAIN main_result<double> main(double x, double y) {
    const std::uint64_t upper = bits(x) >> 32;
    const double m = value((bits(x) & format<double>::fraction) | format<double>::one);
    const auto j = static_cast<std::int64_t>(((upper & 0xffe00u) + 0x200u) >> 10);
    const double r = value(internal_dpow_ha_data[j]);
    const double row_high = value(internal_dpow_ha_data[1026 + 2 * j]);
    const double row_low = value(internal_dpow_ha_data[1027 + 2 * j]);
    const double exponent = small_integer((upper + 0x80200u) >> 20) - 1023.0;

    const double m_high = value(bits(m) & 0x3ffffffff8000000u);
    const double m_low = m - m_high;
    const double p = fma(m, r, 0.0);
    const double u = p - value(0x3ff7154740000000u);
    double v = fma(m_high, r, -p);
    v = fma(m_low, r, v);
    const double a = exponent + row_high;
    const double s1 = a + u;
    const double t1 = (a - s1) + u;
    const double s2 = s1 + v;
    const double t2 = (s1 - s2) + v;
    const double rest = (t2 + t1) + row_low;
    const double z = u + v;
    double q = horner(z, 0xbf9b4ea0e9419f52u, 0x3fa7a334ddfc9f86u, 0xbfb550472a8bb463u,
                      0x3fc47fd462b3b816u, 0xbfd62e4346694107u, 0x3e79c3a6966457eeu);
    q = fma(q, z, rest);
    const double s = s2 + q;
    const double s_low = q - (s - s2);

    const double s_first = upper_half(s);
    const double s_second = s - s_first;
    const double y_first = upper_half(y);
    const double y_second = y - y_first;
    const double product = fma(y_first, s_first, 0.0);
    const double tail =
        fma(y_second, s_first, fma(y_first, s_second, fma(y_second, s_second, 0.0)));
    const double others = tail + fma(y, s_low, 0.0);
    const bool large = (bits(product) & format<double>::magnitude) >= 0x408f3fff00000000u;
    return {power_of_two(product, others), flag_if<double>(not_for_main_path(x, y), large)};
  }

 private:
  LUMEN_MAIN double upper_half(double x) { return value(bits(x) & 0xfffffffff8000000u); }

  LUMEN_MAIN double power_of_two(double product, double others) {
    const double shifter = value(0x42c8000000000000u);  // 3·2^44, unit 1/128
    const double u2 = product + shifter;
    const double n = u2 - shifter;
    const double f = others + (product - n);
    const double scale = value(((bits(u2) << 45) & 0xfff0000000000000u) + format<double>::one);
    const auto i = static_cast<std::int64_t>(bits(u2) & 0x7fu);
    const double root = value(internal_dpow_ha_data[3076 + 2 * i]);
    const double root_low = value(internal_dpow_ha_data[3077 + 2 * i]);
    const double w1 = fma(f, f, 0.0);
    const double w2 = fma(w1, w1, 0.0);
    const double a = fma(fma(value(0x3f55d87fe78a6731u), f, value(0x3f83b2ab6fba4e77u)), w2, 0.0);
    const double s1 = fma(a, root, 0.0) + root_low;
    const double b = fma(fma(value(0x3fac6b08d704a0bfu), f, value(0x3fcebfbdff82c58eu)), w1, 0.0);
    const double s2 = s1 + fma(b, root, 0.0);
    const double c = fma(value(0x3fe62e42fefa39efu), f, 0.0);
    const double s3 = s2 + fma(c, root, 0.0);
    return fma(s3 + root, scale, 0.0);
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
