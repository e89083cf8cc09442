// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// a + b + c from left to right; at float in double, rounded once.
LUMEN_DEVICE inline float sum_of_three(float a, float b, float c) {
  return static_cast<float>(static_cast<double>(a) + b + c);
}
LUMEN_DEVICE inline double sum_of_three(double a, double b, double c) { return a + b + c; }
template <typename R>
LUMEN_DEVICE inline std::complex<R> sum_of_three(std::complex<R> a, std::complex<R> b,
                                                 std::complex<R> c) {
  return {sum_of_three(a.real(), b.real(), c.real()), sum_of_three(a.imag(), b.imag(), c.imag())};
}

/// faa(a, b, c): the sum of three elements, of a complex number by parts.
template <typename T>
struct faa_body {
  using input_type = T;
  using output_type = T;
  LUMEN_DEVICE static std::uint32_t call(const T* a, const T* b, const T* c, T* y) {
    *y = sum_of_three(*a, *b, *c);
    return 0;
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
