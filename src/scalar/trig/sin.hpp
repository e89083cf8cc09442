// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/trig/half_sine.hpp"
#include "scalar/trig/half_turn.hpp"
#include "scalar/trig/half_turn_sine.hpp"
#include "scalar/trig/half_turn_sine_block.hpp"
#include "scalar/trig/octants.hpp"
#include "scalar/trig/parity.hpp"
#include "scalar/trig/quarter_turn.hpp"
#include "scalar/trig/quarter_turn_kernels.hpp"
#include "scalar/trig/turn_rows.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// sin, float. Code 1 for infinities; their NaN, as that of NaNs, is the argument's pattern made
/// quiet.
///
/// `la` and `ep`: x - n pi with pi in three and two parts, degree 9 and 5. Beyond 10000 the fixed
/// point of `ha`. Largest error 2.4 and 2525 ulp.
template <tier t>
struct sin_s : scalar_v11<sin_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float a = fabs(x);
    const float r = rest_of_half_turns<parts_of_pi<t>>(a);
    return {value(bits(sine(r)) ^ sign_bit(x)), flag_if<float>(!(a <= value(0x461c4000u)))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) { return half_turn_sine::any_sine(x, y); }

  LUMEN_MAIN main_result<float> beyond(float x) { return half_turn_sine::finite_sine(x); }

 private:
  LUMEN_MAIN float sine(float r) {
    const float z = r * r;
    if constexpr (t == tier::la) {
      const float p = horner(z, 0x362edef8u, 0xb94fb7ffu, 0x3c088766u, 0xbe2aaaa6u);
      return fma(p * z, r, r);
    } else {
      const float p = horner(z, 0x3bf84524u, 0xbe29e72fu);
      return fma(r * z, p, r * value(0x3f7ff87cu));
    }
  }
};

/// `ha`: fixed point. Largest error 0.59 ulp.
template <>
struct sin_s<tier::ha> : scalar_v11<sin_s<tier::ha>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float y = select(is_below_fixed_turn(x), x, half_turn_sine::sine(x));
    return {y, flag_if<float>(is_above_fixed_turn(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) { return half_turn_sine::any_sine(x, y); }

  LUMEN_MAIN main_result<float> beyond(float x) { return half_turn_sine::finite_sine(x); }

  template <std::int64_t length>
  static bool block(const float* x, float* y) {
    return half_turn_sine_block::sine<length>(x, y);
  }
};

/// sin, double. Code 1 for infinities.
///
/// `la` and `ep`: x - n pi with pi in three and two parts, degree 15 and 9; largest error 3.4 and
/// 6.2e7 ulp. Beyond 2^24 `la` goes on with rows of tables, within 0.51 ulp, and `ep` with the
/// expansion of 4/pi in doubles, within 1.2 ulp.
template <tier t>
struct sin_d : scalar_v11<sin_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const double a = fabs(x);
    const double r = rest_of_half_turns<parts_of_pi<t>>(a);
    const double z = r * r;
    const double y = fma(polynomial(z) * z, r, r);
    return {value(bits(y) ^ sign_bit(x)), flag_if<double>(!(a <= value(0x4170000000000000u)))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    if (is_special(x)) return product_of_special(x, y);
    if constexpr (t == tier::la) {
      const double sine = sine_of_step(turn_step::nearest(fabs(x)), 0);
      *y = value(bits(sine) ^ sign_bit(x));
    } else {
      *y = sine_of_octants(octant_rest::of(x), 0);
    }
    return mask(code::none);
  }

  LUMEN_MAIN main_result<double> beyond(double x) {
    if constexpr (t == tier::la) {
      const double sine = sine_of_step(turn_step::nearest(fabs(x)), 0);
      return {value(bits(sine) ^ sign_bit(x)), flag_if<double>(is_special(x))};
    } else {
      return {sine_of_octants(octant_rest::of_sliced(x), 0),
              flag_if<double>(octant_rest::is_not_sliced(x))};
    }
  }

 private:
  LUMEN_MAIN double polynomial(double z) {
    if constexpr (t == tier::la) {
      return horner(z, 0xbd69f1517e9f65f0u, 0x3de60e6bee01d83eu, 0xbe5ae6355aaa4a53u,
                    0x3ec71de3806add1au, 0xbf2a01a019a659ddu, 0x3f8111111110a573u,
                    0xbfc55555555554a8u);
    } else {
      return horner(z, 0x3ec5d4567512bbd5u, 0xbf29f67d9395d587u, 0x3f8110ea968a0185u,
                    0xbfc55554ad3eaf1fu);
    }
  }
};

/// `ha`: the nearest quarter turn in two words, degree 13 and 14. From 2^20 the same kernels behind
/// a reduction in fixed point. The NaN of an infinity is the negative one, and a NaN loses its
/// sign. Largest error 0.86 ulp.
template <>
struct sin_d<tier::ha> : scalar_v11<sin_d<tier::ha>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const double a = fabs(x);
    const auto s = short_quarter_turn::of(a);
    const double r = s.rest;
    const double z = r * r;
    const bool odd = is_odd(s.quarters);
    const double q = quarter_turn_series::of_either(odd, z) * z;
    const double y = select(odd, cosine_kernel(r, s.rest_low, z, q), sine_kernel(r, s.rest_low, q));
    const std::uint64_t sign = ((s.quarters << 62) ^ bits(x)) & format<double>::sign;
    return {value(bits(y) ^ sign), flag_if<double>(is_beyond_short_quarter_turns(a))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    if (is_special(x)) return quiet_of_special(x, y);
    *y = long_sine(quarter_turn::nearest(fabs(x)), x);
    return mask(code::none);
  }

  LUMEN_MAIN main_result<double> beyond(double x) {
    bool next_to_quarter;
    const auto s = quarter_turn::nearest_without_branch(fabs(x), next_to_quarter);
    return {long_sine(s, x), flag_if<double>(next_to_quarter, is_special(x))};
  }

 private:
  LUMEN_MAIN double long_sine(const quarter_turn& s, double x) {
    const double y = select(is_odd(s.quarters), long_cosine_kernel(s.rest, s.rest_low),
                            long_sine_kernel(s.rest, s.rest_low));
    return value(bits(y) ^ (((s.quarters << 62) ^ bits(x)) & format<double>::sign));
  }
};

/// sin, half; one body for all tiers, within 0.51 ulp.
using sin_h = half_v11<sine_of_half>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
