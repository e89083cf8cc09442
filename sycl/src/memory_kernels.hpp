// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>

#include "sycl/detail/kernel.hpp"

namespace sycl::detail {

/// The closures of the memory operations; their work-items are bytes.
struct copy_closure {
  unsigned char* dest;
  const unsigned char* src;
};
struct set_closure {
  unsigned char* dest;
  int value;
};

/// What copies `bytes` bytes fastest.
kernel_function copy_kernel(std::size_t bytes) noexcept;
kernel_function set_kernel() noexcept;

}  // namespace sycl::detail
