// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <cstdint>
#include <sycl/sycl.hpp>

#include "call/queue_key.hpp"

namespace arbor::lumen::vm::detail::host {

/// The queue of a call and what its arrays need to know of it.
struct staging_queue {
  explicit staging_queue(const keyed_queue& callers)
      : queue(*callers), is_cpu(callers.device().is_cpu()) {}
  sycl::queue& queue;
  bool is_cpu;
};

/// The untyped half of `usm_wrapper`.
class usm_wrapper_base {
 public:
  usm_wrapper_base() = default;
  usm_wrapper_base(const usm_wrapper_base&) = delete;
  usm_wrapper_base& operator=(const usm_wrapper_base&) = delete;
  /// Copies an output back and frees the copy. A failure here ends the process.
  ~usm_wrapper_base() {
    if (host_ptr_ != nullptr) finish();
  }

 protected:
  void* wrap(const staging_queue& on, void* pointer, std::int64_t count, std::size_t element_size,
             std::size_t element_alignment, bool is_output) {
    if (pointer == nullptr || (count != 0 && on.is_cpu)) return pointer;
    return stage(on.queue, pointer, count, element_size, element_alignment, is_output);
  }

 private:
  void* stage(sycl::queue& queue, void* pointer, std::int64_t count, std::size_t element_size,
              std::size_t element_alignment, bool is_output);
  void finish();

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
  T* wrap(const staging_queue& on, T* pointer, std::int64_t count, bool is_output) {
    return static_cast<T*>(
        usm_wrapper_base::wrap(on, pointer, count, sizeof(T), alignof(T), is_output));
  }
  const T* wrap(const staging_queue& on, const T* pointer, std::int64_t count) {
    return wrap(on, const_cast<T*>(pointer), count, false);
  }
};

}  // namespace arbor::lumen::vm::detail::host
