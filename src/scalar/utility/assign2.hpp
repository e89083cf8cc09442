// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// assign2(c): the constant, in both outputs.
template <typename T>
struct assign2_body {
  using input_type = T;
  using output_type = T;
  LUMEN_DEVICE static std::uint32_t call(T c, T* y1, T* y2) {
    *y1 = c;
    *y2 = c;
    return 0;
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
