// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/complex/double_double.hpp"
#include "scalar/complex/product_recovery.hpp"
#include "scalar/complex/scaled_products.hpp"
#include "scalar/complex/status.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The product of complex floats in double, where the four products of parts are exact: each part
/// is rounded twice, within 0.5000001 ulp, whatever cancels.
LUMEN_DEVICE inline std::complex<float> widened_product(std::complex<float> x,
                                                        std::complex<float> y) {
  const double a = x.real(), b = x.imag(), c = y.real(), d = y.imag();
  return {static_cast<float>(fma(a, c, -fma(b, d, 0.0))),
          static_cast<float>(fma(b, c, fma(a, d, 0.0)))};
}

/// The flag of a product: a part that is infinite or a NaN, which may be an overflow, the product
/// of special operands, or the wrong outcome of an infinity with a NaN in the formula.
template <typename R>
LUMEN_DEVICE inline uint_of<R> is_special_product(std::complex<R> p) {
  return flag_if<R>(is_special(p.real()), is_special(p.imag()));
}

/// mul(x, y) for complex float, la and ha. Code 3 if a part of the product overflows; infinite
/// operands by C99 Annex G.
struct mul_c : scalar_v21<mul_c, std::complex<float>> {
  using complex = std::complex<float>;

  LUMEN_MAIN main_result<complex> main(complex x, complex y) {
    const complex p = widened_product(x, y);
    return {p, is_special_product(p)};
  }

  LUMEN_RARE std::uint32_t rare(complex x, complex y, complex* r) {
    if (has_infinity(x) || has_infinity(y)) {
      *r = recovered_product(x, y);
      return mask(code::none);
    }
    *r = widened_product(x, y);
    return overflow_mask(*r);
  }
};

/// mul(x, y) for complex float, ep: the textbook formula in float, so that a part may lose all its
/// bits where it cancels; what overflows on the way is repaired in double. Status 0.
struct mul_c_ep : scalar_v21<mul_c_ep, std::complex<float>> {
  using complex = std::complex<float>;

  LUMEN_MAIN main_result<complex> main(complex x, complex y) {
    const complex p = plain_product(x, y);
    return {p, is_special_product(p)};
  }

  LUMEN_RARE std::uint32_t rare(complex x, complex y, complex* r) {
    mul_c::rare(x, y, r);
    return mask(code::none);
  }
};

/// mul(x, y) for complex double, la and ha: each part is within 0.5000001 ulp, whatever cancels.
/// Code 3 if a part of the product overflows; infinite operands by C99 Annex G. A part that is
/// exactly zero is +0.
struct mul_z : scalar_v21<mul_z, std::complex<double>> {
  using complex = std::complex<double>;

  LUMEN_MAIN main_result<complex> main(complex x, complex y) {
    const double a = x.real(), b = x.imag(), c = y.real(), d = y.imag();
    const double_double re = sum_of_products(two_product(a, c), two_product(b, -d));
    const double_double im = sum_of_products(two_product(b, c), two_product(a, d));
    return {
        {re.high + re.low, im.high + im.low},
        flag_if<double>(needs_scaling(a), needs_scaling(b), needs_scaling(c), needs_scaling(d))};
  }

  LUMEN_RARE std::uint32_t rare(complex x, complex y, complex* r) {
    const double a = x.real(), b = x.imag(), c = y.real(), d = y.imag();
    if (has_infinity(x) || has_infinity(y)) {
      *r = recovered_product(x, y);
      return mask(code::none);
    }
    if (is_nan(a) || is_nan(b) || is_nan(c) || is_nan(d)) {
      *r = plain_product(x, y);
      return mask(code::none);
    }
    *r = {rounded_sum_of_products(a, c, b, -d), rounded_sum_of_products(b, c, a, d)};
    return overflow_mask(*r);
  }

 private:
  /// Outside [2^-459, 1.41·2^510]: there a product may overflow, or its error lose bits. Zeros too.
  LUMEN_DEVICE static bool needs_scaling(double part) {
    constexpr std::uint64_t shift = 0x5cc0000000000000;
    constexpr std::uint64_t bound = 0xbc96a09dffffffff;
    return static_cast<std::int64_t>(bits(fabs(part)) + shift) > static_cast<std::int64_t>(bound);
  }
};

/// mul(x, y) for complex double, ep: the textbook formula, so that a part may lose all its bits
/// where it cancels; what overflows on the way is repaired by scaling. Status 0.
struct mul_z_ep : scalar_v21<mul_z_ep, std::complex<double>> {
  using complex = std::complex<double>;

  LUMEN_MAIN main_result<complex> main(complex x, complex y) {
    const complex p = plain_product(x, y);
    return {p, is_special_product(p)};
  }

  LUMEN_RARE std::uint32_t rare(complex x, complex y, complex* r) {
    mul_z::rare(x, y, r);
    return mask(code::none);
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
