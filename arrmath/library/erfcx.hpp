// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// e^(a^2) erfc(a). Every argument has the status success, also where the result is infinite.
#pragma once

#include <cmath>
#include <cstdint>
#include <limits>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct erfcx {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, T* y) {
    *y = narrow<T>(value(widen(*a)));
    return success;
  }

 private:
  using W = wide<T>;

  /// Up to here erfc is a normal number of W.
  static constexpr W series_from = std::numeric_limits<W>::max_exponent > 1024 ? W(100) : W(25);

  static W value(W x) {
    if (x > series_from) return series(x);
    const W square = x * x;
    const W rest = std::fma(x, x, -square);
    const W e = std::exp(square);
    if (std::isinf(e)) return e;
    return (e + e * rest) * std::erfc(x);
  }

  /// 1 / (x sqrt(pi)) times 1 - 1/(2x^2) + 1·3/(2x^2)^2 - …, for large x.
  static W series(W x) {
    constexpr W one_by_root_pi = W(0.564189583547756286948079451560772586L);
    const W u = 1 / x / x / 2;
    W sum = 1;
    W term = 1;
    for (int k = 1; k < 20; k += 2) {
      term *= -k * u;
      sum += term;
    }
    return one_by_root_pi / x * sum;
  }
};

}  // namespace arbor::lumen::vm::detail::library
