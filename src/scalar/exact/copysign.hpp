// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// copysign(x, y): the magnitude of x with the sign of y, in integers, also where either is a NaN;
/// every tier, status 0.
template <typename T>
struct copysign_body : scalar_v21<copysign_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x, T y) { return {or_sign(fabs(x), y)}; }
};

using copysign_s = copysign_body<float>;
using copysign_d = copysign_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
