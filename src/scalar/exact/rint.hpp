// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/integer_part.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// rint(x): x rounded to the nearest integer, ties to even, exact in every tier, status 0; the sign
/// of a zero result is that of x.
template <typename T>
struct rint_body : scalar_v11<rint_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x) { return {nearest_integer_part(x)}; }
};

using rint_s = rint_body<float>;
using rint_d = rint_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
