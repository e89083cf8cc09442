// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/nan_rule.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// fdim(x, y): x - y where x > y, +0 elsewhere; every tier, status 0 also on overflow. A NaN loses
/// to a number, which is then the result itself and no difference: fdim(NaN, 3) is 3.
template <typename T>
struct fdim_body : scalar_v21<fdim_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x, T y) { return {nan_rule(x, y, select(x > y, x - y, T(0)))}; }
};

using fdim_s = fdim_body<float>;
using fdim_d = fdim_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
