// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <memory>
#include <new>
#include <type_traits>
#include <utility>
#include <vector>

#include "access.hpp"
#include "aspect.hpp"
#include "detail/export.hpp"
#include "detail/handle.hpp"
#include "detail/kernel.hpp"
#include "detail/region.hpp"
#include "event.hpp"
#include "id.hpp"
#include "interop_handle.hpp"
#include "range.hpp"
#include "type_traits.hpp"

namespace sycl {

/// Collects what one command group does and what it waits for.
class ARBOR_LUMEN_SYCL_API handler {
 public:
  handler(const handler&) = delete;
  handler& operator=(const handler&) = delete;

  void depends_on(const event& dependency);
  void depends_on(const std::vector<event>& dependencies);

  template <typename DataT, int Dimensions, access_mode Mode, target Target,
            access::placeholder Placeholder>
  void require(const accessor<DataT, Dimensions, Mode, Target, Placeholder>& acc) {
    detail::require_region(*this, acc.bytes(), Mode);
  }

  template <typename KernelName = detail::unnamed_kernel, typename Kernel>
  void single_task(const Kernel& kernel) {
    launch(&detail::run_task<Kernel>, 0, nullptr, kernel);
  }

  template <typename KernelName = detail::unnamed_kernel, typename Kernel>
  void parallel_for(range<1> extents, const Kernel& kernel) {
    const std::size_t shape[3] = {extents[0], 1, 1};
    launch(&detail::run_range<Kernel, 1>, 1, shape, kernel);
  }
  template <typename KernelName = detail::unnamed_kernel, typename Kernel>
  void parallel_for(range<2> extents, const Kernel& kernel) {
    const std::size_t shape[3] = {extents[0], extents[1], 1};
    launch(&detail::run_range<Kernel, 2>, 2, shape, kernel);
  }
  template <typename KernelName = detail::unnamed_kernel, typename Kernel>
  void parallel_for(range<3> extents, const Kernel& kernel) {
    const std::size_t shape[3] = {extents[0], extents[1], extents[2]};
    launch(&detail::run_range<Kernel, 3>, 3, shape, kernel);
  }

  /// Runs on a thread of its own, where it may block.
  template <typename Task>
  void host_task(Task&& task) {
    using closure = std::decay_t<Task>;
    begin_host_task();
    void* place = reserve(sizeof(closure), alignof(closure));
    ::new (place) closure(std::forward<Task>(task));
    commit(detail::closure_destructor<closure>());
    if constexpr (std::is_invocable_v<closure&, interop_handle>) {
      set_host_task(
          [](void* object, const interop_handle& ih) { (*static_cast<closure*>(object))(ih); });
    } else {
      set_host_task(
          [](void* object, const interop_handle&) { (*static_cast<closure*>(object))(); });
    }
  }

  /// errc::invalid for null, and for device memory that the queue's device has no access to.
  void memcpy(void* dest, const void* src, std::size_t bytes);
  void memset(void* ptr, int value, std::size_t bytes);
  template <typename T>
  void copy(const T* src, T* dest, std::size_t count) {
    static_assert(is_device_copyable_v<T>);
    memcpy(dest, src, count * sizeof(T));
  }
  template <typename T>
  void fill(void* ptr, const T& pattern, std::size_t count) {
    static_assert(is_device_copyable_v<T>);
    check_memory(ptr, count * sizeof(T));
    T* const elements = static_cast<T*>(ptr);
    parallel_for(range<1>(count), [elements, pattern](id<1> i) { elements[i[0]] = pattern; });
  }
  /// Hints, which memory that is shared with the host does not need.
  void prefetch(void* ptr, std::size_t bytes);
  void mem_advise(void* ptr, std::size_t bytes, int advice);

  template <typename SrcT, int D, access_mode M, target Tgt, access::placeholder P, typename DestT>
  void copy(accessor<SrcT, D, M, Tgt, P> src, DestT* dest);
  template <typename SrcT, int D, access_mode M, target Tgt, access::placeholder P, typename DestT>
  void copy(accessor<SrcT, D, M, Tgt, P> src, std::shared_ptr<DestT> dest);
  template <typename SrcT, typename DestT, int D, access_mode M, target Tgt, access::placeholder P>
  void copy(const SrcT* src, accessor<DestT, D, M, Tgt, P> dest);
  template <typename SrcT, typename DestT, int D, access_mode M, target Tgt, access::placeholder P>
  void copy(std::shared_ptr<SrcT> src, accessor<DestT, D, M, Tgt, P> dest);
  template <typename SrcT, int SrcD, access_mode SrcM, target SrcTgt, access::placeholder SrcP,
            typename DestT, int DestD, access_mode DestM, target DestTgt, access::placeholder DestP>
  void copy(accessor<SrcT, SrcD, SrcM, SrcTgt, SrcP> src,
            accessor<DestT, DestD, DestM, DestTgt, DestP> dest);
  template <typename T, int D, access_mode M, target Tgt, access::placeholder P>
  void fill(accessor<T, D, M, Tgt, P> dest, const std::remove_const_t<T>& value);
  /// Orders the host after the commands before; the host's memory is the buffer's.
  template <typename T, int D, access_mode M, target Tgt, access::placeholder P>
  void update_host(accessor<T, D, M, Tgt, P> acc);

 private:
  friend class queue;
  friend void detail::require_region(handler& cgh, const detail::region& bytes, access_mode mode);

  explicit handler(const std::shared_ptr<detail::queue_impl>& owner);
  ~handler();

  template <typename Kernel>
  void launch(detail::kernel_function function, int dimensions, const std::size_t* shape,
              const Kernel& kernel) {
    begin_action();
    if constexpr (requires { Kernel::required_aspects; }) {
      for (const aspect needed : Kernel::required_aspects) check_aspect(needed);
    }
    void* place = reserve(sizeof(Kernel), alignof(Kernel));
    ::new (place) Kernel(kernel);
    commit(detail::closure_destructor<Kernel>());
    set_kernel(function, dimensions, shape);
  }

  void begin_action();
  void begin_host_task() { begin_action(); }
  void check_aspect(aspect needed) const;
  void check_memory(const void* ptr, std::size_t bytes) const;
  void* reserve(std::size_t size, std::size_t alignment);
  void commit(void (*destroy)(void*) noexcept) noexcept;
  void set_kernel(detail::kernel_function function, int dimensions,
                  const std::size_t* shape) noexcept;
  void set_host_task(void (*function)(void* closure, const interop_handle& ih)) noexcept;
  void set_nothing();
  event submit();

  std::shared_ptr<detail::command> command_;
  const std::shared_ptr<detail::queue_impl>& owner_;
  bool has_action_ = false;
};

}  // namespace sycl
