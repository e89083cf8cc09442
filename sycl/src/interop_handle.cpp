// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "sycl/interop_handle.hpp"

#include "queue_impl.hpp"
#include "sycl/native.hpp"

namespace sycl {

backend interop_handle::get_backend() const noexcept { return impl_->dev->description.from; }

detail::native_handle interop_handle::native_queue(backend expected) const {
  return detail::get_native(detail::handle_access::make<queue>(impl_), expected);
}
detail::native_handle interop_handle::native_device(backend expected) const {
  return detail::get_native(detail::handle_access::make<device>(impl_->dev), expected);
}
detail::native_handle interop_handle::native_context(backend expected) const {
  return detail::get_native(detail::handle_access::make<context>(impl_->ctx), expected);
}

}  // namespace sycl
