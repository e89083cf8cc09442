// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Modified Bessel function I1.
#pragma once

#include <boost/math/special_functions/bessel.hpp>

#include <cmath>
#include <cstdint>

#include "library/boost_policy.hpp"
#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct i1 {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    if (!std::isfinite(x) || x == 0) {
      *y = x + x;
      return success;
    }
    *y = narrow<T>(boost::math::cyl_bessel_i(1, widen(x), boost_policy{}));
    return overflow_from(x, *y);
  }
};

}  // namespace arbor::lumen::vm::detail::library
