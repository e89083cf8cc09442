// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Complementary error function. Zeros from finite arguments are underflows, denormal results are
/// not.
#pragma once

#include <cmath>
#include <cstdint>
#include <type_traits>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct erfc {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    const bool zero = x >= underflow_bound;
    *y = zero ? T(0) : narrow<T>(std::erfc(widen(x)));
    return zero && !std::isinf(x) ? underflow : success;
  }

 private:
  /// 27.226..., 10.054...: from here on the result is reported as a zero.
  static constexpr T underflow_bound =
      std::is_same_v<T, float> ? T(0x1.41bbf6p3f) : T(0x1.b39dc41e48bfdp4);
};

}  // namespace arbor::lumen::vm::detail::library
