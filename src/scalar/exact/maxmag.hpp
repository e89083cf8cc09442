// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/nan_rule.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// maxmag(x, y): the operand of larger magnitude, of equal magnitudes the larger value and of equal
/// values x; every tier, status 0. A NaN loses to a number; of two NaNs the result is y.
template <typename T>
struct maxmag_body : scalar_v21<maxmag_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x, T y) {
    const T larger_value = select(y > x, y, x);
    const T not_larger_x = select(fabs(x) == fabs(y), larger_value, y);
    return {nan_rule(x, y, select(fabs(x) > fabs(y), x, not_larger_x))};
  }
};

using maxmag_s = maxmag_body<float>;
using maxmag_d = maxmag_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
