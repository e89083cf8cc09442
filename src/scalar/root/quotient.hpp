// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// x/y as the rare path of a quotient: code 2 for every division by zero, that of a zero or a NaN
/// included.
template <typename T>
LUMEN_DEVICE inline std::uint32_t quotient_by_division(T x, T y, T* result) {
  *result = divide(x, y);
  return mask(y == 0 ? code::pole : code::none);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
