// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// abs(x): the sign bit cleared, also of a NaN; every tier, status 0.
template <typename T>
struct abs_body : scalar_v11<abs_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x) { return {fabs(x)}; }
};

using abs_s = abs_body<float>;
using abs_d = abs_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
