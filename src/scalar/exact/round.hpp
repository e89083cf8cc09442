// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/big_number_rounding.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// round(x): x rounded to the nearest integer, ties away from zero, exact in every tier, status 0.
/// The nearest integer by ties to even is one too low exactly where a tie went down.
template <typename T>
LUMEN_DEVICE inline T tie_raised(T a, T even) {
  return even + select(a - even == T(0.5), T(1), T(0));
}

struct round_s : scalar_v11<round_s, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float a = fabs(x);
    return {or_sign(tie_raised(a, rint(a)), x)};
  }
};

struct round_d : scalar_v11<round_d, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const double a = fabs(x);
    return {or_sign(tie_raised(a, select(is_big(x), a, nearest_integer(a))), x)};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
