// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/nan_rule.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// fmax(x, y), exact in every tier, status 0. Equal values give y, so fmax(+0, -0) is -0. A NaN
/// loses to a number; of two NaNs the result is y.
template <typename T>
struct fmax_body : scalar_v21<fmax_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x, T y) { return {nan_rule(x, y, select(x > y, x, y))}; }
};

using fmax_s = fmax_body<float>;
using fmax_d = fmax_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
