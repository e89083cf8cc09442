// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/exp/exp2.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/spow.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// x^y at float for positive normal x and |y·log2 x| <= 125.75, by a logarithm to base 2 in two
/// words from a table of 257 rows.
///
/// R, an integer close to the reciprocal of the mantissa, leads to a row with its logarithm and
/// leaves t with |t| < 2^-9. The product of t with 1/ln 2 is exact in two words; a polynomial of
/// degree 4 at `ha`, of degree 3 at `la`, has the rest. The power of two is that of exp2 at `ha`, a
/// polynomial of degree 5 at `la`, whose value at 0 is 1 + 2^-23: no argument is singled out, so y
/// = 0 and x = 1 have that result.
template <tier t>
struct row_power_s {
  LUMEN_MAIN main_result<float> main(float x, float y) {
    const std::uint32_t e = bits(x) >> 23;
    const words l = log2_of(x, static_cast<float>(static_cast<std::int32_t>(e)));
    const float p = fma(y, l.high, 0.0f);
    const float p_low = fma(y, l.high, -p);
    const float w = p_low + fma(y, l.low, 0.0f);
    const float n = rint(p);
    const float f = (p - n) + w;
    // The integer n, exact for |n| < 2^22.
    const std::uint32_t shifter = 0x4b400000;  // 3·2^22
    const std::uint32_t i = bits(n + value(shifter)) - shifter;
    const bool not_positive_normal = e - 255u < 0xffffff02u;
    const bool large = bits(fabs(p)) > 0x42fb7fffu;  // 125.75
    return {value((i << 23) + bits(power_of_fraction(f))),
            flag_if<float>(not_positive_normal, large)};
  }

 private:
  struct words {
    float high;
    float low;
  };

  LUMEN_MAIN words log2_of(float x, float exponent) {
    const float m = value((bits(x) & format<float>::fraction) | 0x3b000000u);  // 2^-9
    const float integer = rint(divide(1.0f, m));                               // 256..512
    const auto word = static_cast<std::int32_t>(((bits(integer) >> 14) & 0x3feu) ^ 0x200u);
    const float r = fma(integer, m, -1.0f);
    const float a = value(__spow_ha_log_tbl[word]) + exponent;
    const float row_low = value(__spow_ha_log_tbl[word | 1]);
    const float q = polynomial(r, row_low);
    const float b = fma(value(0x3fb8aa3bu), r, a);
    const float b_low = fma(value(0x3fb8aa3bu), r, -(b - a));
    const float h = q + b;
    return {h, (q - (h - b)) + b_low};
  }

  LUMEN_MAIN float polynomial(float r, float row_low) {
    if constexpr (t == tier::ha) {
      const float p = horner(r, 0xbeb8aa69u, 0x3ef63874u, 0xbf38aa3bu, 0x32a56f38u);
      return fma(p, r, row_low);
    } else {
      const float p = horner(r, 0x3ef6387du, 0xbf38aa4cu, 0x32a56e11u);
      return fma(p, r, row_low);
    }
  }

  LUMEN_MAIN float power_of_fraction(float f) {
    if constexpr (t == tier::ha) {
      return exp2_of_fraction(f);
    } else {
      return horner(f, 0x3aafc483u, 0x3c1e883du, 0x3d635716u, 0x3e75fc83u, 0x3f317219u,
                    0x3f800001u);
    }
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
