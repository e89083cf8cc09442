// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <cstdint>
#include <sycl/sycl.hpp>

namespace arbor::lumen::vm::detail::device {

/// The untyped half of `usm_wrapper`.
class usm_wrapper_base {
 public:
  usm_wrapper_base() = default;
  usm_wrapper_base(const usm_wrapper_base&) = delete;
  usm_wrapper_base& operator=(const usm_wrapper_base&) = delete;
  /// Waits for the event and copies back if asked to; frees the copy, after the event if that was
  /// not waited for. A failure here ends the process.
  ~usm_wrapper_base();

  /// The command that has to finish before the copy may be read back or freed.
  void set_event(const sycl::event& event) { event_ = event; }

 protected:
  void* wrap(sycl::queue& queue, void* pointer, std::int64_t count, std::size_t element_size,
             std::size_t element_alignment, bool copy_back);

 private:
  void stage(const void* source, std::size_t element_size, std::size_t element_alignment);

  bool copy_back_ = false;
  void* device_ptr_ = nullptr;
  void* host_ptr_ = nullptr;
  std::size_t bytes_ = 0;
  sycl::queue* queue_ = nullptr;
  sycl::event event_;
};

/// A device copy of a host array for the span of a call. A pointer that the device can reach is
/// handed through untouched; any other memory is copied to a device allocation, which replaces the
/// array in the kernel and is copied back at the end where the array is an output.
template <typename T>
class usm_wrapper : public usm_wrapper_base {
 public:
  /// The pointer that a kernel on `queue` may use for the `count` elements at `pointer`; null for
  /// null. Output arrays (`copy_back`) are copied in as well, so that elements that the kernel does
  /// not write keep their values.
  /// @throws invalid_argument if the device has no memory left
  T* wrap(sycl::queue& queue, T* pointer, std::int64_t count, bool copy_back) {
    return static_cast<T*>(
        usm_wrapper_base::wrap(queue, pointer, count, sizeof(T), alignof(T), copy_back));
  }
  const T* wrap(sycl::queue& queue, const T* pointer, std::int64_t count) {
    return wrap(queue, const_cast<T*>(pointer), count, false);
  }
};

}  // namespace arbor::lumen::vm::detail::device
