// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Inverse of cdfnorm, -sqrt(2) erfcinv(2 a). 0 and 1 are poles, what lies outside of them a domain
/// error.
#pragma once

#include <boost/math/special_functions/erf.hpp>

#include <cmath>
#include <cstdint>
#include <limits>

#include "library/boost_policy.hpp"
#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct cdfnorminv {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    constexpr T infinity = std::numeric_limits<T>::infinity();
    constexpr auto root_two = wide<T>(1.41421356237309504880168872420969808L);
    if (x > 0 && x < 1) {
      *y = x == T(0.5) ? T(0)
                       : narrow<T>(-root_two * boost::math::erfc_inv(2 * widen(x), boost_policy{}));
      return success;
    }
    if (x == 0 || x == 1) {
      *y = x == 0 ? -infinity : infinity;
      return pole;
    }
    *y = std::isnan(x) ? x + x : std::numeric_limits<T>::quiet_NaN();
    return std::isnan(x) ? success : domain;
  }
};

}  // namespace arbor::lumen::vm::detail::library
