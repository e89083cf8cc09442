// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <utility>

namespace sycl::detail {

class command;
class buffer_storage;
class context_impl;
class device_impl;
class platform_impl;
class queue_impl;

/// The way from a handle class to its implementation object and back, for the runtime alone.
struct handle_access {
  template <typename Handle>
  static const auto& impl(const Handle& handle) noexcept {
    return handle.impl_;
  }
  template <typename Handle, typename Impl>
  static Handle make(std::shared_ptr<Impl> impl) noexcept {
    return Handle(std::move(impl));
  }
};

/// The hash of a handle: equal for handles of one object.
template <typename Handle>
struct handle_hash {
  std::size_t operator()(const Handle& handle) const noexcept {
    return std::hash<const void*>()(handle_access::impl(handle).get());
  }
};

}  // namespace sycl::detail
