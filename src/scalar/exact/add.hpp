// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// add(x, y) = x + y, the plain sum; every tier, status 0.
template <typename T>
struct add_body : scalar_v21<add_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x, T y) { return {x + y}; }
};

using add_s = add_body<float>;
using add_d = add_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
