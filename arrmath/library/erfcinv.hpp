// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Inverse of erfc. 0 and 2 are poles, what lies outside of them a domain error; float reports a
/// NaN as one as well.
#pragma once

#include <boost/math/special_functions/erf.hpp>

#include <cmath>
#include <cstdint>
#include <limits>
#include <type_traits>

#include "library/boost_policy.hpp"
#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct erfcinv {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    constexpr T infinity = std::numeric_limits<T>::infinity();
    if (x > 0 && x < 2) {
      *y = narrow<T>(x == 1 ? wide<T>(0) : boost::math::erfc_inv(widen(x), boost_policy{}));
      return success;
    }
    if (std::isnan(x)) {
      *y = x + x;
      return std::is_same_v<T, float> ? domain : success;
    }
    if (x == 0 || x == 2) {
      *y = x == 0 ? infinity : -infinity;
      return pole;
    }
    *y = std::numeric_limits<T>::quiet_NaN();
    return domain;
  }
};

}  // namespace arbor::lumen::vm::detail::library
