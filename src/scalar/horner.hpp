// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <concepts>

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

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
