// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstddef>
#include <cstdint>

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// iota(start, step) at element i, real: 0, whatever the constants.
template <typename T>
struct iota_body {
  using input_type = T;
  using output_type = T;
  LUMEN_DEVICE static std::uint32_t call(T, T, std::size_t, T* y) {
    *y = 0;
    return 0;
  }
};

/// iota(start, step) at element i, complex: start·(t + it) + step with t = i rounded to float, in
/// double, each part rounded once. The index enters as a number with equal parts.
template <typename R>
struct complex_iota_body {
  using input_type = std::complex<R>;
  using output_type = std::complex<R>;
  LUMEN_DEVICE static std::uint32_t call(std::complex<R> start, std::complex<R> step, std::size_t i,
                                         std::complex<R>* y) {
    const double t = static_cast<float>(i);
    const double p = start.real(), q = start.imag();
    *y = {static_cast<R>((p * t - q * t) + step.real()),
          static_cast<R>((p * t + q * t) + step.imag())};
    return 0;
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
