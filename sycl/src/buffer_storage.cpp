// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "buffer_storage.hpp"

#include <cstring>
#include <mutex>
#include <utility>

#include "scheduler.hpp"

namespace sycl::detail {

buffer_storage::buffer_storage(const buffer_description& description,
                               std::unique_ptr<buffer_memory> memory,
                               const property_list& buffer_properties)
    : properties(buffer_properties),
      elements_(description.elements),
      element_size_(description.element_size),
      memory_(std::move(memory)),
      data_(const_cast<void*>(description.initial)),
      in_place_(
          description.initial != nullptr &&
          (properties.has_property<property::buffer::use_host_ptr>() ||
           (description.in_place && !properties.has_property<property::buffer::use_mutex>()))) {
  if (in_place_) return;
  allocate();
  if (description.initial != nullptr && elements_ != 0) {
    std::unique_lock<std::mutex> lock;
    if (properties.has_property<property::buffer::use_mutex>()) {
      lock =
          std::unique_lock(*properties.get_property<property::buffer::use_mutex>().get_mutex_ptr());
    }
    std::memcpy(data_, description.initial, elements_ * element_size_);
  }
}

buffer_storage::~buffer_storage() {
  if (!in_place_ && !is_small_ && data_ != nullptr) memory_->release(data_, elements_);
}

void buffer_storage::allocate() {
  data_ = nullptr;
  if (elements_ != 0 && elements_ * element_size_ <= small && memory_->is_default()) {
    std::size_t space = sizeof small_;
    data_ = small_;
    data_ = std::align(small, elements_ * element_size_, data_, space);
    is_small_ = true;
  } else if (elements_ != 0) {
    try {
      data_ = memory_->allocate(elements_);
    } catch (const std::bad_alloc&) {
      throw exception(errc::memory_allocation, "there is no memory for the buffer");
    }
  }
  in_place_ = false;
}

void buffer_storage::leave_callers_memory() {
  if (!in_place_ || accessed_ || properties.has_property<property::buffer::use_host_ptr>()) return;
  const void* const initial = data_;
  allocate();
  if (elements_ != 0) std::memcpy(data_, initial, elements_ * element_size_);
}

spin_mutex& buffer_storage::accesses_mutex() noexcept {
  static constinit spin_mutex mutex;
  return mutex;
}

void buffer_storage::add_access(access_record& added, command& owner) {
  for (const access_record* other = first_; other != nullptr; other = other->next) {
    const bool overlap = other->begin < added.end && added.begin < other->end;
    if (overlap && other->owner != &owner && (other->write || added.write)) {
      owner.add_dependency(other->owner->shared_from_this());
    }
  }
  added.next = nullptr;
  added.previous = last_;
  (last_ == nullptr ? first_ : last_->next) = &added;
  last_ = &added;
}

void buffer_storage::remove_access(access_record& removed) noexcept {
  (removed.previous == nullptr ? first_ : removed.previous->next) = removed.next;
  (removed.next == nullptr ? last_ : removed.next->previous) = removed.previous;
}

void buffer_storage::wait_for_accesses(std::size_t begin, std::size_t end) {
  for (;;) {
    std::shared_ptr<command> found;
    {
      const std::lock_guard lock(accesses_mutex());
      for (const access_record* other = first_; other != nullptr; other = other->next) {
        if (other->begin < end && begin < other->end && !other->owner->complete()) {
          found = other->owner->shared_from_this();
          break;
        }
      }
    }
    if (found == nullptr) return;
    scheduler::instance().wait(*found);
  }
}

}  // namespace sycl::detail
