// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// copy2(a): the element as it is, in both outputs.
template <typename T>
struct copy2_body {
  using input_type = T;
  using output_type = T;
  LUMEN_DEVICE static std::uint32_t call(const T* a, T* y1, T* y2) {
    const T x = *a;
    *y1 = x;
    *y2 = x;
    return 0;
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
