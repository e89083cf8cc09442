// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>

#include "../usm.hpp"
#include "export.hpp"

/// For tests of code that allocates.
namespace sycl::detail::testing {

/// Lets the next `count` allocations of the kind return null; 0 ends that.
ARBOR_LUMEN_SYCL_API void fail_next_allocations(usm::alloc kind, std::size_t count) noexcept;

}  // namespace sycl::detail::testing
