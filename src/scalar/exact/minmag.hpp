// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/nan_rule.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// minmag(x, y): the operand of smaller magnitude, of equal magnitudes the smaller value and of
/// equal values x; every tier, status 0. A NaN loses to a number; of two NaNs the result is y.
template <typename T>
struct minmag_body : scalar_v21<minmag_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x, T y) {
    const T smaller_value = select(y < x, y, x);
    const T not_smaller_x = select(fabs(x) == fabs(y), smaller_value, y);
    return {nan_rule(x, y, select(fabs(x) < fabs(y), x, not_smaller_x))};
  }
};

using minmag_s = minmag_body<float>;
using minmag_d = minmag_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
