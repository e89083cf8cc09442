// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/exp/half_range_power.hpp"
#include "scalar/exp/half_step_power.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dexp10.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// (10^r - 1)/r on |r| <= log10(2)/4, and where 10^x leaves the normal numbers.
struct decimal_base_s {
  static constexpr std::uint32_t log2_of_base = 0x40549a78;    // log2 10
  static constexpr std::uint32_t half_step_high = 0x3e9a209b;  // log10 2
  static constexpr std::uint32_t half_step_low = 0xb2760860;
  static constexpr std::uint32_t c5 = 0x3f0a4794, c4 = 0x3f962559, c3 = 0x40023822, c2 = 0x4029a917,
                                 c1 = 0x40135d8e;
  static constexpr std::uint32_t normal_limit = 0x4217b818;  // 37.92978
  static constexpr std::uint32_t scaled_limit = 0x42349e35;  // 45.1545
  static constexpr std::uint32_t zero_limit = scaled_limit;  // scaled ones need not be zero
};

/// exp10, float; within 0.95 ulp in every tier.
using exp10_s = half_step_power<decimal_base_s>;

/// exp10, double. Code 3 for a finite argument above 308.2547155599167, code 4 for a finite one
/// below -307.6526555685887; ±infinity has code 0.
///
/// x·log2 10 = k + i/128 + a rest, 2^(i/128) from a table, at `ha` from a table of pairs; `ep`
/// reduces to integers and has no table. The rare path, one for all tiers, has a table of 64 pairs
/// and rounds a denormal result once. Largest error 0.52, 1.0, 2.8e7 ulp for `ha`, `la`, `ep`, and
/// 0.53 on the rare path.
template <tier t>
struct exp10_d : scalar_v11<exp10_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const std::uint64_t magnitude = bits(x) & 0x7fffffff00000000u;
    return {power(x), flag_if<double>(magnitude > 0x40733a7000000000u)};  // 307.65234
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    const rare_result<double> limit = beyond(x);
    if (limit.rare == 0) return assign(limit, y);
    if (is_nan(x)) {
      *y = x * x;
      return mask(code::none);
    }
    if (((bits(x) >> 52) & 0x7ff) <= 0x3ca) {
      *y = 1.0 + x;
      return mask(code::none);
    }
    return finite_power(x, y);
  }

  /// Infinity and zero.
  LUMEN_MAIN rare_result<double> beyond(double x) {
    const bool above = x > value(0x40734413509f79feu);
    const bool below = x < value(0xc07439b746e36b52u);  // -323.60724533877976
    const std::uint64_t status =
        select(above, std::uint64_t{mask(code::overflow)}, std::uint64_t{mask(code::underflow)});
    return {select(above, value(format<double>::special), 0.0), flag_if<double>(!(above || below)),
            select(is_special(x), std::uint64_t{0}, status)};
  }

 private:
  LUMEN_MAIN double power(double x) {
    const double shifter = value(0x4338800000000000u);  // 3·2^51 + 2^47
    if constexpr (t == tier::ep) {
      const double log2_10 = value(0x400a934f0979a371u);
      const double shifted = fma(x, log2_10, shifter);
      const double n = shifted - shifter;
      const double f = fma(x, log2_10, -n);
      const double y = horner(f, 0x3f24308fabc18decu, 0x3f55f07b4611e454u, 0x3f83b2b9fbd8970fu,
                              0x3fac6af6e92be375u, 0x3fcebfbdec29c82au, 0x3fe62e4302eeb44du,
                              0x3ff0000000000000u);
      return value(bits(y) + (bits(shifted) << 52));
    } else {
      const double shifted = fma(x, value(0x407a934f0979a371u), shifter);
      const double n = shifted - shifter;
      const std::uint64_t w = bits(shifted);
      const auto i = static_cast<std::int64_t>(w & 0x7f);
      const std::uint64_t exponent = (w << 45) & 0xfff0000000000000u;
      double r = fma(-n, value(0x3f63441350a00000u), x);
      r = fma(-n, value(0xbd10c0219dc1da99u), r);
      const double p = horner(r, 0x3fe144c03efafb54u, 0x3ff2bd767584db59u, 0x4000470591ccea8bu,
                              0x40053524c73ce8e3u, 0x40026bb1bbb55516u);
      const double q = fma(p, r, 0.0);
      if constexpr (t == tier::ha) {
        const double high = value(internal_dexp10_ha_data[2 * i]);
        const double low = value(internal_dexp10_ha_data[2 * i + 1]);
        return value(bits(fma(q, high, low) + high) + exponent);
      } else {
        const double root = value(internal_dexp10_la_data[i]);
        return value(bits(fma(q, root, root)) + exponent);
      }
    }
  }

  /// 10^x for -323.60724533877976 <= x <= 308.2547155599167.
  LUMEN_DEVICE static std::uint32_t finite_power(double x, double* y) {
    const double shifter = value(0x4338000000000000u);  // 3·2^51
    const double v = x * value(0x406a934f0979a371u);    // 64 log2 10
    const double u = v + shifter;
    const double m = u - shifter;
    const auto l = static_cast<std::int32_t>(bits(u));
    const double r = (x - m * value(0x3f734413509f0000u)) - m * value(0x3d1e7fbcc47c4acdu);
    double p = value(0x3fe1427c87c70a85u);
    p = mad(p, r, value(0x3ff2bd77b840f0bfu));
    p = mad(p, r, value(0x4000470591e2bc10u));
    p = mad(p, r, value(0x40053524c73cd20au));
    p = mad(p, r, value(0x40026bb1bbb55515u));
    p = p * r;
    const std::int32_t i = (l & 0x3f) << 1;
    const std::int32_t e = l >> 6;
    const double high = value(rare_table()[i]);
    const double low = value(rare_table()[i + 1]);
    const double a = (p + low) * high;
    if (!(x < value(0xc0733a7146f72a41u))) {  // -307.6526555685887
      const auto g = static_cast<std::uint64_t>(e + 0x3ff) & 0x7ff;
      const double b = a + high;
      *y = g == 0x7ff ? (b * value(0x7fe0000000000000u)) * 2.0 : b * value(g << 52);
      return mask(code::none);
    }
    // The result times 2^60, normal, in two words.
    const auto g = static_cast<std::uint64_t>(e + 0x43b) & 0x7ff;
    const double scale = value(g << 52);
    const double low_word = a * scale;
    const double high_word = high * scale;
    const double w = low_word + high_word;
    const double back = value(0x3c30000000000000u);  // 2^-60
    if (g < 0x33) {
      *y = w * back;
      return mask(code::underflow);
    }
    // The leading 20 bits of w and the rest: only the sum of the scaled words rounds.
    const double d = (high_word - w) + low_word;
    const double c = w * value(0x41f8000000000000u);
    const double h = (w + c) - c;
    const double rest = (w - h) + d;
    *y = (h * back) + (rest * back);
    return mask(code::underflow);
  }

  LUMEN_DEVICE static constexpr const std::uint64_t* rare_table() {
    if constexpr (t == tier::ha) return __dexp10_ha__zordExp10Tab;
    if constexpr (t == tier::la) return __dexp10_la__zordExp10Tab;
    if constexpr (t == tier::ep) return __dexp10_ep__zordExp10Tab;
  }
};

struct decimal_base_h {
  static constexpr float highest = 6.0f;
  static constexpr float lowest = -8.0f;
  static constexpr std::uint32_t half_log2 = 0x42a5;  // log2 10 in two halves, and as a float
  static constexpr std::uint32_t half_log2_low = 0x8d88;
  static constexpr std::uint32_t float_log2 = 0x40549a78;
};

/// exp10, half; within 0.76, 1.67, 1.67 ulp for `ha`, `la`, `ep`, status 0.
template <tier t>
using exp10_h = half_range_power<decimal_base_h, t>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
