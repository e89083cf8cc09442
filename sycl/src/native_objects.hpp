// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <memory>

#include "sycl/detail/handle.hpp"

namespace sycl::detail {

/// info::device::mem_base_addr_align of every device: a cache line.
inline constexpr unsigned mem_base_addr_align_bits = 512;

/// The live queues and contexts, other than the default ones, by address, which is their native
/// handle.
namespace native_objects {
void remember(const std::shared_ptr<context_impl>& object);
void remember(const std::shared_ptr<queue_impl>& object);
void forget(const void* object) noexcept;
/// Null if there is no such object.
std::shared_ptr<context_impl> find_context(const void* address);
std::shared_ptr<queue_impl> find_queue(const void* address);
}  // namespace native_objects

}  // namespace sycl::detail
