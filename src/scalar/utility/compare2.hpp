// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/utility/relation_mask.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// compare2(a, b): the relations between the element and the element of a second array.
template <typename T>
struct compare2_body {
  using input_type = T;
  using output_type = T;
  LUMEN_DEVICE static std::uint32_t call(const T* a, const T* b, T* y) {
    *y = relation_mask(*a, *b);
    return 0;
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
