// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/trig/half_turn.hpp"
#include "scalar/trig/half_turn_sine.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// sin, float. Code 1 for infinities; their NaN, as that of NaNs, is the argument's pattern made
/// quiet.
///
/// `la` and `ep`: x - n pi with pi in three and two parts, degree 9 and 5. Beyond 10000 the fixed
/// point of `ha`. Largest error SINSLA and SINSEP ulp.
template <tier t>
struct sin_s : scalar_v11<sin_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float a = fabs(x);
    const float r = rest_of_half_turns < t == tier::la ? 3 : 2 > (a);
    return {value(bits(sine(r)) ^ sign_bit(x)), flag_if<float>(!(a <= value(0x461c4000u)))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) { return half_turn_sine::any_sine(x, y); }

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

/// `ha`: fixed point. Largest error SINSHA ulp.
template <>
struct sin_s<tier::ha> : scalar_v11<sin_s<tier::ha>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float y = select(is_below_fixed_turn(x), x, half_turn_sine::sine(x));
    return {y, flag_if<float>(is_above_fixed_turn(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) { return half_turn_sine::any_sine(x, y); }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
