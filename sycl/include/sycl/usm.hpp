// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <type_traits>

#include "context.hpp"
#include "detail/export.hpp"
#include "device.hpp"
#include "exception.hpp"
#include "property.hpp"
#include "queue.hpp"

namespace sycl {

namespace usm {
enum class alloc : int { host = 0, device = 1, shared = 2, unknown = 3 };
}  // namespace usm

// Every allocation function returns null if the memory cannot be had, if the alignment is not
// supported, and for nothing to allocate.

ARBOR_LUMEN_SYCL_API void* malloc_device(std::size_t bytes, const device& dev, const context& ctx,
                                         const property_list& properties = {});
ARBOR_LUMEN_SYCL_API void* malloc_device(std::size_t bytes, const queue& q,
                                         const property_list& properties = {});
ARBOR_LUMEN_SYCL_API void* aligned_alloc_device(std::size_t alignment, std::size_t bytes,
                                                const device& dev, const context& ctx,
                                                const property_list& properties = {});
ARBOR_LUMEN_SYCL_API void* aligned_alloc_device(std::size_t alignment, std::size_t bytes,
                                                const queue& q,
                                                const property_list& properties = {});

ARBOR_LUMEN_SYCL_API void* malloc_host(std::size_t bytes, const context& ctx,
                                       const property_list& properties = {});
ARBOR_LUMEN_SYCL_API void* malloc_host(std::size_t bytes, const queue& q,
                                       const property_list& properties = {});
ARBOR_LUMEN_SYCL_API void* aligned_alloc_host(std::size_t alignment, std::size_t bytes,
                                              const context& ctx,
                                              const property_list& properties = {});
ARBOR_LUMEN_SYCL_API void* aligned_alloc_host(std::size_t alignment, std::size_t bytes,
                                              const queue& q, const property_list& properties = {});

ARBOR_LUMEN_SYCL_API void* malloc_shared(std::size_t bytes, const device& dev, const context& ctx,
                                         const property_list& properties = {});
ARBOR_LUMEN_SYCL_API void* malloc_shared(std::size_t bytes, const queue& q,
                                         const property_list& properties = {});
ARBOR_LUMEN_SYCL_API void* aligned_alloc_shared(std::size_t alignment, std::size_t bytes,
                                                const device& dev, const context& ctx,
                                                const property_list& properties = {});
ARBOR_LUMEN_SYCL_API void* aligned_alloc_shared(std::size_t alignment, std::size_t bytes,
                                                const queue& q,
                                                const property_list& properties = {});

ARBOR_LUMEN_SYCL_API void* malloc(std::size_t bytes, const device& dev, const context& ctx,
                                  usm::alloc kind, const property_list& properties = {});
ARBOR_LUMEN_SYCL_API void* malloc(std::size_t bytes, const queue& q, usm::alloc kind,
                                  const property_list& properties = {});
ARBOR_LUMEN_SYCL_API void* aligned_alloc(std::size_t alignment, std::size_t bytes,
                                         const device& dev, const context& ctx, usm::alloc kind,
                                         const property_list& properties = {});
ARBOR_LUMEN_SYCL_API void* aligned_alloc(std::size_t alignment, std::size_t bytes, const queue& q,
                                         usm::alloc kind, const property_list& properties = {});

/// Does nothing for null; errc::invalid for what is no allocation of the context.
ARBOR_LUMEN_SYCL_API void free(void* ptr, const context& ctx);
ARBOR_LUMEN_SYCL_API void free(void* ptr, const queue& q);

/// Of the allocation that the pointer points into; unknown if there is none in the context.
ARBOR_LUMEN_SYCL_API usm::alloc get_pointer_type(const void* ptr, const context& ctx);
/// errc::invalid for a pointer into no allocation of the context.
ARBOR_LUMEN_SYCL_API device get_pointer_device(const void* ptr, const context& ctx);

namespace detail {

/// The bytes of `count` elements, or a size that no allocation can have.
template <typename T>
constexpr std::size_t array_bytes(std::size_t count) noexcept {
  const std::size_t limit = static_cast<std::size_t>(-1) / 2;
  return count > limit / sizeof(T) ? limit : count * sizeof(T);
}

}  // namespace detail

// The typed forms: of `count` elements, aligned for T at least.

template <typename T>
T* malloc_device(std::size_t count, const device& dev, const context& ctx,
                 const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc_device(alignof(T), detail::array_bytes<T>(count), dev, ctx, properties));
}
template <typename T>
T* malloc_device(std::size_t count, const queue& q, const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc_device(alignof(T), detail::array_bytes<T>(count), q, properties));
}
template <typename T>
T* aligned_alloc_device(std::size_t alignment, std::size_t count, const device& dev,
                        const context& ctx, const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc_device(alignment, detail::array_bytes<T>(count), dev, ctx, properties));
}
template <typename T>
T* aligned_alloc_device(std::size_t alignment, std::size_t count, const queue& q,
                        const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc_device(alignment, detail::array_bytes<T>(count), q, properties));
}

template <typename T>
T* malloc_host(std::size_t count, const context& ctx, const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc_host(alignof(T), detail::array_bytes<T>(count), ctx, properties));
}
template <typename T>
T* malloc_host(std::size_t count, const queue& q, const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc_host(alignof(T), detail::array_bytes<T>(count), q, properties));
}
template <typename T>
T* aligned_alloc_host(std::size_t alignment, std::size_t count, const context& ctx,
                      const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc_host(alignment, detail::array_bytes<T>(count), ctx, properties));
}
template <typename T>
T* aligned_alloc_host(std::size_t alignment, std::size_t count, const queue& q,
                      const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc_host(alignment, detail::array_bytes<T>(count), q, properties));
}

template <typename T>
T* malloc_shared(std::size_t count, const device& dev, const context& ctx,
                 const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc_shared(alignof(T), detail::array_bytes<T>(count), dev, ctx, properties));
}
template <typename T>
T* malloc_shared(std::size_t count, const queue& q, const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc_shared(alignof(T), detail::array_bytes<T>(count), q, properties));
}
template <typename T>
T* aligned_alloc_shared(std::size_t alignment, std::size_t count, const device& dev,
                        const context& ctx, const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc_shared(alignment, detail::array_bytes<T>(count), dev, ctx, properties));
}
template <typename T>
T* aligned_alloc_shared(std::size_t alignment, std::size_t count, const queue& q,
                        const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc_shared(alignment, detail::array_bytes<T>(count), q, properties));
}

template <typename T>
T* malloc(std::size_t count, const device& dev, const context& ctx, usm::alloc kind,
          const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc(alignof(T), detail::array_bytes<T>(count), dev, ctx, kind, properties));
}
template <typename T>
T* malloc(std::size_t count, const queue& q, usm::alloc kind,
          const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc(alignof(T), detail::array_bytes<T>(count), q, kind, properties));
}
template <typename T>
T* aligned_alloc(std::size_t alignment, std::size_t count, const device& dev, const context& ctx,
                 usm::alloc kind, const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc(alignment, detail::array_bytes<T>(count), dev, ctx, kind, properties));
}
template <typename T>
T* aligned_alloc(std::size_t alignment, std::size_t count, const queue& q, usm::alloc kind,
                 const property_list& properties = {}) {
  return static_cast<T*>(
      aligned_alloc(alignment, detail::array_bytes<T>(count), q, kind, properties));
}

/// A standard allocator of host or shared memory.
template <typename T, usm::alloc AllocKind, std::size_t Alignment = 0>
class usm_allocator {
  static_assert(AllocKind == usm::alloc::host || AllocKind == usm::alloc::shared,
                "the host cannot construct elements in device memory");

 public:
  using value_type = T;
  using propagate_on_container_copy_assignment = std::true_type;
  using propagate_on_container_move_assignment = std::true_type;
  using propagate_on_container_swap = std::true_type;

  template <typename U>
  struct rebind {
    using other = usm_allocator<U, AllocKind, Alignment>;
  };

  usm_allocator() = delete;
  usm_allocator(const context& ctx, const device& dev, const property_list& properties = {})
      : context_(ctx), device_(dev), properties_(properties) {}
  usm_allocator(const queue& q, const property_list& properties = {})
      : usm_allocator(q.get_context(), q.get_device(), properties) {}
  usm_allocator(const usm_allocator&) = default;
  usm_allocator(usm_allocator&&) noexcept = default;
  usm_allocator& operator=(const usm_allocator&) = default;
  usm_allocator& operator=(usm_allocator&&) noexcept = default;
  template <typename U>
  usm_allocator(const usm_allocator<U, AllocKind, Alignment>& other) noexcept
      : context_(other.context_), device_(other.device_), properties_(other.properties_) {}

  /// errc::memory_allocation if the memory cannot be had.
  T* allocate(std::size_t count) {
    constexpr std::size_t alignment = Alignment > alignof(T) ? Alignment : alignof(T);
    T* const memory = aligned_alloc<T>(alignment, count, device_, context_, AllocKind, properties_);
    if (memory == nullptr) {
      detail::throw_error(errc::memory_allocation, "usm_allocator: allocation failed");
    }
    return memory;
  }
  void deallocate(T* memory, std::size_t) {
    if (memory != nullptr) free(memory, context_);
  }

  template <typename Property>
  bool has_property() const noexcept {
    return properties_.template has_property<Property>();
  }
  template <typename Property>
  Property get_property() const {
    return properties_.template get_property<Property>();
  }

  template <typename U, usm::alloc OtherKind, std::size_t OtherAlignment>
  friend bool operator==(const usm_allocator& a,
                         const usm_allocator<U, OtherKind, OtherAlignment>& b) noexcept {
    return a.equals(b);
  }

 private:
  template <typename, usm::alloc, std::size_t>
  friend class usm_allocator;

  template <typename U, usm::alloc OtherKind, std::size_t OtherAlignment>
  bool equals(const usm_allocator<U, OtherKind, OtherAlignment>& other) const noexcept {
    return AllocKind == OtherKind && Alignment == OtherAlignment && context_ == other.context_ &&
           device_ == other.device_;
  }

  context context_;
  device device_;
  property_list properties_;
};

}  // namespace sycl
