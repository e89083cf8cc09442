// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <cstdint>
#include <sycl/sycl.hpp>

namespace arbor::lumen::vm::detail::host {

/// The untyped half of `usm_wrapper`.
class usm_wrapper_base {
 public:
  usm_wrapper_base() = default;
  usm_wrapper_base(const usm_wrapper_base&) = delete;
  usm_wrapper_base& operator=(const usm_wrapper_base&) = delete;
  /// Copies an output back and frees the copy. A failure here ends the process.
  ~usm_wrapper_base();

 protected:
  void* wrap(sycl::queue& queue, void* pointer, std::int64_t count, std::size_t element_size,
             std::size_t element_alignment, bool is_output);

 private:
  bool is_output_ = false;
  void* host_ptr_ = nullptr;
  void* device_ptr_ = nullptr;
  std::size_t bytes_ = 0;
  sycl::queue* queue_ = nullptr;
};

/// A host copy of an array in device memory for the span of a call on the host. Memory that the
/// host can reach, and any memory of a CPU device, is used in place.
template <typename T>
class usm_wrapper : public usm_wrapper_base {
 public:
  /// The pointer that the host may use for the `count` elements at `pointer`; null for null.
  /// Outputs are copied in as well, so that elements outside a slice keep their values.
  /// @throws invalid_argument if there is no host memory left
  T* wrap(sycl::queue& queue, T* pointer, std::int64_t count, bool is_output) {
    return static_cast<T*>(
        usm_wrapper_base::wrap(queue, pointer, count, sizeof(T), alignof(T), is_output));
  }
  const T* wrap(sycl::queue& queue, const T* pointer, std::int64_t count) {
    return wrap(queue, const_cast<T*>(pointer), count, false);
  }
};

}  // namespace arbor::lumen::vm::detail::host
