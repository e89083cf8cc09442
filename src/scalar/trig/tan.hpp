// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dtan.hpp"
#include "scalar/trig/fixed_turn.hpp"
#include "scalar/trig/half_turn_cosine.hpp"
#include "scalar/trig/parity.hpp"
#include "scalar/trig/quarter_turn.hpp"
#include "scalar/trig/quarter_turn_kernels.hpp"
#include "scalar/trig/quarter_turn_tangent_block.hpp"
#include "scalar/trig/tangent_rows_s.hpp"
#include "scalar/trig/turn_rows.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// tan, float. Code 1 for infinities; no pole or overflow is ever reported, as no float is a
/// multiple of pi/2.
///
/// `la` and `ep`: x - n pi/2 with pi/2 in three and two parts, and a rational function of degree
/// 3 and 4 or its negative reciprocal; largest error 3.7 ulp, and at `ep` 45 ulp, but next to
/// multiples of pi/2 up to 985. Beyond 8256 a row of a table, within 1.5 ulp.
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
    const bool odd = is_odd(bits(shifted));
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
/// words. The NaN of an infinity is its pattern made quiet, as of NaNs. Largest error 0.56 ulp.
template <>
struct tan_s<tier::ha> : scalar_v11<tan_s<tier::ha>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float y = select(is_below_fixed_turn(x), x, of_place(fixed_turn(x), x));
    return {y, flag_if<float>(is_above_fixed_turn(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    if (is_special(x)) return of_special(x, y);
    *y = beyond(x).value;
    return mask(code::none);
  }

  LUMEN_MAIN main_result<float> beyond(float x) {
    return {of_place(fixed_turn_by_table(x), x), flag_if<float>(is_special(x))};
  }

  template <std::int64_t length>
  static bool block(const float* x, float* y) {
    return quarter_turn_tangent_block::tangent<length>(x, y);
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

/// tan, double. Code 1 for infinities; no pole or overflow is ever reported, as no double is a
/// multiple of pi/2.
///
/// `la` and `ep`: x - n pi/2 with pi/2 in three and two parts, and r/D(r^2) or its negative
/// reciprocal with D of degree 9 and 4; the quotient from the reciprocal at float by two steps of
/// Newton's method. Largest error 3.1 and 5.2e7 ulp. The two parts leave 2^-86 of pi/2: closer than
/// n 2^-59 to a multiple, `ep` has fewer than 26 bits. From 2^20 a reduction in fixed point and D
/// of degree 10, with a division, within 2.2 ulp. The NaN of an infinity is the negative one, and a
/// NaN loses its sign.
template <tier t>
struct tan_d : scalar_v11<tan_d<t>, double> {
  static constexpr int interleave = 4;

  LUMEN_MAIN main_result<double> main(double x) {
    const double a = fabs(x);
    const double shifter = value(0x4338000000000000u);  // 3·2^51
    const double shifted = fma(a, value(0x3fe45f306dc9c883u), shifter);
    const double n = shifted - shifter;
    double r = fma(n, value(0xbff921fb54442d18u), a);
    r = fma(n, value(0xbc91a62633000000u), r);
    if constexpr (t == tier::la) r = fma(n, value(0xba945c06e0e68948u), r);
    const double divisor = denominator(r * r);
    const bool odd = is_odd(bits(shifted));
    const double y = fma(select(odd, divisor, r), reciprocal(select(odd, r, divisor)), 0.0);
    const std::uint64_t sign = (bits(shifted) << 63) ^ sign_bit(x);
    return {value(bits(y) ^ sign), flag_if<double>(is_beyond_short_quarter_turns(a))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    if (is_special(x)) return quiet_of_special(x, y);
    *y = long_tangent(quarter_turn::nearest(fabs(x)), x);
    return mask(code::none);
  }

  LUMEN_MAIN main_result<double> beyond(double x) {
    bool next_to_quarter;
    const auto s = quarter_turn::nearest_without_branch(fabs(x), next_to_quarter);
    return {long_tangent(s, x), flag_if<double>(next_to_quarter, is_special(x))};
  }

 private:
  LUMEN_MAIN double long_tangent(const quarter_turn& s, double x) {
    const double r = s.rest;
    const double z = r * r;
    const double q = horner(z, 0xbdf64c1ef7b9f88fu, 0xbe2209d9df00def0u, 0xbe57fdc92b36f96fu,
                            0xbe8d6b5f16d11bceu, 0xbec228124e270b4cu, 0xbef66a8ed675ceb9u,
                            0xbf2bbd7794a1b07du, 0xbf61566abbff502au, 0xbf96c16c16c16e58u);
    const double divisor = fma(z, fma(z, q, value(0xbfd5555555555555u)), 1.0);
    const bool odd = is_odd(s.quarters);
    const double quotient = divide(select(odd, divisor, r), select(odd, r, divisor));
    return value(bits(quotient) ^ (s.quarters << 63) ^ sign_bit(x));
  }

  /// r/tan r from z = r^2.
  LUMEN_MAIN double denominator(double z) {
    if constexpr (t == tier::la) {
      const double p = horner(z, 0xbe2aa44944d3bdabu, 0xbe56949700bbc9c7u, 0xbe8d8c2b7da62111u,
                              0xbec2272be7d1c53cu, 0xbef66a96aa289b0eu, 0xbf2bbd776b2f9531u,
                              0xbf61566abc3e5adbu, 0xbf96c16c16c10cecu, 0xbfd5555555555572u);
      return fma(z, p, 1.0);
    } else {
      return horner(z, 0xbf30473bc9951ab8u, 0xbf612b43c92fe3c3u, 0xbf96c2a27abdad92u,
                    0xbfd55553d0e3f982u, 0x3feffffffd92bc1eu);
    }
  }

  /// Of a number in the range of float.
  LUMEN_MAIN double reciprocal(double x) {
    auto c = static_cast<double>(divide(1.0f, static_cast<float>(x)));
    c = fma(c, fma(c, -x, 1.0), c);
    return fma(c, fma(c, -x, 1.0), c);
  }
};

/// `ha`: x = n pi/16 + r in two words, and the addition formula in two words with a table of the
/// tangents of n pi/16. The pole's row has a number so large that the formula gives -1/tan r by
/// itself. Beyond 65536.003 the same behind rows of 192 bits of 1/(2 pi). Largest error 0.52 ulp.
template <>
struct tan_d<tier::ha> : scalar_v11<tan_d<tier::ha>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const double shifter = value(0x4338000000000000u);  // 3·2^51
    const double shifted = fma(x, value(0x40145f306dc9c883u), shifter);
    const double n = shifted - shifter;
    const double t1 = fma(-n, value(0x3fc921fb54442d18u), x);
    const double t2 = fma(-n, value(0x3c61a62633000000u), t1);
    const double r = fma(-n, value(0x3a645c06e0e68948u), t2);
    const double low =
        fma(-n, value(0x3c61a62633000000u), t1 - t2) - fma(n, value(0x3a645c06e0e68948u), r - t2);
    const double y = of_sixteenth(static_cast<std::int64_t>(bits(shifted) & 15u), r, low);
    // The sum with the row's -0 loses the sign of -0.
    return {select(x == 0.0, x, y), flag_if<double>(!(fabs(x) <= value(0x40f000000e4db24cu)))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    if (is_special(x)) return product_of_special(x, y);
    *y = of_step(turn_step::nearest(x));
    return mask(code::none);
  }

  LUMEN_MAIN main_result<double> beyond(double x) {
    return {of_step(turn_step::nearest(x)), flag_if<double>(is_special(x))};
  }

 private:
  LUMEN_MAIN double of_step(const turn_step& a) {
    // From the step of pi/256 to the nearest one of pi/16, the half going by the sign of the rest.
    const std::int32_t behind = select(a.rest < 0, 1, 0);
    const std::int32_t centred = a.step - behind + 8;
    const auto steps = static_cast<double>(a.step - (centred & ~15));
    const double unit = value(0x3f8921fb54442d18u);  // pi/256
    const double r = fma(steps, unit, a.rest);
    const double error = a.rest - fma(-steps, unit, r);
    const double low = fma(steps, value(0x3c21a62633145c07u), error) + a.rest_low;
    return of_sixteenth((centred >> 4) & 15, r, low);
  }

  /// tan(k pi/16 + r + low).
  LUMEN_MAIN double of_sixteenth(std::int64_t k, double r, double low) {
    const double t = value(internal_dtan_ha_data[6 + k]);
    const double t_low = value(internal_dtan_ha_data[22 + k]);
    const double z = r * r;
    const double p = horner(z, 0x3f825cccc7c9fa5du, 0x3f9664ab664efba9u, 0x3faba1ba489d25cau,
                            0x3fc11111110b0802u, 0x3fd55555555555dcu);
    // tan(r + low) = u + u_low
    const double v = fma(-fma(p, r, 0.0), z, -low);
    const double u = r - v;
    const double u_low = (r - u) - v;
    // The quotient of (t + u) and (1 - t u), each in two words; the lower one of the divisor is
    // subtracted.
    const double top = u + t;
    const double top_low = ((u - (top - t)) + t_low) + u_low;
    const double divisor = fma(-t, u, 1.0);
    const double divisor_low = fma(t_low, u, fma(t, u_low, fma(t, u, divisor - 1.0)));
    const double c = reciprocal(divisor, divisor_low);
    const double q = fma(c, top, 0.0);
    const double remainder = fma(-divisor_low, q, fma(divisor, q, -top)) - top_low;
    return fma(-remainder, c, q);
  }

  /// 1/(d - d_low) from the reciprocal of d's mantissa at float.
  LUMEN_MAIN double reciprocal(double d, double d_low) {
    const std::uint64_t exponent = bits(d) & format<double>::special;
    const double mantissa = value((bits(d) & ~format<double>::special) | format<double>::one);
    const double inverse = divide(1.0f, static_cast<float>(mantissa));
    const double scale = value(2 * format<double>::one - exponent);
    const double c = fma(scale, inverse, 0.0);
    return fma(c, fma(c, d_low, fma(-c, d, 1.0)), c);
  }
};

using tan_h = half_v11<tan_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
