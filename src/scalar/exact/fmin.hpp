// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/nan_rule.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// fmin(x, y), exact in every tier, status 0. Equal values give y, so fmin(-0, +0) is +0. A NaN
/// loses to a number; of two NaNs the result is y.
template <typename T>
struct fmin_body : scalar_v21<fmin_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x, T y) { return {nan_rule(x, y, select(x < y, x, y))}; }
};

using fmin_s = fmin_body<float>;
using fmin_d = fmin_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
