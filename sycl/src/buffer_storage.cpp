// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "buffer_storage.hpp"

#include <cstring>
#include <mutex>
#include <new>
#include <utility>

#include "scheduler.hpp"

namespace sycl::detail {

namespace {

/// Where the default allocator puts what it allocates.
constexpr std::align_val_t cache_line{64};

[[noreturn]] void throw_no_memory() {
  throw exception(errc::memory_allocation, "there is no memory for the buffer");
}

std::size_t bytes_of(const buffer_description& description) {
  std::size_t bytes = 0;
  if (__builtin_mul_overflow(description.elements, description.element_size, &bytes)) {
    throw_no_memory();
  }
  return bytes;
}

}  // namespace

buffer_storage::buffer_storage(const buffer_description& described,
                               std::unique_ptr<buffer_memory> memory,
                               const property_list& buffer_properties)
    : properties(buffer_properties),
      description_(described),
      memory_(std::move(memory)),
      data_(const_cast<void*>(description_.initial)),
      in_place_(
          description_.initial != nullptr &&
          (properties.has_property<property::buffer::use_host_ptr>() ||
           (description_.in_place && !properties.has_property<property::buffer::use_mutex>()))),
      write_back_(description_.write_back),
      whole_(region{this, 0, bytes_of(description_)}) {
  if (in_place_) return;
  allocate();
  if (description_.initial != nullptr && bytes() != 0) {
    const auto lock = callers_lock();
    std::memcpy(data_, description_.initial, bytes());
  }
}

buffer_storage::~buffer_storage() {
  if (in_place_ || is_small_ || data_ == nullptr) return;
  if (memory_ != nullptr) {
    memory_->release(data_, description_.elements);
  } else {
    ::operator delete(data_, cache_line);
  }
}

view_handle buffer_view::make(const buffer_description& description,
                              std::unique_ptr<buffer_memory> memory,
                              const property_list& properties) {
  auto made = std::make_shared<buffer_storage>(description, std::move(memory), properties);
  buffer_storage& storage = *made;
  storage.self_ = std::move(made);
  return view_handle(&storage.whole_);
}

void buffer_storage::close() {
  const std::shared_ptr<buffer_storage> keep = std::move(self_);
  const bool to_caller = write_back_ && !redirected_ && modified_ && !in_place_;
  const bool to_destination = write_back_ && destination_ != nullptr;
  if (to_caller || to_destination || in_place_) wait_for_accesses(0, bytes());
  if (to_caller || to_destination) {
    const auto lock = callers_lock();
    if (to_destination) {
      destination_->write(data_, description_.elements);
    } else if (bytes() != 0) {
      std::memcpy(const_cast<void*>(description_.initial), data_, bytes());
    }
  }
  destination_ = nullptr;
  description_.keep_alive = nullptr;
}

void buffer_storage::set_final_data(std::unique_ptr<final_destination> destination) {
  destination_ = std::move(destination);
  redirected_ = true;
  write_back_ = true;
}

std::unique_lock<std::mutex> buffer_storage::callers_lock() const {
  if (!properties.has_property<property::buffer::use_mutex>()) return {};
  return std::unique_lock(*properties.get_property<property::buffer::use_mutex>().get_mutex_ptr());
}

void buffer_storage::allocate() {
  data_ = nullptr;
  if (bytes() != 0 && bytes() <= small && memory_ == nullptr) {
    std::size_t space = sizeof small_;
    data_ = small_;
    data_ = std::align(small, bytes(), data_, space);
    is_small_ = true;
  } else if (description_.elements != 0) {
    try {
      data_ = memory_ != nullptr ? memory_->allocate(description_.elements)
                                 : ::operator new(bytes(), cache_line);
    } catch (const std::bad_alloc&) {
      throw_no_memory();
    }
  }
  in_place_ = false;
}

void buffer_storage::leave_callers_memory() {
  if (!in_place_ || accessed_ || properties.has_property<property::buffer::use_host_ptr>()) return;
  const void* const initial = data_;
  allocate();
  if (bytes() != 0) std::memcpy(data_, initial, bytes());
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
