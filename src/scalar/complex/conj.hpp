// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// conj(z) for complex numbers: the sign bit of the imaginary part flipped, unless it is a NaN,
/// which stays as it is; every tier, status 0.
template <typename R>
struct conj_body : scalar_v11<conj_body<R>, std::complex<R>> {
  LUMEN_MAIN main_result<std::complex<R>> main(std::complex<R> z) {
    const R im = z.imag();
    return {{z.real(), select(is_nan(im), im, value(bits(im) ^ format<R>::sign))}};
  }
};

using conj_c = conj_body<float>;
using conj_z = conj_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
