// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/complex/mul.hpp"
#include "scalar/utility/multiply3_156.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// fmm(a, b, c): the product of three elements with one rounding, at float with one more from
/// double. Status 1 above, 2 below the range of exponents. Special values are not looked for.
template <typename T>
struct fmm_body {
  using input_type = T;
  using output_type = T;
  LUMEN_DEVICE static std::uint32_t call(const T* a, const T* b, const T* c, T* y) {
    const auto product =
        special::impl::multiply3_156(bits(static_cast<double>(*a)), bits(static_cast<double>(*b)),
                                     bits(static_cast<double>(*c)));
    *y = static_cast<T>(value(product.pattern));
    return product.code;
  }
};

/// fmm(a, b, c) of complex numbers: (a·b)·c by the product of `mul`, status 0.
template <typename Multiply>
struct complex_fmm_body {
  using input_type = typename Multiply::input_type;
  using output_type = input_type;
  LUMEN_DEVICE static std::uint32_t call(const input_type* a, const input_type* b,
                                         const input_type* c, output_type* y) {
    input_type ab;
    Multiply::call(a, b, &ab);
    Multiply::call(&ab, c, y);
    return 0;
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
