// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Hyperbolic tangent; real and complex.
#pragma once

#include <cmath>
#include <complex>
#include <cstdint>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct tanh {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    *y = narrow<T>(std::tanh(widen(*a)));
    return success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
