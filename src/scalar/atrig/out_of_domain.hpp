// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// |x| > 1, or a NaN, by y = (1 - |x|)/2.
template <typename T>
LUMEN_MAIN bool is_outside_unit_interval(T y) {
  return !(y >= T(0));
}

/// The result there: of a NaN itself, quietened, of a number the quiet NaN with its sign. Both are
/// outside the domain.
template <typename T>
LUMEN_DEVICE inline std::uint32_t out_of_domain(T x, T* y) {
  *y = value((is_nan(x) ? bits(x) : sign_bit(x)) | format<T>::nan);
  return mask(code::domain);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
