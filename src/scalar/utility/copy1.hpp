// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// copy1(a): the element as it is.
template <typename T>
struct copy1_body {
  using input_type = T;
  using output_type = T;
  LUMEN_DEVICE static std::uint32_t call(const T* a, T* y) {
    *y = *a;
    return 0;
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
