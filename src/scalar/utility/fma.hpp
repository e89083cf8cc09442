// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/ops.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// a·b + c with one rounding; in each part of a complex number two.
template <typename T>
LUMEN_DEVICE inline T multiply_add(T a, T b, T c) {
  return fma(a, b, c);
}
template <typename R>
LUMEN_DEVICE inline std::complex<R> multiply_add(std::complex<R> a, std::complex<R> b,
                                                 std::complex<R> c) {
  return {fma(-a.imag(), b.imag(), fma(a.real(), b.real(), c.real())),
          fma(a.imag(), b.real(), fma(a.real(), b.imag(), c.imag()))};
}

template <typename R>
LUMEN_DEVICE inline bool is_nan(std::complex<R> x) {
  return is_nan(x.real()) || is_nan(x.imag());
}

/// fma(a, b, c): says whether a·b + c is a NaN, with code 1 if it is. The result itself goes
/// nowhere: the output keeps what it held.
template <typename T>
struct fma_body {
  using input_type = T;
  using output_type = T;
  LUMEN_DEVICE static std::uint32_t call(const T* a, const T* b, const T* c, T*) {
    return mask(is_nan(multiply_add(*a, *b, *c)) ? code::domain : code::none);
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
