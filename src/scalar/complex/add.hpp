// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/complex/status.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// add(x, y) for complex numbers, ep: the sum by components, status 0.
template <typename R>
struct complex_add_ep_body : scalar_v21<complex_add_ep_body<R>, std::complex<R>> {
  LUMEN_MAIN main_result<std::complex<R>> main(std::complex<R> x, std::complex<R> y) {
    return {{x.real() + y.real(), x.imag() + y.imag()}};
  }
};

/// add(x, y) for complex numbers, la and ha: the sum by components; code 3 if a part of it is
/// infinite and no part of an operand is.
template <typename R>
struct complex_add_body : scalar_v21<complex_add_body<R>, std::complex<R>> {
  LUMEN_MAIN main_result<std::complex<R>> main(std::complex<R> x, std::complex<R> y) {
    const R re = x.real() + y.real();
    const R im = x.imag() + y.imag();
    return {{re, im}, flag_if<R>(is_infinite(re), is_infinite(im))};
  }

  LUMEN_RARE std::uint32_t rare(std::complex<R> x, std::complex<R> y, std::complex<R>* r) {
    *r = complex_add_ep_body<R>::main(x, y).value;
    return overflow_mask(x, y, *r);
  }
};

using add_c = complex_add_body<float>;
using add_c_ep = complex_add_ep_body<float>;
using add_z = complex_add_body<double>;
using add_z_ep = complex_add_ep_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
