// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

namespace arbor::lumen {

/// A strided view of an array, in elements. Element i of the slice is element
/// `start + i * stride` of the array.
///
/// A slice is empty if `size` is 0 or if the index of its last element,
/// `(size - 1) * stride + start`, is negative.
struct slice {
  std::int64_t start;   ///< index of the first element
  std::int64_t size;    ///< number of elements
  std::int64_t stride;  ///< distance between elements; may be zero or negative
};

}  // namespace arbor::lumen
