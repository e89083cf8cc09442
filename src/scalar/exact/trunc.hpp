// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/integer_part.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// trunc(x): x rounded towards zero, exact in every tier, status 0; trunc(-0.5) is -0.
template <typename T>
struct trunc_body : scalar_v11<trunc_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x) { return {integer_part(x)}; }
};

using trunc_s = trunc_body<float>;
using trunc_d = trunc_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
