// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Bessel functions J_b(a) of integer order; the order is cut to an integer. Every argument has the
/// status success.
#pragma once

#include <cmath>
#include <cstdint>

#include "library/bessel.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct jn {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T b, T* y) {
    *y = std::isnan(b) ? b + b : first_kind<T>(order_of(b), *a);
    return success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
