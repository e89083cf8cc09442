// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Sine of complex elements.
#pragma once

#include <cmath>
#include <complex>
#include <cstdint>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct sin {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    *y = narrow<T>(std::sin(widen(*a)));
    return success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
