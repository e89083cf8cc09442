// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/horner.hpp"
#include "scalar/trig/fixed_turn.hpp"
#include "scalar/trig/half_sine_constants.hpp"
#include "scalar/trig/half_turn.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Sine and cosine for halves, in float and narrowed once: what is left to the nearest multiple of
/// pi, with pi in two parts, which suffice for the largest half, and degree 7. Code 1 for
/// infinities; their NaN, as that of NaNs, is the argument's pattern made quiet.
template <typename Body>
struct half_sine : scalar_v11<Body, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float r = Body::rest(fabs(x));
    const float z = r * r;
    const float p = horner(z, half_sine_cubic[2], half_sine_cubic[1], half_sine_cubic[0]);
    const float y = fma(p * z, r, r);
    return {Body::with_sign(y, x), flag_if<float>(is_special(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) { return of_special(x, y); }
};

struct sine_of_half : half_sine<sine_of_half> {
  LUMEN_MAIN float rest(float a) { return rest_of_half_turns<2>(a); }
  LUMEN_MAIN float with_sign(float y, float x) { return value(bits(y) ^ sign_bit(x)); }
};

struct cosine_of_half : half_sine<cosine_of_half> {
  LUMEN_MAIN float rest(float a) { return rest_of_quarter_turn_next<2>(a).rest; }
  LUMEN_MAIN float with_sign(float y, float) { return y; }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
