// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Modified Bessel function I0. Float reports an overflow only above 92.
#pragma once

#include <boost/math/special_functions/bessel.hpp>

#include <cmath>
#include <cstdint>
#include <limits>
#include <type_traits>

#include "library/boost_policy.hpp"
#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct i0 {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = std::fabs(*a);
    if (!std::isfinite(x)) {
      *y = x + x;
      return success;
    }
    *y = narrow<T>(boost::math::cyl_bessel_i(0, widen(x), boost_policy{}));
    if (std::is_same_v<T, float> && x <= 92) return success;
    return overflow_from(x, *y);
  }
};

}  // namespace arbor::lumen::vm::detail::library
