// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>

#include "../access.hpp"
#include "../property.hpp"
#include "export.hpp"
#include "handle.hpp"

namespace sycl {
class handler;
}

namespace sycl::detail {

/// The bytes [begin, end) of a buffer's storage.
struct region {
  buffer_storage* storage = nullptr;
  std::size_t begin = 0;
  std::size_t end = 0;

  friend bool operator==(const region&, const region&) = default;
};

ARBOR_LUMEN_SYCL_API void* region_data(const region& bytes) noexcept;

/// A number that no other accessor has; copies share it.
ARBOR_LUMEN_SYCL_API std::uint64_t new_accessor_number() noexcept;

/// errc::invalid for a read-only accessor with no_init.
ARBOR_LUMEN_SYCL_API void check_access(access_mode mode, const property_list& properties);
/// errc::invalid unless [offset, offset + extent) lies in [0, whole).
ARBOR_LUMEN_SYCL_API void check_access_range(std::size_t whole, std::size_t offset,
                                             std::size_t extent);
ARBOR_LUMEN_SYCL_API void require_region(handler& cgh, const region& bytes, access_mode mode);

/// Waits until the host may access the region; the access ends with the last owner of the result.
ARBOR_LUMEN_SYCL_API std::shared_ptr<void> begin_host_access(const region& bytes, access_mode mode);

}  // namespace sycl::detail
