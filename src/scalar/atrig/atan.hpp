// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/atrig/arctangent_polynomial.hpp"
#include "scalar/atrig/bitwise_choice.hpp"
#include "scalar/atrig/half_angle.hpp"
#include "scalar/atrig/quadrant.hpp"
#include "scalar/atrig/tangent_reduction.hpp"
#include "scalar/half.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/datan.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// All bits set if the sign bit of the difference of two patterns is.
LUMEN_MAIN std::uint32_t sign_mask(std::uint32_t difference) {
  return static_cast<std::uint32_t>(static_cast<std::int32_t>(difference) >> 31);
}

/// atan, float; status 0 for every argument. Largest error 0.98, 3.3 and 2.3e3 ulp for `ha`, `la`,
/// `ep`.
template <tier t>
struct atan_s;

/// `la`: pi/2 + arctan(-1/a) for a >= 1, degree 7 in the square.
///
/// The difference of the patterns of a and of -1/a has its sign bit set where a >= 1/a: subtracting
/// what that mask keeps of it leaves the one or the other.
template <>
struct atan_s<tier::la> : scalar_v11<atan_s<tier::la>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float a = fabs(x);
    const std::uint32_t difference = bits(a) - bits(divide(-1.0f, a));
    const std::uint32_t m = sign_mask(difference);
    const float r = value(bits(a) - (difference & m));
    const float angle = fma(arctangent_factor(r * r), r, value(m & pi_words<float>::half));
    return {value(bits(angle) ^ sign_bit(x))};
  }
};

/// `ep`: r = min(a, 1/a), degree 4 in r. Beyond 1 the sum is arctan(1/a) - pi/2, and the mask
/// brings the sign back.
template <>
struct atan_s<tier::ep> : scalar_v11<atan_s<tier::ep>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float a = fabs(x);
    const std::uint32_t difference = bits(divide(1.0f, a)) - bits(a);
    const std::uint32_t m = sign_mask(difference);
    const float r = value(bits(a) + (difference & m));
    const float base = value(m & (format<float>::sign | pi_words<float>::half));
    const float angle = fma(r, arctangent_factor_ep(r), base);
    return {value(bits(angle) ^ sign_bit(value(m ^ bits(x))))};
  }
};

/// `ha`: as `ep`, with the error of the reciprocal carried along and degree 11 in r - 1/2.
///
/// Without its bit 30 a pattern is that of a number below 2 in magnitude: it leaves the small error
/// as it is, and makes a number of the NaN that an infinite reciprocal gives.
template <>
struct atan_s<tier::ha> : scalar_v11<atan_s<tier::ha>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    constexpr std::uint32_t below_two = 0xbfffffffu;
    const float a = fabs(x);
    const float reciprocal = divide(1.0f, a);
    const std::uint32_t difference = bits(reciprocal) - bits(a);
    const std::uint32_t m = sign_mask(difference);
    const float r = value(bits(a) + (difference & m));
    const float f = value(bits(fma(-a, reciprocal, 1.0f)) & below_two);
    const float low = value((m & below_two) & bits(reciprocal * f));
    const float p = arctangent_rest_at_half((r - 0.5f) + low);
    const float rest = fma(r, p, fma(p, low, low) + value(m & 0x333bbd2eu));
    const float base = value(m & (format<float>::sign | pi_words<float>::half));
    const float angle = (rest + r) + base;
    return {value(bits(angle) ^ ((m ^ bits(x)) & format<float>::sign))};
  }
};

/// atan, double; status 0 for every argument. Largest error 0.85, 1.9 and 2.2e7 ulp for `ha`, `la`,
/// `ep`.
template <tier t>
struct atan_d;

/// `la`: arctan b + arctan((a - b)/(1 + ab)) for the multiple b of 1/4 next to a, with b from a
/// shifter and arctan b from a table; from 7.875 pi/2 + arctan(-1/a), a clamped so that infinity
/// needs no case of its own.
template <>
struct atan_d<tier::la> : scalar_v11<atan_d<tier::la>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const double a = fabs(x);
    const double shifter = value(0x4318000000000000u);  // 3·2^49, unit 1/4
    const double shifted = a + shifter;
    const double b = shifted - shifter;
    const auto inverted = mask_of<double>(a >= 7.875);
    const double clamped = select(a < 0x1p128, a, 0x1p128);
    const double numerator = chosen(inverted, -1.0, a - b);
    const double denominator = chosen(inverted, clamped, fma(a, b, 1.0));
    const auto row = static_cast<std::int32_t>(bits(shifted) & 31u);
    const double arctan_b = value(internal_datan_la_data_avx512[row]);
    const double base = chosen(inverted, value(pi_words<double>::half), arctan_b);
    const double t = divide(numerator, denominator);
    const double angle = fma(polynomial(t * t), (t * t) * t, t) + base;
    return {value(bits(angle) ^ sign_bit(x))};
  }

 private:
  /// (arctan(t)/t - 1)/z for |t| <= 1/8.
  LUMEN_MAIN double polynomial(double z) {
    const double z2 = z * z;
    const double p5 = fma(z, value(0x3fb2e9b9f5c4fe97u), value(0xbfb74257c46790ccu));
    const double p3 = fma(z, value(0x3fbc71bfeff916a0u), value(0xbfc249248eef04dau));
    const double p1 = fma(z, value(0x3fc999999998741eu), value(0xbfd555555555554du));
    return fma(fma(p5, z2, p3), z2, p1);
  }
};

/// Without a table: x itself up to 1, pi/2 + arctan(-1/x) beyond. Largest error 2.3 ulp.
struct atan_d_nolut : scalar_v11<atan_d_nolut, double> {
  static constexpr int interleave = 4;

  LUMEN_MAIN main_result<double> main(double x) {
    const bool direct = fabs(x) <= 1.0;
    const double t = select(direct, x, divide(-1.0, x));
    const double head = or_sign(select(direct, 0.0, value(pi_words<double>::half)), x);
    return {fma(arctangent_factor(t * t), t, head)};
  }
};

/// `ep`: the same with degree 9 and the float reciprocal, corrected once.
template <>
struct atan_d<tier::ep> : scalar_v11<atan_d<tier::ep>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const auto r = short_reciprocal::of(x);
    const double head = or_sign(value(~r.direct & pi_words<double>::half), x);
    return {fma(arctangent_factor_ep(r.t * r.t), r.t, head), flag_if<double>(is_special(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    *y = is_nan(x) ? x + x : or_sign(value(pi_words<double>::half), x);
    return mask(code::none);
  }
};

/// `ha`: five segments, arctan k + arctan((a - k)/(1 + ka)) with k = 0, 1/2, 1, 3/2, and pi/2 +
/// arctan(-1/a) for the last.
///
/// The rare path serves a < 2^-1020 and a >= 2^993, where the result is x and pi/2 to the last bit:
/// it needs no table.
template <>
struct atan_d<tier::ha> : scalar_v11<atan_d<tier::ha>, double> {
  static constexpr int interleave = 4;

  LUMEN_MAIN main_result<double> main(double x) {
    const auto s = tangent_segment::of(fabs(x), internal_datan_ha_data);
    const double z = s.t * s.t;
    const double angle = s.high + (s.t + fma(arctangent_rest_of_segment(z), z * s.t, s.low));
    return {value(bits(angle) ^ sign_bit(x)), flag_if<double>(is_extreme(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    if (is_nan(x)) {
      *y = x + x;
    } else {
      *y = fabs(x) < 1.0 ? x : or_sign(value(pi_words<double>::half), x);
    }
    return mask(code::none);
  }
};

/// atan, half: the float body of `ep` in every tier.
using atan_h = half_v11<atan_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
