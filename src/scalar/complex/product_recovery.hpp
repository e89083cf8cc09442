// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>

#include "scalar/complex/status.hpp"
#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// A number different from zero by an ordered comparison, so that a NaN does not count as one.
template <typename R>
LUMEN_DEVICE inline bool is_nonzero(std::complex<R> z) {
  return z.real() < 0 || z.real() > 0 || z.imag() < 0 || z.imag() > 0;
}

/// An infinite complex number as a direction: an infinite part becomes 1, any other 0, signs kept.
template <typename R>
LUMEN_DEVICE inline R boxed(R part) {
  return or_sign(is_infinite(part) ? R(1) : R(0), part);
}

template <typename R>
LUMEN_DEVICE inline R nan_as_zero(R part) {
  return is_nan(part) ? or_sign(R(0), part) : part;
}

template <typename R>
LUMEN_DEVICE inline R infinity_as_one(R part) {
  return is_infinite(part) ? or_sign(R(1), part) : part;
}

/// What the product needs of an operand where one of the two is infinite and neither is zero.
template <typename R>
LUMEN_DEVICE inline std::complex<R> direction(std::complex<R> z) {
  if (has_infinity(z)) return {boxed(z.real()), boxed(z.imag())};
  return {nan_as_zero(z.real()), nan_as_zero(z.imag())};
}

/// The product by the textbook formula: no attention to intermediate overflow or cancellation.
template <typename R>
LUMEN_DEVICE inline std::complex<R> plain_product(std::complex<R> x, std::complex<R> y) {
  const R a = x.real(), b = x.imag(), c = y.real(), d = y.imag();
  return {mad(a, c, -(b * d)), mad(b, c, a * d)};
}

/// The product where an operand has an infinite part: the recovery of C99 Annex G. An infinity
/// times anything but zero is infinite even if a part of either operand is a NaN; an infinity times
/// zero (or times a number that may be zero, having a NaN beside a zero) is a NaN in both parts.
template <typename R>
LUMEN_DEVICE inline std::complex<R> recovered_product(std::complex<R> x, std::complex<R> y) {
  if (is_nonzero(x) && is_nonzero(y)) {
    constexpr R infinity = value(format<R>::special);
    const std::complex<R> p = plain_product(direction(x), direction(y));
    return {p.real() * infinity, p.imag() * infinity};
  }
  if (is_nan(x.real()) || is_nan(x.imag()) || is_nan(y.real()) || is_nan(y.imag())) {
    // Without infinities no invalid product can stand in for the NaN that is there.
    x = {infinity_as_one(x.real()), infinity_as_one(x.imag())};
    y = {infinity_as_one(y.real()), infinity_as_one(y.imag())};
  }
  return plain_product(x, y);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
