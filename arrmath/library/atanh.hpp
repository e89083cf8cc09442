// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Inverse hyperbolic tangent; real and complex. Real arguments: ±1 are poles, beyond lies a domain
/// error.
#pragma once

#include <cmath>
#include <complex>
#include <cstdint>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct atanh {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    *y = narrow<T>(std::atanh(widen(x)));
    if constexpr (is_real<T>) {
      const T magnitude = std::fabs(x);
      if (magnitude >= 1) return magnitude == 1 ? pole : domain;
    }
    return success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
