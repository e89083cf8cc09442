// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// assign(c): the constant.
template <typename T>
struct assign_body {
  using input_type = T;
  using output_type = T;
  LUMEN_DEVICE static std::uint32_t call(T c, T* y) {
    *y = c;
    return 0;
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
