// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Error function.
#pragma once

#include <cmath>
#include <cstdint>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct erf {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    *y = narrow<T>(std::erf(widen(*a)));
    return success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
