// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The reduction of floats in fixed point, by which every finite float has its place in the turn to
/// 2^-51, and what the sine, the cosine and the tangent share of what follows.
#pragma once

#include <cstdint>

#include "scalar/protocol.hpp"
#include "scalar/tables/ssin.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Magnitude patterns. Below 2^-12 x is within 0.67 ulp of its sine and tangent, and 1 of the
/// cosine; from 2^21 the digits of 1/(2 pi) come from a table.
struct fixed_turn_range {
  static constexpr std::uint32_t lowest = 0x39800000;
  static constexpr std::uint32_t table = 0x4a000000;
};

LUMEN_MAIN bool is_below_fixed_turn(float x) { return bits(fabs(x)) < fixed_turn_range::lowest; }
LUMEN_MAIN bool is_above_fixed_turn(float x) { return bits(fabs(x)) >= fixed_turn_range::table; }

/// frac(|x|/(2 pi)) 2^64 for 2^-12 <= |x| < 2^21, from 27 digits of 1/(2 pi) and the following 38,
/// within 2^13. Defined for all x.
LUMEN_MAIN std::uint64_t fixed_turn(float x) {
  const std::uint64_t e = (bits(x) >> 23) & 0xffu;
  const std::uint64_t m = (bits(x) & format<float>::fraction) | 0x00800000u;
  const std::uint64_t high = (m * 0x0517cc1bu) << ((e - 115) & 63u);
  const std::uint64_t low = (m * 0x39391054a8u) >> ((154 - e) & 63u);
  return high + low;
}

/// The same from 2^21 to the largest float, within 1, from those 128 digits of 1/(2 pi) that
/// matter. Defined for all x.
LUMEN_MAIN std::uint64_t fixed_turn_by_table(float x) {
  const auto e = static_cast<std::int32_t>((bits(x) >> 23) & 0xffu);
  const std::uint64_t m = (bits(x) & format<float>::fraction) | 0x00800000u;
  // That of the lowest bit of x, not below the first word.
  const std::int32_t place = select(e < 118, -32, e - 150);
  const std::uint32_t* words = __ssin_ha_invpi_tbl + ((place >> 5) + 1);
  const auto shift = static_cast<std::uint32_t>(place & 31);
  const std::uint64_t low = words[2] * m + ((words[3] * m) >> 32);
  const std::uint64_t high = words[1] * m + ((words[0] * m) << 32) + (low >> 32);
  const std::uint32_t behind = (static_cast<std::uint32_t>(low) >> (shift ^ 31u)) >> 1;
  return (high << shift) | behind;
}

/// What a place in the turn leaves to the nearest half turn (`removed` = 1) or quarter turn (2),
/// in half turns, as the float u and its rest.
struct turn_rest {
  float u;
  float low;
};

/// Shifted left until it fills 31 bits, then converted. No float has a place so close to a multiple
/// of the quarter turn that no bit is left to shift.
template <int removed>
LUMEN_MAIN turn_rest rest_of_turn(std::uint64_t place) {
  const auto high = static_cast<std::uint32_t>(place >> 32);
  const auto low = static_cast<std::uint32_t>(place);
  const std::uint32_t top = high << removed;
  const std::uint32_t e = (bits(static_cast<float>(static_cast<std::int32_t>(top))) >> 23) & 0xffu;
  const std::uint32_t shift = select(e < 158u, 157u + removed - e, std::uint32_t{removed}) & 31u;
  const std::uint32_t filled = (high << shift) + ((low >> 1) >> (31u - shift));
  const auto rounded = static_cast<float>(static_cast<std::int32_t>(filled));
  // An even integer, up to 2^31.
  const std::uint32_t back = static_cast<std::uint32_t>(static_cast<std::int32_t>(rounded * 0.5f))
                             << 1;
  const auto rest = static_cast<float>(static_cast<std::int32_t>(filled - back));
  const float scale = value(0x30000000u - (shift << 23));  // 2^(-31 - shift)
  return {fma(rounded, scale, 0.0f), fma(rest, scale, 0.0f)};
}

/// A float of 48 bits.
struct float_float {
  float high;
  float low;
};

/// The square of u + low; the low part is the error of the high part.
LUMEN_MAIN float_float square(const turn_rest& a) {
  const float v = fma(a.u, a.u, 0.0f);
  return {v, fma(a.u + a.u, a.low, fma(a.u, a.u, -v))};
}

/// p v + (c + c_low) for |p v| < |c|; what the products and sums round away is in the low part.
LUMEN_MAIN float_float horner_step(float_float p, float_float v, float c, float c_low) {
  const float q = fma(p.high, v.high, 0.0f);
  const float q_error = fma(p.high, v.high, -q);
  const float s = q + c;
  const float s_error = q - (s - c);
  const float from_low = fma(p.high, v.low, fma(p.low, v.high, c_low));
  return {s, (s_error + q_error) + from_low};
}

/// p (u + low) as a product and its error.
LUMEN_MAIN float_float times_rest(float_float p, const turn_rest& a) {
  const float s = fma(p.high, a.u, 0.0f);
  const float error = fma(p.high, a.u, -s);
  return {s, fma(p.low, a.u, fma(p.high, a.low, error))};
}

/// An infinity or a NaN as a quiet NaN with its sign and payload; an infinity has code 1.
LUMEN_DEVICE inline std::uint32_t of_special(float x, float* y) {
  const bool infinite = is_infinite(x);
  *y = value(bits(x) | 0x00400000u);
  return mask(infinite ? code::domain : code::none);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
