// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <memory>
#include <utility>

#include "backend.hpp"
#include "context.hpp"
#include "detail/export.hpp"
#include "detail/handle.hpp"
#include "device.hpp"

namespace sycl {

class queue;

/// What a host task may know of the queue it runs for.
class ARBOR_LUMEN_SYCL_API interop_handle {
 public:
  interop_handle() = delete;

  backend get_backend() const noexcept;

  template <backend Backend>
  backend_return_t<Backend, queue> get_native_queue() const {
    return native_queue(Backend);
  }
  template <backend Backend>
  backend_return_t<Backend, device> get_native_device() const {
    return native_device(Backend);
  }
  template <backend Backend>
  backend_return_t<Backend, context> get_native_context() const {
    return native_context(Backend);
  }

 private:
  friend struct detail::handle_access;
  explicit interop_handle(std::shared_ptr<detail::queue_impl> impl) noexcept
      : impl_(std::move(impl)) {}

  detail::native_handle native_queue(backend expected) const;
  detail::native_handle native_device(backend expected) const;
  detail::native_handle native_context(backend expected) const;

  std::shared_ptr<detail::queue_impl> impl_;
};

}  // namespace sycl
