// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The rare path of log2 at double.
#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

namespace log2_parts {

/// 1/ln 2 to 19 bits; the polynomials hold the rest.
static constexpr std::uint64_t inverse_ln2_high = 0x3ff7154700000000;

/// A number in two words of half the length.
struct halves {
  double high;
  double low;
};

LUMEN_DEVICE inline halves split(double v) {
  const double high = v * value(0x41f0000000100000u) - v * value(0x41f0000000000000u);
  return {high, v - high};
}

/// The high half by a multiply-add.
LUMEN_DEVICE inline double high_half(double v) {
  return mad(-v, value(0x41f0000000000000u), v * value(0x41f0000000100000u));
}

/// Within about 2^-31 of 1.
LUMEN_DEVICE inline double closest_to_one(double d) {
  if (d == 0) return 0.0;
  const double q = mad(mad(d, value(0x3fdec709dc3a03fdu), value(0xbfe71547652b82feu)), d,
                       value(0x3e994ae0bf85ddf4u));
  return mad(q, d, d * value(inverse_ln2_high));
}

/// Within about 2^-17 of 1.
LUMEN_DEVICE inline double very_near_one(double d) {
  const double e = d * d;
  const double a = mad(e, value(0xbfd7154765323ffeu), value(0xbfe71547652b82feu));
  const double c = mad(e, value(0x3fdec709dc3fc94fu), value(0x3e994ae0bf85ddeeu));
  double g = mad(a, e, c * d);
  const double d_high = value(bits(d) & 0xffffffff00000000u);
  g = mad(d - d_high, value(inverse_ln2_high), g);
  return d_high * value(inverse_ln2_high) + g;
}

/// Within 2^-6 of 1: d·(1/ln 2 + d·(-1/(2 ln 2) + p)), the two outer steps in two words.
LUMEN_DEVICE inline double near_one(double d) {
  const double e = d * d;
  const double even =
      horner(e, 0xbfc227e173413b57u, 0xbfc7155343f9ebf8u, 0xbfcec709dba4bedbu, 0xbfd71547652b8457u);
  const double odd =
      horner(e, 0x3fc487489b5898b9u, 0x3fca617605c58a46u, 0x3fd2776c50f00abau, 0x3fdec709dc3a03fcu);
  const halves p = split(mad(even, e, odd * d));
  const halves x = split(d);
  const double a = p.high + value(0xbfe7154700000000u);
  const double b = p.low + value(0xbe894ae0bf85a8b6u);
  const double n = mad(a, x.low, b * d);
  const double g = a * x.high;
  const double v = high_half(g + n);
  const double a2 = v + value(inverse_ln2_high);
  const double b2 = (n + (g - v)) + value(0x3e994ae0bf85ddfau);
  const double s = high_half(a2 + b2);
  const double low = b2 + (a2 - s);
  return s * x.high + mad(s, x.low, low * d);
}

/// Of 2^k·m, m in [1, 2), by tables of 256 rows.
LUMEN_DEVICE inline double by_tables(std::uint64_t m, double k, const std::uint32_t* reciprocals,
                                     const std::uint64_t* logarithms) {
  const auto i = static_cast<std::int32_t>((m >> 44) & 0xff);
  const double top = value(m & 0xffffffff00000000u);
  const auto c = static_cast<double>(value(reciprocals[i]));
  const double a = top * c - 1.0;
  const double b = (value(m) - top) * c;
  const double r = a + b;
  const double e = r * r;
  const double p = horner(e, 0xbfcec718810d0357u, 0xbfd71547652a21f9u, 0xbfe71547652b82feu);
  const double q = horner(e, 0x3fd27772978ff6bcu, 0x3fdec709dc3944e3u, 0x3e994ae0bf8613d6u);
  double g = mad(p, e, q * r);
  g = mad(b, value(inverse_ln2_high), g);
  const double h = a * value(inverse_ln2_high);
  const double splitter = value(0x41f0000000000000u);  // 2^32, unit 2^-20
  const double h_high = (h + splitter) - splitter;
  const double h_low = h - h_high;
  const double row_low = value(logarithms[2 * i]);
  const double row_high = value(logarithms[2 * i + 1]);
  return (h_high + (row_high + k)) + ((g + h_low) + row_low);
}

}  // namespace log2_parts

/// log2 of every argument, correct to 0.51 ulp: polynomials within 2^-6 of 1, tables elsewhere. The
/// former serve callers without a main path, since the main paths take all normal numbers.
LUMEN_DEVICE inline std::uint32_t log2_rare(double x, double* y, const std::uint32_t* reciprocals,
                                            const std::uint64_t* logarithms) {
  const std::uint64_t b = bits(x);
  if (b >= format<double>::special) {
    if (is_nan(x) || sign_bit(x) == 0) {
      *y = x + x;
      return mask(code::none);
    }
    *y = value(x == 0 ? 0xfff0000000000000u : format<double>::nan);
    return mask(x == 0 ? code::pole : code::domain);
  }
  const auto high_word = static_cast<std::uint32_t>(b >> 32);
  if (high_word + 0xc0108000u < 0xd000u) {
    const double d = x - 1.0;
    const auto below_exponent = static_cast<std::uint32_t>((b << 11) >> 32);
    if (high_word + 0xc0100010u >= 0x18u)
      *y = log2_parts::near_one(d);
    else if (below_exponent + 0x80000002u >= 3u)
      *y = log2_parts::very_near_one(d);
    else
      *y = log2_parts::closest_to_one(d);
    return mask(code::none);
  }
  if (x == 0) {
    *y = value(0xfff0000000000000u);
    return mask(code::pole);
  }
  const bool denormal = b < 0x0010000000000000u;
  const std::uint64_t scaled = bits(denormal ? x * value(0x4360000000000000u) : x);  // 2^55
  const auto k = static_cast<std::int32_t>(scaled >> 52) - (denormal ? 1078 : 1023);
  const std::uint64_t m = (scaled & format<double>::fraction) | format<double>::one;
  *y = log2_parts::by_tables(m, k, reciprocals, logarithms);
  return mask(code::none);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
