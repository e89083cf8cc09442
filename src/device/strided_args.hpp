// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "call/input.hpp"

namespace arbor::lumen::vm::detail::device {

/// How work item i finds its elements, copied by value into the kernel: input k is element
/// `((i / divisor[k]) % in_size[k]) * in_stride[k] + in_start[k]`, output j is element
/// `i * out_stride[j] + out_start[j]`. The extents are one more than the highest index used.
/// Arrays have one element beyond the arguments, so that shapes without inputs have fields too.
template <int NI, int NO>
struct strided_args {
  bool cyclic = false;
  std::int64_t divisor[NI + 1] = {};
  std::int64_t in_size[NI + 1] = {};
  std::int64_t in_start[NI + 1] = {};
  std::int64_t in_stride[NI + 1] = {};
  std::int64_t out_start[NO + 1] = {};
  std::int64_t out_stride[NO + 1] = {};
  std::int64_t in_extent[NI + 1] = {};
  std::int64_t out_extent[NO + 1] = {};
  std::int64_t count = 0;
};

/// The descriptor of a call: from its slices under the policy of its mode, or unit strides over the
/// effective count if it has none.
/// @throws std::logic_error if the number of slices is not that of the shape
/// @throws invalid_argument for empty slices and, in `slice_normal`, for sizes that differ; under
///         `badarg_quiet` the count is 0 instead
/// @throws std::runtime_error if the number of combinations of a cyclic call overflows
template <int NI, int NO>
strided_args<NI, NO> describe(const input::vxx& record);

}  // namespace arbor::lumen::vm::detail::device
