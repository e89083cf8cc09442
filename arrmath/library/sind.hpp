// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Sine of an angle in degrees. An infinity is a domain error.
#pragma once

#include <cmath>
#include <cstdint>

#include "library/turn.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct sind {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    *y = sine_in<degrees>(x);
    return std::isinf(x) ? domain : success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
