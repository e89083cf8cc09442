// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// ln(1 + r) for 1 + r in [2/3, 4/3), as `la` and `ep` have it, float.
template <tier t>
LUMEN_MAIN float ln_of_one_plus(float r) {
  float q;
  if constexpr (t == tier::ep)
    q = horner(r, 0x3e612933u, 0xbe88e8feu, 0x3eaa7160u, 0xbf000000u);
  else
    q = horner(r, 0x3e0d84edu, 0xbe1ad9e3u, 0x3e0fcb12u, 0xbe28ad37u, 0x3e4ce190u, 0xbe80058eu,
               0x3eaaaa94u, 0xbf000000u);
  q = fma(q, r, 0.0f);
  return fma(q, r, r);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
