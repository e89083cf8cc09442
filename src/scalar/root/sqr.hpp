// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/half.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// sqr, float and double; correctly rounded in every tier, status 0 also on overflow.
template <typename T>
struct sqr_body : scalar_v11<sqr_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x) { return {fma(x, x, T(0))}; }
};
using sqr_s = sqr_body<float>;
using sqr_d = sqr_body<double>;

/// sqr, half, through float.
using sqr_h = half_v11<sqr_s>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
