// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <concepts>
#include <cstddef>

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The polynomial in r with the given coefficients, patterns from the highest power down, by
/// Horner's rule with one fma per step. The order of evaluation is part of a body: the same
/// polynomial evaluated otherwise has other roundings.
template <typename T, std::same_as<uint_of<T>>... Coefficients>
LUMEN_MAIN T horner(T r, uint_of<T> highest, Coefficients... coefficients) {
  T p = value(highest);
  ((p = fma(p, r, value(coefficients))), ...);
  return p;
}

/// The same with the coefficients in an array.
template <typename T, std::size_t N>
LUMEN_MAIN T horner_of(T r, const uint_of<T> (&coefficients)[N]) {
  T p = value(coefficients[0]);
  for (std::size_t i = 1; i < N; ++i) p = fma(p, r, value(coefficients[i]));
  return p;
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
