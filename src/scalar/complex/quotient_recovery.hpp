// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>

#include "scalar/complex/product_recovery.hpp"
#include "scalar/complex/status.hpp"
#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

template <typename R>
LUMEN_DEVICE inline bool is_finite(std::complex<R> z) {
  return !is_special(z.real()) && !is_special(z.imag());
}

/// x times the conjugate of y by the textbook formula.
template <typename R>
LUMEN_DEVICE inline std::complex<R> product_by_conjugate(std::complex<R> x, std::complex<R> y) {
  const R a = x.real(), b = x.imag(), c = y.real(), d = y.imag();
  return {mad(a, c, b * d), mad(b, c, -(a * d))};
}

/// An infinite number by its parts boxed.
template <typename R>
LUMEN_DEVICE inline std::complex<R> boxed(std::complex<R> z) {
  return {boxed(z.real()), boxed(z.imag())};
}

/// The quotient x/y where y is zero or a part of x or y is infinite or a NaN, as C99 Annex G has
/// it: a number over zero is infinite unless it is zero or a NaN, an infinity over a finite number
/// is infinite, a finite number over an infinity is zero; everything else is a NaN in both parts.
template <typename R>
LUMEN_DEVICE inline std::complex<R> recovered_quotient(std::complex<R> x, std::complex<R> y) {
  if (y.real() == 0 && y.imag() == 0) {
    // By the real part, whose sign is that of a zero divisor.
    return {divide(x.real(), y.real()), divide(x.imag(), y.real())};
  }
  if (has_infinity(x) && is_finite(y)) {
    constexpr R infinity = value(format<R>::special);
    const std::complex<R> p = product_by_conjugate(boxed(x), y);
    return {p.real() * infinity, p.imag() * infinity};
  }
  if (has_infinity(y) && is_finite(x)) {
    // Zeros by their signs: the product itself may overflow.
    const std::complex<R> p = product_by_conjugate(x, boxed(y));
    return {or_sign(R(0), p.real()), or_sign(R(0), p.imag())};
  }
  // The sum is an infinity or a NaN.
  const R nan = ((x.real() + x.imag()) + (y.real() + y.imag())) * R(0);
  return {nan, nan};
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
