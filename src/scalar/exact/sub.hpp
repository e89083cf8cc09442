// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// sub(x, y) = x - y, the plain difference; every tier, status 0.
template <typename T>
struct sub_body : scalar_v21<sub_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x, T y) { return {x - y}; }
};

using sub_s = sub_body<float>;
using sub_d = sub_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
