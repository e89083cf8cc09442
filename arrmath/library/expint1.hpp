// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Exponential integral E1. Zero is a pole, negative arguments are outside the domain.
#pragma once

#include <boost/math/special_functions/expint.hpp>

#include <cmath>
#include <cstdint>
#include <limits>

#include "library/boost_policy.hpp"
#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct expint1 {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    if (x > 0 && !std::isinf(x)) {
      *y = narrow<T>(boost::math::expint(1, widen(x), boost_policy{}));
      return success;
    }
    if (x == 0) {
      *y = std::numeric_limits<T>::infinity();
      return pole;
    }
    if (x < 0) {
      *y = std::numeric_limits<T>::quiet_NaN();
      return domain;
    }
    *y = std::isnan(x) ? x + x : T(0);
    return success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
