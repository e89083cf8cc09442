// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// cos(a) + i sin(a).
#pragma once

#include <cmath>
#include <complex>
#include <cstdint>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct cis {
  using input_type = T;
  using output_type = std::complex<T>;
  static std::uint32_t call(const T* a, output_type* y) {
    const auto x = widen(*a);
    *y = {narrow<T>(std::cos(x)), narrow<T>(std::sin(x))};
    return success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
