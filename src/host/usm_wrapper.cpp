// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "host/usm_wrapper.hpp"

#include <algorithm>
#include <cstdint>

#include "arbor/lumen/exception.hpp"

namespace arbor::lumen::vm::detail::host {
namespace {

constexpr std::size_t page = 4096;

/// Stands for a size that overflows: an allocation of it fails.
constexpr std::size_t unallocatable = PTRDIFF_MAX;

bool is_device_memory(const void* pointer, const sycl::context& context) {
  try {
    return sycl::get_pointer_type(pointer, context) == sycl::usm::alloc::device;
  } catch (...) {
    return false;  // what the runtime cannot name is used as it is
  }
}

}  // namespace

void* usm_wrapper_base::stage(sycl::queue& queue, void* pointer, std::int64_t count,
                              std::size_t element_size, std::size_t element_alignment,
                              bool is_output) {
  if (count != 0 && !is_device_memory(pointer, queue.get_context())) return pointer;
  std::size_t bytes;
  if (__builtin_mul_overflow(count, element_size, &bytes)) bytes = unallocatable;
  // An allocation of nothing may be null and be no failure; so one element is asked for then.
  const std::size_t capacity = std::max(bytes, element_size);
  void* copy = sycl::aligned_alloc_host(page, capacity, queue);
  if (copy == nullptr) copy = sycl::aligned_alloc_host(element_alignment, capacity, queue);
  if (copy == nullptr) throw invalid_argument("VM", "core::usm_wrapper", "nullptr on cpu malloc");
  try {
    if (bytes != 0) queue.memcpy(copy, pointer, bytes).wait_and_throw();
  } catch (...) {
    sycl::free(copy, queue);
    throw;
  }
  is_output_ = is_output;
  host_ptr_ = copy;
  device_ptr_ = pointer;
  bytes_ = bytes;
  queue_ = &queue;
  return copy;
}

void usm_wrapper_base::finish() {
  if (is_output_ && bytes_ != 0) queue_->memcpy(device_ptr_, host_ptr_, bytes_).wait();
  sycl::free(host_ptr_, *queue_);
}

}  // namespace arbor::lumen::vm::detail::host
