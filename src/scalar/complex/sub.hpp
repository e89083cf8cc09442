// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>

#include "scalar/complex/status.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// sub(x, y) for complex numbers, ep: the difference by components, status 0.
template <typename R>
struct complex_sub_ep_body : scalar_v21<complex_sub_ep_body<R>, std::complex<R>> {
  LUMEN_MAIN main_result<std::complex<R>> main(std::complex<R> x, std::complex<R> y) {
    return {{x.real() - y.real(), x.imag() - y.imag()}};
  }
};

/// sub(x, y) for complex numbers, la and ha: the difference by components; code 3 if a part of it
/// is infinite and no part of an operand is.
template <typename R>
struct complex_sub_body : scalar_v21<complex_sub_body<R>, std::complex<R>> {
  LUMEN_MAIN main_result<std::complex<R>> main(std::complex<R> x, std::complex<R> y) {
    const R re = x.real() - y.real();
    const R im = x.imag() - y.imag();
    return {{re, im}, flag_if<R>(is_infinite(re), is_infinite(im))};
  }

  LUMEN_RARE std::uint32_t rare(std::complex<R> x, std::complex<R> y, std::complex<R>* r) {
    *r = complex_sub_ep_body<R>::main(x, y).value;
    return overflow_mask(x, y, *r);
  }
};

using sub_c = complex_sub_body<float>;
using sub_c_ep = complex_sub_ep_body<float>;
using sub_z = complex_sub_body<double>;
using sub_z_ep = complex_sub_ep_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
