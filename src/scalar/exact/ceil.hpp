// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/big_number_rounding.hpp"
#include "scalar/exact/integer_part.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// ceil(x): the smallest integer not below x, exact in every tier, status 0; the sign of a zero
/// result is that of x, so ceil(-0.5) is -0.
struct ceil_s : scalar_v11<ceil_s, float> {
  LUMEN_MAIN main_result<float> main(float x) { return {with_quiet_nan(x, ceil(x))}; }
};

struct ceil_d : scalar_v11<ceil_d, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const double v = or_sign(nearest_integer(fabs(x)), x);
    // The addition of a zero or of 1 loses the sign of a zero.
    const double raised = or_sign(v + select(x > v, 1.0, 0.0), x);
    return {select(is_big(x), x, raised)};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
