// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/log/reduction.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// What the logarithms whose main path serves denormals leave over: zeros, negative numbers,
/// infinities, NaNs. A NaN with its sign bit set counts as negative, code 1.
LUMEN_MAIN bool not_positive_finite(double x) {
  return is_outside(x, 0x0000000000000001u, 0x7fefffffffffffffu);
}

LUMEN_DEVICE inline std::uint32_t log_of_zero_or_negative(double x, double* y) {
  if (x == 0) {
    *y = value(0xfff0000000000000u);
    return mask(code::pole);
  }
  if (sign_bit(x) != 0) {
    *y = value(bits(x) | 0xfff8000000000000u);
    return mask(code::domain);
  }
  *y = x + (is_nan(x) ? x : -0.0);
  return mask(code::none);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
