// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Whether the integer in the low bits of a pattern is odd. By a shift: GCC makes a cast to bool of
/// a test of the lowest bit, which it does not vectorise.
template <typename U>
LUMEN_MAIN bool is_odd(U n) {
  return (n << (8 * sizeof(U) - 1)) != 0;
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
