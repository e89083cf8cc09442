// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/trig/half_turn.hpp"
#include "scalar/trig/half_turn_sine.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// cos, float. Code 1 for infinities; their NaN, as that of NaNs, is the argument's pattern made
/// quiet.
///
/// `la` and `ep`: the sine of what x + pi/2 leaves to the nearest multiple of pi, with pi in three
/// and two parts, degree 9 and 5. Beyond 10000 the fixed point of `ha`. Largest error COSSLA and
/// COSSEP ulp.
template <tier t>
struct cos_s : scalar_v11<cos_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float a = fabs(x);
    const auto next = rest_of_quarter_turn_next < t == tier::la ? 3 : 2 > (a);
    return {one_if_hidden(next, sine(next.rest)), flag_if<float>(!(a <= value(0x461c4000u)))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) { return half_turn_sine::any_cosine(x, y); }

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

/// `ha`: fixed point. Largest error COSSHA ulp.
template <>
struct cos_s<tier::ha> : scalar_v11<cos_s<tier::ha>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float y = select(is_below_fixed_turn(x), 1.0f, half_turn_sine::cosine(x));
    return {y, flag_if<float>(is_above_fixed_turn(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) { return half_turn_sine::any_cosine(x, y); }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
