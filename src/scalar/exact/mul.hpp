// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// mul(x, y) = xy + 0 with one rounding; every tier, status 0. The addend turns a product that is
/// exactly zero into +0, so mul(-1, 0) is +0; a product that underflows keeps its sign.
template <typename T>
struct mul_body : scalar_v21<mul_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x, T y) { return {fma(x, y, T(0))}; }
};

using mul_s = mul_body<float>;
using mul_d = mul_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
