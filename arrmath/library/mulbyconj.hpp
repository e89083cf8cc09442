// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// a conj(b). A result with an infinite part from finite operands: an overflow.
#pragma once

#include <cmath>
#include <complex>
#include <cstdint>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct mulbyconj {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, const T* b, T* y) {
    const T u = *a;
    const T v = *b;
    *y = narrow<T>(product(widen(u), widen(v)));
    const bool finite = is_finite(u) && is_finite(v);
    return finite && (std::isinf(y->real()) || std::isinf(y->imag())) ? overflow : success;
  }

 private:
  using W = typename wide<T>::value_type;

  static bool is_finite(const T& z) { return std::isfinite(z.real()) && std::isfinite(z.imag()); }

  /// ab + cd with the error of cd put back: within 1.5 units of W also where the terms cancel.
  static W sum_of_products(W a, W b, W c, W d) {
    const W p = c * d;
    if (!std::isfinite(p)) return a * b + p;
    return std::fma(a, b, p) + std::fma(c, d, -p);
  }

  static wide<T> conjugate_product(W a, W b, W c, W d) {
    return {sum_of_products(a, c, b, d), sum_of_products(b, c, -a, d)};
  }

  /// Infinities become ones, everything else zeros, each with its sign.
  static void box(W& re, W& im) {
    re = std::copysign(std::isinf(re) ? W(1) : W(0), re);
    im = std::copysign(std::isinf(im) ? W(1) : W(0), im);
  }
  static void nan_to_zero(W& x) {
    if (std::isnan(x)) x = std::copysign(W(0), x);
  }

  /// An infinite operand gives an infinite product, also where both parts come out as NaN, unless
  /// the other operand is a zero or a NaN throughout.
  static wide<T> product(wide<T> u, wide<T> v) {
    W a = u.real(), b = u.imag(), c = v.real(), d = v.imag();
    const wide<T> plain = conjugate_product(a, b, c, d);
    if (!std::isnan(plain.real()) || !std::isnan(plain.imag())) return plain;
    bool recover = false;
    if (std::isinf(a) || std::isinf(b)) {
      box(a, b);
      nan_to_zero(c);
      nan_to_zero(d);
      recover = true;
    }
    if (std::isinf(c) || std::isinf(d)) {
      box(c, d);
      nan_to_zero(a);
      nan_to_zero(b);
      recover = true;
    }
    if (!recover) return plain;
    const W infinity = std::numeric_limits<W>::infinity();
    return {infinity * (a * c + b * d), infinity * (b * c - a * d)};
  }
};

}  // namespace arbor::lumen::vm::detail::library
