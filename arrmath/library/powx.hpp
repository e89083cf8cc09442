// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Power of complex elements with one exponent for all.
#pragma once

#include <cstdint>

#include "library/pow.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct powx {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T b, T* y) { return pow<T>::call(a, &b, y); }
};

}  // namespace arbor::lumen::vm::detail::library
