// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Logarithm of |Gamma(a)|. Zero and the negative integers are poles.
#pragma once

#include <cmath>
#include <cstdint>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct lgamma {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    *y = narrow<T>(log_gamma(widen(x)));
    if (!std::isinf(*y) || std::isinf(x)) return success;
    return x <= 0 && std::rint(x) == x ? pole : overflow;
  }

 private:
  // The forms that keep the sign to themselves: the others write it to a variable of the process.
  static double log_gamma(double x) {
    int sign;
    return ::lgamma_r(x, &sign);
  }
  static long double log_gamma(long double x) {
    int sign;
    return ::lgammal_r(x, &sign);
  }
};

}  // namespace arbor::lumen::vm::detail::library
