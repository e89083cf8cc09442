// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The rule by which a two-operand comparison function treats NaNs: if y is a NaN the result is x;
/// then if x is a NaN the result is y. So a number wins over a NaN, and of two NaNs it is y.
/// `ordered` is the result for operands that are both numbers.
template <typename T>
LUMEN_DEVICE inline T nan_rule(T x, T y, T ordered) {
  const T without_y = select(is_nan(y), x, ordered);
  return select(is_nan(x), y, without_y);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
