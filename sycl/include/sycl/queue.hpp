// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <memory>
#include <type_traits>
#include <utility>
#include <vector>

#include "accessor.hpp"
#include "backend.hpp"
#include "context.hpp"
#include "detail/export.hpp"
#include "detail/handle.hpp"
#include "device.hpp"
#include "event.hpp"
#include "exception.hpp"
#include "handler.hpp"
#include "info.hpp"
#include "property.hpp"
#include "selector.hpp"
#include "type_traits.hpp"

namespace sycl {

/// Takes commands for one device.
class ARBOR_LUMEN_SYCL_API queue {
 public:
  explicit queue(const property_list& properties = {});
  explicit queue(const async_handler& handler, const property_list& properties = {});
  template <detail::device_selector Selector>
  explicit queue(const Selector& selector, const property_list& properties = {})
      : queue(device(selector), properties) {}
  template <detail::device_selector Selector>
  explicit queue(const Selector& selector, const async_handler& handler,
                 const property_list& properties = {})
      : queue(device(selector), handler, properties) {}
  explicit queue(const device& dev, const property_list& properties = {});
  explicit queue(const device& dev, const async_handler& handler,
                 const property_list& properties = {});
  template <detail::device_selector Selector>
  explicit queue(const context& ctx, const Selector& selector, const property_list& properties = {})
      : queue(ctx, device(selector), properties) {}
  template <detail::device_selector Selector>
  explicit queue(const context& ctx, const Selector& selector, const async_handler& handler,
                 const property_list& properties = {})
      : queue(ctx, device(selector), handler, properties) {}
  explicit queue(const context& ctx, const device& dev, const property_list& properties = {});
  explicit queue(const context& ctx, const device& dev, const async_handler& handler,
                 const property_list& properties = {});

  backend get_backend() const noexcept;
  context get_context() const;
  device get_device() const;
  bool is_in_order() const;
  template <typename Param>
  typename Param::return_type get_info() const;

  template <typename Property>
  bool has_property() const noexcept {
    return properties().template has_property<Property>();
  }
  template <typename Property>
  Property get_property() const {
    return properties().template get_property<Property>();
  }

  void wait();
  void wait_and_throw();
  void throw_asynchronous();

  template <typename CommandGroup>
  event submit(CommandGroup cgf) {
    handler cgh(impl_);
    cgf(cgh);
    return cgh.submit();
  }
  /// Submits to the secondary queue what this one refuses.
  template <typename CommandGroup>
  event submit(CommandGroup cgf, const queue& secondary) {
    try {
      return submit(cgf);
    } catch (const exception&) {
      return queue(secondary).submit(cgf);
    }
  }

  template <typename KernelName = detail::unnamed_kernel, typename Kernel>
  event single_task(const Kernel& kernel) {
    handler cgh(impl_);
    cgh.single_task<KernelName>(kernel);
    return cgh.submit();
  }
  template <typename KernelName = detail::unnamed_kernel, typename Kernel>
  event single_task(const event& dependency, const Kernel& kernel) {
    handler cgh(impl_);
    cgh.depends_on(dependency);
    cgh.single_task<KernelName>(kernel);
    return cgh.submit();
  }
  template <typename KernelName = detail::unnamed_kernel, typename Kernel>
  event single_task(const std::vector<event>& dependencies, const Kernel& kernel) {
    handler cgh(impl_);
    cgh.depends_on(dependencies);
    cgh.single_task<KernelName>(kernel);
    return cgh.submit();
  }

#define SYCL_DETAIL_PARALLEL_FOR(dimensions)                                                     \
  template <typename KernelName = detail::unnamed_kernel, typename Kernel>                       \
  event parallel_for(range<dimensions> extents, const Kernel& kernel) {                          \
    handler cgh(impl_);                                                                          \
    cgh.parallel_for<KernelName>(extents, kernel);                                               \
    return cgh.submit();                                                                         \
  }                                                                                              \
  template <typename KernelName = detail::unnamed_kernel, typename Kernel>                       \
  event parallel_for(range<dimensions> extents, const event& dependency, const Kernel& kernel) { \
    handler cgh(impl_);                                                                          \
    cgh.depends_on(dependency);                                                                  \
    cgh.parallel_for<KernelName>(extents, kernel);                                               \
    return cgh.submit();                                                                         \
  }                                                                                              \
  template <typename KernelName = detail::unnamed_kernel, typename Kernel>                       \
  event parallel_for(range<dimensions> extents, const std::vector<event>& dependencies,          \
                     const Kernel& kernel) {                                                     \
    handler cgh(impl_);                                                                          \
    cgh.depends_on(dependencies);                                                                \
    cgh.parallel_for<KernelName>(extents, kernel);                                               \
    return cgh.submit();                                                                         \
  }
  SYCL_DETAIL_PARALLEL_FOR(1)
  SYCL_DETAIL_PARALLEL_FOR(2)
  SYCL_DETAIL_PARALLEL_FOR(3)
#undef SYCL_DETAIL_PARALLEL_FOR

  event memcpy(void* dest, const void* src, std::size_t bytes);
  event memcpy(void* dest, const void* src, std::size_t bytes, const event& dependency);
  event memcpy(void* dest, const void* src, std::size_t bytes,
               const std::vector<event>& dependencies);
  event memset(void* ptr, int value, std::size_t bytes);
  event memset(void* ptr, int value, std::size_t bytes, const event& dependency);
  event memset(void* ptr, int value, std::size_t bytes, const std::vector<event>& dependencies);
  event prefetch(void* ptr, std::size_t bytes);
  event prefetch(void* ptr, std::size_t bytes, const event& dependency);
  event prefetch(void* ptr, std::size_t bytes, const std::vector<event>& dependencies);
  event mem_advise(void* ptr, std::size_t bytes, int advice);
  event mem_advise(void* ptr, std::size_t bytes, int advice, const event& dependency);
  event mem_advise(void* ptr, std::size_t bytes, int advice,
                   const std::vector<event>& dependencies);

  template <typename T>
  event copy(const T* src, T* dest, std::size_t count) {
    static_assert(is_device_copyable_v<T>);
    return memcpy(dest, src, count * sizeof(T));
  }
  template <typename T, typename Dependencies>
  event copy(const T* src, T* dest, std::size_t count, const Dependencies& dependencies) {
    static_assert(is_device_copyable_v<T>);
    return memcpy(dest, src, count * sizeof(T), dependencies);
  }
  template <typename T>
  event fill(void* ptr, const T& pattern, std::size_t count) {
    handler cgh(impl_);
    cgh.fill(ptr, pattern, count);
    return cgh.submit();
  }
  template <typename T>
  event fill(void* ptr, const T& pattern, std::size_t count, const event& dependency) {
    handler cgh(impl_);
    cgh.depends_on(dependency);
    cgh.fill(ptr, pattern, count);
    return cgh.submit();
  }
  template <typename T>
  event fill(void* ptr, const T& pattern, std::size_t count,
             const std::vector<event>& dependencies) {
    handler cgh(impl_);
    cgh.depends_on(dependencies);
    cgh.fill(ptr, pattern, count);
    return cgh.submit();
  }

  /// The explicit copies, fills and updates of handler over accessors that are placeholders.
  template <typename SrcT, int D, access_mode M, target Tgt, access::placeholder P, typename Dest>
  event copy(accessor<SrcT, D, M, Tgt, P> src, Dest dest) {
    handler cgh(impl_);
    cgh.require(src);
    if constexpr (requires { cgh.require(dest); }) cgh.require(dest);
    cgh.copy(src, dest);
    return cgh.submit();
  }
  template <typename Src, typename DestT, int D, access_mode M, target Tgt, access::placeholder P>
  requires(!requires(Src src, handler& cgh) { cgh.require(src); }) event
      copy(Src src, accessor<DestT, D, M, Tgt, P> dest) {
    handler cgh(impl_);
    cgh.require(dest);
    cgh.copy(src, dest);
    return cgh.submit();
  }
  template <typename T, int D, access_mode M, target Tgt, access::placeholder P>
  event fill(accessor<T, D, M, Tgt, P> dest, const std::remove_const_t<T>& value) {
    handler cgh(impl_);
    cgh.require(dest);
    cgh.fill(dest, value);
    return cgh.submit();
  }
  template <typename T, int D, access_mode M, target Tgt, access::placeholder P>
  event update_host(accessor<T, D, M, Tgt, P> acc) {
    handler cgh(impl_);
    cgh.require(acc);
    cgh.update_host(acc);
    return cgh.submit();
  }

  friend bool operator==(const queue& a, const queue& b) noexcept { return a.impl_ == b.impl_; }

 private:
  friend struct detail::handle_access;
  explicit queue(std::shared_ptr<detail::queue_impl> impl) noexcept : impl_(std::move(impl)) {}

  const property_list& properties() const noexcept;

  std::shared_ptr<detail::queue_impl> impl_;
};

template <>
struct is_property_of<property::queue::enable_profiling, queue> : std::true_type {};
template <>
struct is_property_of<property::queue::in_order, queue> : std::true_type {};

}  // namespace sycl

template <>
struct std::hash<sycl::queue> : sycl::detail::handle_hash<sycl::queue> {};
