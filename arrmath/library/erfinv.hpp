// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Inverse of erf. ±1 are poles, what lies beyond a domain error.
#pragma once

#include <boost/math/special_functions/erf.hpp>

#include <cmath>
#include <cstdint>
#include <limits>

#include "library/boost_policy.hpp"
#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct erfinv {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    const T magnitude = std::fabs(x);
    if (magnitude < 1) {
      *y = x == 0 ? x : narrow<T>(boost::math::erf_inv(widen(x), boost_policy{}));
      return success;
    }
    if (magnitude == 1) {
      *y = std::copysign(std::numeric_limits<T>::infinity(), x);
      return pole;
    }
    *y = std::isnan(x) ? x + x : std::numeric_limits<T>::quiet_NaN();
    return std::isnan(x) ? success : domain;
  }
};

}  // namespace arbor::lumen::vm::detail::library
