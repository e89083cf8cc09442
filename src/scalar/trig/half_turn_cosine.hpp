// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/horner.hpp"
#include "scalar/trig/fixed_turn.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// cos(pi u) for |u| <= 1/4 from v = u^2, float: degree 8 in u, with the terms of degree 0 and 2 in
/// two words.
LUMEN_MAIN float_float cosine_of_half_turns(float_float v) {
  const float p = horner(v.high, 0x3e6ce1b2u, 0xbfaae2beu, 0x4081e0eeu);
  const float_float c2 = horner_step({p, 0.0f}, v, value(0xc09de9e6u), value(0xb3e646a5u));
  return horner_step(c2, v, 1.0f, 0.0f);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
