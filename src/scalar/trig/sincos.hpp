// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/trig/fixed_turn.hpp"
#include "scalar/trig/half_turn.hpp"
#include "scalar/trig/half_turn_cosine.hpp"
#include "scalar/trig/parity.hpp"
#include "scalar/trig/quarter_turn.hpp"
#include "scalar/trig/quarter_turn_kernels.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// sincos, float: sine, then cosine, from the place in the turn in fixed point and the rest to the
/// nearest quarter turn. Code 1 for infinities; in both results their NaN, as that of NaNs, is the
/// argument's pattern made quiet.
///
/// `la` and `ep` are one body: degree 7 and 8 in one word. `ha` has the terms of degree 0 to 2 in
/// two words. Largest error 2.5 and 0.66 ulp.
template <tier t>
struct sincos_s : scalar_v12<sincos_s<t>, float> {
  LUMEN_MAIN main_result2<float> main(float x) {
    const pair of_range = of_place(fixed_turn(x), x);
    const bool below = is_below_fixed_turn(x);
    return {select(below, x, of_range.sine), select(below, 1.0f, of_range.cosine),
            flag_if<float>(is_above_fixed_turn(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* sine, float* cosine) {
    if (is_special(x)) {
      const std::uint32_t status = of_special(x, sine);
      *cosine = *sine;
      return status;
    }
    const pair y = of_place(fixed_turn_by_table(x), x);
    *sine = y.sine;
    *cosine = y.cosine;
    return mask(code::none);
  }

 private:
  struct pair {
    float sine;
    float cosine;
  };

  LUMEN_MAIN pair of_place(std::uint64_t place, float x) {
    const auto quarters = static_cast<std::uint32_t>(place >> 32) + 0x20000000u;
    const bool swapped = (quarters & 0x40000000u) != 0;
    const pair kernels = of_rest(rest_of_turn<2>(place));
    const float sine = value(bits(kernels.sine) ^ ((quarters ^ (quarters << 1)) & 0x80000000u));
    const float cosine = value(bits(kernels.cosine) ^ (quarters & 0x80000000u));
    const float first = select(swapped, cosine, sine);
    return {value(bits(first) ^ sign_bit(x)), select(swapped, sine, cosine)};
  }

  LUMEN_MAIN pair of_rest(const turn_rest& a) {
    if constexpr (t == tier::ha) {
      const float_float v = square(a);
      const float_float cosine = cosine_of_half_turns(v);
      const float p = horner(v.high, 0xbf16c981u, 0x40232f49u, 0xc0a55dddu);
      const float_float c = horner_step({p, 0.0f}, v, value(0x40490fdbu), value(0xb3d195e9u));
      const float_float sine = times_rest(c, a);
      return {sine.high + sine.low, cosine.high + cosine.low};
    } else {
      const float v = a.u * a.u;
      const float p = horner(v, 0xbf16c981u, 0x40232f49u, 0xc0a55dddu, 0x40490fdbu);
      const float q = horner(v, 0x3e6ce1b2u, 0xbfaae2beu, 0x4081e0eeu, 0xc09de9e6u, 0x3f800000u);
      return {p * a.u, q};
    }
  }
};

/// sincos, double: sine, then cosine. x - n pi/2, and a polynomial for each; from 2^20 the same
/// behind a reduction in fixed point. Code 1 for infinities, the negative NaN in both results; a
/// NaN loses its sign.
///
/// `ha`: the rest in two words, degree 13 and 14, the cosine with the rounding error of its square.
/// `la`: pi in three parts, the same polynomials in one word. `ep`: pi in two parts, degree 7
/// and 8. Largest error 0.86, 1.5 and 2.8e7 ulp. The two parts leave 2^-85 of pi: below 2^20 and
/// closer than n 2^-58 to the n-th zero, the sine or cosine of `ep` has fewer than 26 bits.
template <tier t>
struct sincos_d : scalar_v12<sincos_d<t>, double> {
  LUMEN_MAIN main_result2<double> main(double x) {
    const double a = fabs(x);
    const auto s = reduce(a);
    const pair y = of_quarter(s.quarters, s.rest, s.rest_low, x);
    return {y.sine, y.cosine, flag_if<double>(is_beyond_short_quarter_turns(a))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* sine, double* cosine) {
    if (is_special(x)) {
      const std::uint32_t status = quiet_of_special(x, sine);
      *cosine = *sine;
      return status;
    }
    const auto s = quarter_turn::nearest(fabs(x));
    const pair y = of_quarter(s.quarters, s.rest, s.rest_low, x);
    *sine = y.sine;
    *cosine = y.cosine;
    return mask(code::none);
  }

 private:
  struct pair {
    double sine;
    double cosine;
  };

  LUMEN_MAIN short_quarter_turn reduce(double a) {
    if constexpr (t == tier::ha) {
      return short_quarter_turn::by_products(a);
    } else {
      return short_quarter_turn::in_one_word<parts_of_pi<t>>(a);
    }
  }

  LUMEN_MAIN pair of_quarter(std::uint64_t quarters, double r, double low, double x) {
    const pair kernels = of_rest(r, low);
    const bool odd = is_odd(quarters);
    const double sine = select(odd, kernels.cosine, kernels.sine);
    const double cosine = select(odd, kernels.sine, kernels.cosine);
    const std::uint64_t half = quarters << 62;
    return {value(bits(sine) ^ ((half ^ bits(x)) & format<double>::sign)),
            value(bits(cosine) ^ ((half ^ (quarters << 63)) & format<double>::sign))};
  }

  LUMEN_MAIN pair of_rest(double r, double low) {
    const double z = r * r;
    if constexpr (t == tier::ha) {
      return {sine_kernel(r, low, quarter_turn_series::of_sine(z) * z),
              cosine_kernel(r, low, z, quarter_turn_series::of_cosine(z) * z)};
    } else if constexpr (t == tier::la) {
      const double cosine = fma(quarter_turn_series::of_cosine(z), z, -0.5);
      return {fma(r, quarter_turn_series::of_sine(z) * z, r), fma(cosine, z, 1.0)};
    } else {
      return {short_sine_series(r, z), short_cosine_series(z)};
    }
  }
};

using sincos_h = half_v12<sincos_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
