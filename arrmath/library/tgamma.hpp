// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Gamma function. Zero is a pole; the negative integers and -infinity are outside the domain.
#pragma once

#include <cmath>
#include <cstdint>
#include <limits>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct tgamma {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    if (x == 0) {
      *y = std::copysign(std::numeric_limits<T>::infinity(), x);
      return pole;
    }
    if (x < 0 && std::rint(x) == x) {
      *y = std::numeric_limits<T>::quiet_NaN();
      return domain;
    }
    *y = narrow<T>(std::tgamma(widen(x)));
    return *y == 0 ? underflow : overflow_from(x, *y);
  }
};

}  // namespace arbor::lumen::vm::detail::library
