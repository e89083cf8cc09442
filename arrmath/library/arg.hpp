// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Argument of a complex element.
#pragma once

#include <cmath>
#include <complex>
#include <cstdint>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct arg {
  using input_type = T;
  using output_type = typename T::value_type;
  static std::uint32_t call(const T* a, output_type* y) {
    const auto z = widen(*a);
    *y = narrow<output_type>(std::atan2(z.imag(), z.real()));
    return success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
