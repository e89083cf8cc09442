// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "device/usm_wrapper.hpp"

#include <algorithm>
#include <cstdint>

#include "arbor/lumen/exception.hpp"
#include "device/sycl_portability.hpp"

namespace arbor::lumen::vm::detail::device {
namespace {

/// Blocks above a page start on one; a smaller one needs no more than a word's alignment.
constexpr std::size_t page = 4096;

/// Stands for a size that overflows: an allocation of it fails.
constexpr std::size_t unallocatable = PTRDIFF_MAX;

bool reachable_from_device(const void* pointer, const sycl::context& context) {
  try {
    const sycl::usm::alloc kind = sycl::get_pointer_type(pointer, context);
    return kind == sycl::usm::alloc::device || kind == sycl::usm::alloc::shared;
  } catch (...) {
    return false;  // what the runtime cannot name is treated as plain host memory
  }
}

}  // namespace

void* usm_wrapper_base::wrap(sycl::queue& queue, void* pointer, std::int64_t count,
                             std::size_t element_size, std::size_t element_alignment,
                             bool copy_back) {
  if (pointer == nullptr) return nullptr;
  if (count > 0 && reachable_from_device(pointer, queue.get_context())) return pointer;
  queue_ = &queue;
  if (__builtin_mul_overflow(count, element_size, &bytes_)) bytes_ = unallocatable;
  stage(pointer, element_size, element_alignment);
  copy_back_ = copy_back;
  host_ptr_ = copy_back ? pointer : nullptr;
  return device_ptr_;
}

// An allocation of nothing may be null and be no failure; so one element is asked for then.
void usm_wrapper_base::stage(const void* source, std::size_t element_size,
                             std::size_t element_alignment) {
  const std::size_t bytes = std::max(bytes_, element_size);
  const std::size_t alignment = std::max(bytes <= page ? std::size_t{8} : page, element_alignment);
  void* copy = sycl::aligned_alloc_device(alignment, bytes, *queue_);
  if (copy == nullptr) copy = sycl::aligned_alloc_device(element_alignment, bytes, *queue_);
  if (copy == nullptr)
    throw invalid_argument("VM", "core::usm_wrapper", "nullptr on device malloc");
  try {
    queue_->memcpy(copy, source, bytes_).wait_and_throw();
  } catch (...) {
    sycl::free(copy, *queue_);
    throw;
  }
  device_ptr_ = copy;
}

usm_wrapper_base::~usm_wrapper_base() {
  if (device_ptr_ == nullptr) return;
  if (copy_back_) {
    event_.wait();
    queue_->memcpy(host_ptr_, device_ptr_, bytes_).wait();
  }
  portability::free_after(event_, device_ptr_, *queue_);
}

}  // namespace arbor::lumen::vm::detail::device
