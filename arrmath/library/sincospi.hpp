// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Sine and cosine of pi times the argument.
#pragma once

#include <cstdint>

#include "library/cospi.hpp"
#include "library/sinpi.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct sincospi {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y1, T* y2) {
    const T x = *a;
    const std::uint32_t status = sinpi<T>::call(&x, y1);
    cospi<T>::call(&x, y2);
    return status;
  }
};

}  // namespace arbor::lumen::vm::detail::library
