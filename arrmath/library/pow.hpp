// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Power with complex elements, as the C library: exp(b log(a)), also where the exponent is zero.
#pragma once

#include <complex>
#include <cstdint>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct pow {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, const T* b, T* y) {
    *y = narrow<T>(std::pow(widen(*a), widen(*b)));
    return success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
