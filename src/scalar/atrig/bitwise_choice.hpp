// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Choices by a mask, for where several depend on one condition: of the conditional form GCC makes
/// one branch around them, and then does not vectorise the loop.
#pragma once

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// All bits set if `c`, otherwise none.
template <typename T>
LUMEN_MAIN uint_of<T> mask_of(bool c) {
  return uint_of<T>{0} - static_cast<uint_of<T>>(c);
}

/// `a` where the mask is set, otherwise `b`.
template <typename T>
LUMEN_MAIN T chosen(uint_of<T> mask, T a, T b) {
  return value((bits(a) & mask) | (bits(b) & ~mask));
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
