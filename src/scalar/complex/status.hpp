// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// An infinite part. Only these, among special values, make C99 call a complex number infinite:
/// also beside a NaN.
template <typename R>
LUMEN_DEVICE inline bool has_infinity(std::complex<R> z) {
  return is_infinite(z.real()) || is_infinite(z.imag());
}

/// The status of a result computed from finite operands: code 3 if a part overflowed.
template <typename R>
LUMEN_DEVICE inline std::uint32_t overflow_mask(std::complex<R> result) {
  return mask(has_infinity(result) ? code::overflow : code::none);
}

/// The status of a sum, difference or product of x and y: an infinity that was in an operand is no
/// overflow.
template <typename R>
LUMEN_DEVICE inline std::uint32_t overflow_mask(std::complex<R> x, std::complex<R> y,
                                                std::complex<R> result) {
  if (has_infinity(x) || has_infinity(y)) return mask(code::none);
  return overflow_mask(result);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
