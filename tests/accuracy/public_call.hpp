// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <arbor/lumen/vm.hpp>
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "measurement.hpp"

namespace arbor::lumen::accuracy {

/// A public call over USM or host pointers at a real type.
struct public_call {
  std::string_view function;
  char type;
  std::size_t inputs;
  std::size_t outputs;
  void (*run)(sycl::queue& queue, const void* const* in, void* const* out, std::int64_t n,
              vm::enums::mode mode);
};

/// The call of that name, `<function>_<type>` as in "exp_s", or null.
const public_call* find_public_call(std::string_view name);

subject subject_of(const public_call& call, const sycl::queue& queue, vm::enums::mode mode);

}  // namespace arbor::lumen::accuracy
