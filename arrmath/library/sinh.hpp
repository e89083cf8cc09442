// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Hyperbolic sine; real and complex. Real results that overflow are reported.
#pragma once

#include <cmath>
#include <complex>
#include <cstdint>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct sinh {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    *y = narrow<T>(std::sinh(widen(x)));
    if constexpr (is_real<T>) return overflow_from(x, *y);
    return success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
