// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Inverse hyperbolic cosine; real and complex. Real arguments below 1: a domain error.
#pragma once

#include <cmath>
#include <complex>
#include <cstdint>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct acosh {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    *y = narrow<T>(std::acosh(widen(x)));
    if constexpr (is_real<T>) return x < 1 ? domain : success;
    return success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
