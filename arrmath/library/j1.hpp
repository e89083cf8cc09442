// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Bessel function J1. Every argument has the status success.
#pragma once

#include <cstdint>

#include "library/bessel.hpp"
#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct j1 {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    *y = first_kind<T>(1, *a);
    return success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
