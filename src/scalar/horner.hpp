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

/// The same with the coefficients in an array. Unrolled by recursion: a loop here would keep GCC
/// from vectorising the loop around the body.
template <std::size_t next = 1, typename T, std::size_t N>
LUMEN_MAIN T horner_from(T p, T r, const uint_of<T> (&coefficients)[N]) {
  if constexpr (next == N) {
    return p;
  } else {
    return horner_from<next + 1>(fma(p, r, value(coefficients[next])), r, coefficients);
  }
}
template <typename T, std::size_t N>
LUMEN_MAIN T horner_of(T r, const uint_of<T> (&coefficients)[N]) {
  return horner_from(value(coefficients[0]), r, coefficients);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
