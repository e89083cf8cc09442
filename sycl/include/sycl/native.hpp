// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <vector>

#include "backend.hpp"
#include "context.hpp"
#include "detail/export.hpp"
#include "device.hpp"
#include "exception.hpp"
#include "platform.hpp"
#include "property.hpp"
#include "queue.hpp"

namespace sycl {

namespace detail {

ARBOR_LUMEN_SYCL_API native_handle get_native(const platform& object, backend expected);
ARBOR_LUMEN_SYCL_API native_handle get_native(const device& object, backend expected);
ARBOR_LUMEN_SYCL_API native_handle get_native(const context& object, backend expected);
ARBOR_LUMEN_SYCL_API native_handle get_native(const queue& object, backend expected);

/// Each throws errc::invalid for a value that is no handle of a live object of the kind, and
/// errc::backend_mismatch for an object of another backend.
ARBOR_LUMEN_SYCL_API platform make_platform(native_handle handle, backend expected);
ARBOR_LUMEN_SYCL_API device make_device(native_handle handle, backend expected);
/// A context over the same native one: pointers of one are pointers of the other. Without a
/// handler and devices of its own it is the very same object. The runtime counts references, so
/// keeping or giving up the ownership of the handle comes to the same.
ARBOR_LUMEN_SYCL_API context make_context(native_handle handle, const async_handler& handler,
                                          backend expected, bool keep_ownership,
                                          const std::vector<device>& devices = {});
/// A queue over the same stream of commands, which keeps its order. Without a handler and
/// properties of its own it is the very same object. Immediate and ordinary queues are one kind
/// here. The context, and the device unless null, must be the native queue's.
ARBOR_LUMEN_SYCL_API queue make_queue(native_handle handle, bool immediate, const context& ctx,
                                      const device* dev, bool keep_ownership,
                                      const property_list& properties, const async_handler& handler,
                                      backend expected);

}  // namespace detail

template <backend Backend, typename SyclObject>
backend_return_t<Backend, SyclObject> get_native(const SyclObject& object) {
  return detail::get_native(object, Backend);
}

template <backend Backend>
platform make_platform(const backend_input_t<Backend, platform>& handle) {
  return detail::make_platform(handle, Backend);
}
template <backend Backend>
device make_device(const backend_input_t<Backend, device>& handle) {
  return detail::make_device(handle, Backend);
}
template <backend Backend>
context make_context(const backend_input_t<Backend, context>& handle,
                     const async_handler& handler = {}) {
  return detail::make_context(handle, handler, Backend, true);
}
template <backend Backend>
queue make_queue(const backend_input_t<Backend, queue>& handle, const context& ctx,
                 const async_handler& handler = {}) {
  return detail::make_queue(handle, false, ctx, nullptr, true, {}, handler, Backend);
}

}  // namespace sycl
