// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The relations that hold between a and b, as a bit mask in the element type: 1 for a != b, which
/// also holds if the two are unordered, 2 for a < b, 4 for a <= b, 8 for a == b, 16 for a >= b, 32
/// for a > b.
template <typename T>
LUMEN_DEVICE inline T relation_mask(T a, T b) {
  const int mask = (a != b ? 1 : 0) | (a < b ? 2 : 0) | (a <= b ? 4 : 0) | (a == b ? 8 : 0) |
                   (a >= b ? 16 : 0) | (a > b ? 32 : 0);
  return static_cast<T>(mask);
}

/// Complex numbers have no order: real and imaginary parts are compared each by itself.
template <typename R>
LUMEN_DEVICE inline std::complex<R> relation_mask(std::complex<R> a, std::complex<R> b) {
  return {relation_mask(a.real(), b.real()), relation_mask(a.imag(), b.imag())};
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
