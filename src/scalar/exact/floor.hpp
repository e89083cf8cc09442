// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/big_number_rounding.hpp"
#include "scalar/exact/integer_part.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// floor(x): the largest integer not above x, exact in every tier, status 0; floor(-0) is -0.
struct floor_s : scalar_v11<floor_s, float> {
  LUMEN_MAIN main_result<float> main(float x) { return {with_quiet_nan(x, floor(x))}; }
};

struct floor_d : scalar_v11<floor_d, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const double v = or_sign(nearest_integer(fabs(x)), x);
    return {select(is_big(x), x, v - select(x < v, 1.0, 0.0))};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
