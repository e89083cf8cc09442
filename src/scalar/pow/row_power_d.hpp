// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/log/reduction.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dpow.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// x^y at double, the main path of pow at `la`: for positive normal x and |y·log2 x| <= 1021.5.
///
/// A reciprocal rounded to 9 bits leads to a row with its logarithm to base 2 and leaves t with
/// |t| < 2^-9, a polynomial of degree 6. The power of two comes from a row of 2^(i/256) and a
/// polynomial of degree 4; the shifter with the unit 1/256 has the exponent's bias in its low bits.
struct row_power_d {
  LUMEN_MAIN main_result<double> main(double x, double y) {
    const double m = mantissa_at(format<double>::one, x);
    const auto c = static_cast<double>(quick_reciprocal(m));
    const double exponent = small_integer(bits(x) >> 52);
    const std::uint64_t rounded = (bits(c) + 0x0000040000000000u) & 0xfffff80000000000u;
    const auto word = static_cast<std::int32_t>((rounded >> 42) - 0xff800u);
    const double row_high = value(internal_dpow_la_data[word]);
    const double row_low = value(internal_dpow_la_data[word + 1]);
    const double t = fma(m, value(rounded), -1.0);

    const double p1 = fma(value(0xbfcec1cfbbc5c90cu), t, value(0x3fd2776da3d26e6au));
    const double w = fma(t, t, 0.0);
    const double p2 = fma(value(0xbfd71547655d37e0u), t, value(0x3fdec709dc39fb02u));
    const double p3 = fma(p1, w, p2);
    const double p4 = fma(p3, t, value(0xbfe71547652b82feu));
    const double a = row_high + exponent;
    const double l0 = fma(value(0x3c777a3a2c24613du), t, row_low);
    const double log2_e = value(0x3ff71547652b82feu);
    const double h = fma(log2_e, t, a);
    const double d = h - a;
    const double l = fma(w, p4, l0 + fma(log2_e, t, -d));

    const double p = fma(h, y, 0.0);
    const double p_low = fma(h, y, -p);
    const double s = fma(l, y, p);
    const double shifter = value(0x42b800000003ff00u);
    const double sum = s + shifter;
    const double n = sum - shifter;
    const double l_low = fma(l, y, -(s - p));
    const double f = s - n;
    const double ff = (l_low + p_low) + f;

    const auto i = static_cast<std::int64_t>(bits(sum) & 0xffu);
    const double root = value(internal_dpow_la_data[0x402 + i]);
    const double scale = value((bits(sum) << 44) & 0xfff0000000000000u);
    double q = fma(value(0x3f83b2ab930f15f9u), f, value(0x3fac6b090da1e0a9u));
    q = fma(q, ff, value(0x3fcebfbdff82c54du));
    q = fma(q, ff, value(0x3fe62e42fefa39b9u));
    const double r = fma(q, fma(root, ff, 0.0), root);
    const bool large = !(fabs(p) <= 1021.5);
    return {fma(r, scale, 0.0), flag_if<double>(not_positive_normal(x), large)};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
