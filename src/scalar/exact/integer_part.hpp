// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/big_number_rounding.hpp"
#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The result of a rounding operation at x, or x quietened if it is a NaN: the operations of some
/// machines pass a signalling NaN through, unlike any arithmetic.
LUMEN_DEVICE inline float with_quiet_nan(float x, float rounded) {
  return select(is_nan(x), x + x, rounded);
}

/// x without its fraction: by the rounding operation at float, by the big number at double.
LUMEN_DEVICE inline float integer_part(float x) { return with_quiet_nan(x, trunc(x)); }
LUMEN_DEVICE inline double integer_part(double x) { return big_number_trunc(x); }

/// The integer nearest to x, ties to even.
LUMEN_DEVICE inline float nearest_integer_part(float x) { return with_quiet_nan(x, rint(x)); }
LUMEN_DEVICE inline double nearest_integer_part(double x) { return big_number_rint(x); }

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
