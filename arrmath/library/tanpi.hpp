// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tangent of pi times the argument. An infinity is a domain error.
#pragma once

#include <cmath>
#include <cstdint>

#include "library/turn.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct tanpi {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    *y = tangent_in<half_turns>(x);
    return std::isinf(x) ? domain : success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
