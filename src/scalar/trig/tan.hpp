// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/trig/fixed_turn.hpp"
#include "scalar/trig/half_turn_cosine.hpp"
#include "scalar/trig/tangent_rows_s.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// tan, float. Code 1 for infinities; no pole or overflow is ever reported, as no float is a
/// multiple of pi/2.
///
/// `la` and `ep`: x - n pi/2 with pi/2 in three and two parts, and a rational function of degree
/// 3 and 4 or its negative reciprocal. Beyond 8256 a row of a table. Largest error TANSLA and
/// TANSEP ulp.
template <tier t>
struct tan_s : scalar_v11<tan_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float a = fabs(x);
    const float shifted = fma(a, value(0x3f22f983u), value(0x4b400000u));  // 3·2^22
    const float n = shifted - value(0x4b400000u);
    float r = fma(-n, value(0x3fc90fdbu), a);
    r = fma(-n, value(0xb33bbd2eu), r);
    if constexpr (t == tier::la) r = fma(-n, value(0xa6f72cedu), r);
    const float z = r * r;
    const float p = r * fma(value(0xbdc433b4u), z, value(0x3f7ffffcu));
    const float q = horner(z, 0x3c1f336bu, 0xbedbb7abu, 0x3f7ffffcu);
    const bool odd = (bits(shifted) & 1u) != 0;
    const float y = quotient(select(odd, q, p), select(odd, p, q));
    const std::uint32_t sign = (bits(shifted) << 31) ^ sign_bit(x);
    return {value(bits(y) ^ sign), flag_if<float>(!(a <= value(0x46010000u)))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    if (is_special(x)) {
      *y = is_nan(x) ? x * x : 0.0f * x;
      return mask(is_nan(x) ? code::none : code::domain);
    }
    *y = value(bits(tangent_rows_s::tangent(fabs(x))) ^ sign_bit(x));
    return mask(code::none);
  }

 private:
  LUMEN_MAIN float quotient(float numerator, float denominator) {
    if constexpr (t == tier::la) {
      return divide(numerator, denominator);
    } else {
      return fma(divide(1.0f, denominator), numerator, 0.0f);
    }
  }
};

/// `ha`: fixed point to the nearest quarter turn, then the quotient of sine and cosine, all in two
/// words. The NaN of an infinity is its pattern made quiet, as of NaNs. Largest error TANSHA ulp.
template <>
struct tan_s<tier::ha> : scalar_v11<tan_s<tier::ha>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float y = select(is_below_fixed_turn(x), x, of_place(fixed_turn(x), x));
    return {y, flag_if<float>(is_above_fixed_turn(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    if (is_special(x)) return of_special(x, y);
    *y = of_place(fixed_turn_by_table(x), x);
    return mask(code::none);
  }

 private:
  LUMEN_MAIN float of_place(std::uint64_t place, float x) {
    const auto quarters = static_cast<std::uint32_t>(place >> 32) + 0x20000000u;
    const bool odd = (quarters & 0x40000000u) != 0;
    const turn_rest a = rest_of_turn<2>(place);
    const float_float v = square(a);
    const float_float cosine = cosine_of_half_turns(v);

    const float p = horner(v.high, 0x3da5e12bu, 0xbf196543u, 0x402335ddu);
    const float_float c2 = horner_step({p, 0.0f}, v, value(0xc0a55de7u), 0.0f);
    const float_float sine =
        times_rest(horner_step(c2, v, value(0x40490fdbu), value(0xb3bbc50au)), a);

    const float numerator = select(odd, cosine.high, sine.high);
    const float numerator_low = select(odd, cosine.low, sine.low);
    const float denominator = select(odd, -sine.high, cosine.high);
    const float denominator_low = select(odd, -sine.low, cosine.low);
    const float c = divide(1.0f, denominator);
    const float e = fma(denominator_low, -c, fma(denominator, -c, 1.0f)) * c;
    const float y = fma(numerator, c, fma(numerator, e, numerator_low * c));
    return value(bits(y) ^ sign_bit(x));
  }
};

using tan_h = half_v11<tan_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
