// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Distribution function of the normal distribution, erfc(-a / sqrt(2)) / 2. Zeros from finite
/// arguments are underflows, denormal results are not.
#pragma once

#include <cmath>
#include <cstdint>
#include <type_traits>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct cdfnorm {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    const bool zero = x <= underflow_bound;
    *y = zero ? T(0) : narrow<T>(value(widen(x)));
    return zero && !std::isinf(x) ? underflow : success;
  }

 private:
  using W = wide<T>;

  /// -38.485..., -14.170...: down from here the result is reported as a zero.
  static constexpr T underflow_bound =
      std::is_same_v<T, float> ? T(-0x1.c57228p3f) : T(-0x1.33e21dc3f3bd7p5);

  /// erfc magnifies a relative error of its argument t up to 2 t^2 times, so what rounding the
  /// quotient takes away is put back through the derivative.
  static W value(W x) {
    constexpr W root_half = W(0x1.6a09e667f3bcdp-1L);
    constexpr W root_half_low = W(-4.833646656726456518593584429912793e-17L);
    constexpr W two_by_root_pi = W(1.12837916709551257389615890312154517L);
    const W t = -x * root_half;
    if (!(std::fabs(t) < 40)) return std::erfc(t) / 2;
    const W rest = std::fma(-x, root_half, -t) - x * root_half_low;
    return (std::erfc(t) - two_by_root_pi * std::exp(-t * t) * rest) / 2;
  }
};

}  // namespace arbor::lumen::vm::detail::library
