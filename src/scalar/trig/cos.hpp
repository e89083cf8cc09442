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

/// cos, float. Code 1 for infinities; their NaN, as that of NaNs, is the argument's pattern made
/// quiet.
///
/// `la` and `ep`: the sine of what x + pi/2 leaves to the nearest multiple of pi, with pi in three
/// and two parts, degree 9 and 5. Beyond 10000 the fixed point of `ha`. Largest error 2.4 and
/// 2536 ulp.
template <tier t>
struct cos_s : scalar_v11<cos_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float a = fabs(x);
    const auto next = rest_of_quarter_turn_next<parts_of_pi<t>>(a);
    return {one_if_hidden(next, sine(next.rest)), flag_if<float>(!(a <= value(0x461c4000u)))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) { return half_turn_sine::any_cosine(x, y); }

  LUMEN_MAIN main_result<float> beyond(float x) { return half_turn_sine::finite_cosine(x); }

 private:
  LUMEN_MAIN float sine(float r) {
    const float z = r * r;
    if constexpr (t == tier::la) {
      const float p = horner(z, 0x362ec335u, 0xb94fb6cfu, 0x3c088764u, 0xbe2aaaa6u);
      return fma(p * z, r, r);
    } else {
      const float p = horner(z, 0x3bf84524u, 0xbe29e73fu);
      return fma(r * z, p, r * value(0x3f7ff87cu));
    }
  }
};

/// `ha`: fixed point. Largest error 0.59 ulp.
template <>
struct cos_s<tier::ha> : scalar_v11<cos_s<tier::ha>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float y = select(is_below_fixed_turn(x), 1.0f, half_turn_sine::cosine(x));
    return {y, flag_if<float>(is_above_fixed_turn(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) { return half_turn_sine::any_cosine(x, y); }

  LUMEN_MAIN main_result<float> beyond(float x) { return half_turn_sine::finite_cosine(x); }

  template <std::int64_t length>
  static bool block(const float* x, float* y) {
    return half_turn_sine_block::cosine<length>(x, y);
  }
};

/// cos, double. Code 1 for infinities.
///
/// `la` and `ep`: the sine of what pi/2 - x leaves to the nearest multiple of pi, with pi in three
/// and two parts, degree 15 and 9; largest error 3.5 and 6.2e7 ulp. Where pi/2 - |x| is beyond
/// 2^23, `la` goes on with rows of tables, within 0.51 ulp, and `ep` with the expansion of 4/pi in
/// doubles, within 1.2 ulp.
template <tier t>
struct cos_d : scalar_v11<cos_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const auto next = rest_of_quarter_turn_next<parts_of_pi<t>>(fabs(x));
    const double r = next.rest;
    const double z = r * r;
    const double y = fma(polynomial(z) * z, r, r);
    return {one_if_hidden(next, y),
            flag_if<double>(!(fabs(next.quarter) <= value(0x4160000000000000u)))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    if (is_special(x)) return product_of_special(x, y);
    if constexpr (t == tier::la) {
      *y = sine_of_step(turn_step::nearest(x), 128);
    } else {
      *y = sine_of_octants(octant_rest::of(x), 16);
    }
    return mask(code::none);
  }

  LUMEN_MAIN main_result<double> beyond(double x) {
    if constexpr (t == tier::la) {
      return {sine_of_step(turn_step::nearest(x), 128), flag_if<double>(is_special(x))};
    } else {
      return {sine_of_octants(octant_rest::of_sliced(x), 16),
              flag_if<double>(octant_rest::is_not_sliced(x))};
    }
  }

 private:
  LUMEN_MAIN double polynomial(double z) {
    if constexpr (t == tier::la) {
      return horner(z, 0xbd69f0d60811aac8u, 0x3de60e6857a2f220u, 0xbe5ae63546002231u,
                    0x3ec71de38030fea0u, 0xbf2a01a019a5b87bu, 0x3f8111111110a4a8u,
                    0xbfc55555555554a7u);
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
struct cos_d<tier::ha> : scalar_v11<cos_d<tier::ha>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const double a = fabs(x);
    const auto s = short_quarter_turn::of(a);
    const double r = s.rest;
    const double z = r * r;
    const bool even = !is_odd(s.quarters);
    const double q = quarter_turn_series::of_either(even, z) * z;
    const double y =
        select(even, cosine_kernel(r, s.rest_low, z, q), sine_kernel(r, s.rest_low, q));
    return {value(bits(y) ^ sign(s.quarters)), flag_if<double>(is_beyond_short_quarter_turns(a))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    if (is_special(x)) return quiet_of_special(x, y);
    *y = long_cosine(quarter_turn::nearest(fabs(x)));
    return mask(code::none);
  }

  LUMEN_MAIN main_result<double> beyond(double x) {
    bool next_to_quarter;
    const auto s = quarter_turn::nearest_without_branch(fabs(x), next_to_quarter);
    return {long_cosine(s), flag_if<double>(next_to_quarter, is_special(x))};
  }

 private:
  LUMEN_MAIN double long_cosine(const quarter_turn& s) {
    const double y = select(is_odd(s.quarters), long_sine_kernel(s.rest, s.rest_low),
                            long_cosine_kernel(s.rest, s.rest_low));
    return value(bits(y) ^ sign(s.quarters));
  }

  /// Negative in the second and third quadrant.
  LUMEN_MAIN std::uint64_t sign(std::uint64_t quarters) {
    return ((quarters ^ (quarters >> 1)) << 63);
  }
};

/// cos, half; one body for all tiers, within 0.51 ulp.
using cos_h = half_v11<cosine_of_half>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
