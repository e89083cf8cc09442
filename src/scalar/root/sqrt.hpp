// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// sqrt, float and double; correctly rounded in every tier. sqrt(-0) is -0. Code 1 for every other
/// pattern with its sign bit set: negative numbers, -infinity, and NaNs of negative sign.
template <typename T>
struct sqrt_body : scalar_v11<sqrt_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x) { return {sqrt(x), flag_if<T>(bits(x) > format<T>::sign)}; }

  LUMEN_RARE std::uint32_t rare(T x, T* y) {
    *y = sqrt(x);
    return mask(code::domain);
  }
};
using sqrt_s = sqrt_body<float>;
using sqrt_d = sqrt_body<double>;

/// sqrt, half, through float.
using sqrt_h = half_v11<sqrt_s>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
