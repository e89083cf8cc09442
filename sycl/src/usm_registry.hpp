// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <memory>
#include <optional>

#include "context_impl.hpp"
#include "device_impl.hpp"
#include "sycl/usm.hpp"

namespace sycl::detail {

struct usm_record {
  std::size_t bytes = 0;
  usm::alloc kind = usm::alloc::unknown;
  /// Identity of the context.
  const void* ctx = nullptr;
  /// Null for host memory.
  std::shared_ptr<device_impl> dev;
};

namespace usm_registry {
void insert(const void* base, usm_record record);
/// Its size; 0 if there is no such allocation in the context.
std::size_t erase(const void* base, const void* ctx);
/// The allocation that the pointer points into, without its device's ownership being shared.
std::optional<usm_record> find(const void* ptr);
}  // namespace usm_registry

/// errc::invalid for device memory of another context or of a device that shares no memory with
/// this one.
void check_device_access(const void* ptr, const context_impl& ctx, const device_impl& dev);

}  // namespace sycl::detail
