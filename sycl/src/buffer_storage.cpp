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

std::size_t bytes_of(std::size_t elements, std::size_t element_size) {
  std::size_t bytes = 0;
  if (__builtin_mul_overflow(elements, element_size, &bytes)) throw_no_memory();
  return bytes;
}

}  // namespace

bool buffer_origin::in_place() const noexcept {
  return description.initial != nullptr &&
         (properties.has_property<property::buffer::use_host_ptr>() ||
          (description.in_place && !properties.has_property<property::buffer::use_mutex>()));
}

std::unique_lock<std::mutex> buffer_origin::callers_lock() const {
  if (!properties.has_property<property::buffer::use_mutex>()) return {};
  return std::unique_lock(*properties.get_property<property::buffer::use_mutex>().get_mutex_ptr());
}

view_handle buffer_view::make(const buffer_description& description,
                              std::unique_ptr<buffer_memory> memory,
                              const property_list& properties) {
  std::unique_ptr<buffer_origin> origin;
  if (description.initial != nullptr || memory != nullptr || !properties.entries_.empty()) {
    origin.reset(new buffer_origin{.description = description,
                                   .memory = std::move(memory),
                                   .properties = properties,
                                   .destination = nullptr,
                                   .write_back = description.write_back});
  }
  return buffer_storage::make(description.elements, description.element_size, std::move(origin));
}

buffer_view* deferred_view::make() const {
  view_handle made = buffer_storage::make(elements_, element_size_, nullptr);
  buffer_view* before = nullptr;
  if (view_.compare_exchange_strong(before, made.get(), std::memory_order_acq_rel)) {
    return made.release();
  }
  return before;
}

view_handle buffer_storage::make(std::size_t elements, std::size_t element_size,
                                 std::unique_ptr<buffer_origin> origin) {
  auto made = std::make_shared<buffer_storage>(elements, element_size, std::move(origin));
  buffer_storage& storage = *made;
  storage.self_ = std::move(made);
  return view_handle(&storage.whole_);
}

buffer_storage::buffer_storage(std::size_t elements, std::size_t element_size,
                               std::unique_ptr<buffer_origin> origin)
    : elements_(elements),
      element_size_(element_size),
      origin_(std::move(origin)),
      in_place_(origin_ != nullptr && origin_->in_place()),
      whole_(region{this, 0, bytes_of(elements, element_size)}) {
  const void* const initial = origin_ != nullptr ? origin_->description.initial : nullptr;
  if (in_place_) {
    data_ = const_cast<void*>(initial);
    return;
  }
  allocate();
  if (initial != nullptr && bytes() != 0) {
    const auto lock = origin_->callers_lock();
    std::memcpy(data_, initial, bytes());
  }
}

buffer_storage::~buffer_storage() {
  if (in_place_ || is_small_ || data_ == nullptr) return;
  if (origin_ != nullptr && origin_->memory != nullptr) {
    origin_->memory->release(data_, elements_);
  } else {
    ::operator delete(data_, cache_line);
  }
}

void buffer_storage::close() {
  const std::shared_ptr<buffer_storage> keep = std::move(self_);
  if (origin_ == nullptr) return;
  const bool written = origin_->write_back && origin_->description.write_back;
  const bool to_caller = written && !origin_->redirected && modified_ && !in_place_;
  const bool to_destination = origin_->write_back && origin_->destination != nullptr;
  if (to_caller || to_destination || in_place_) wait_for_accesses(0, bytes());
  if (to_caller || to_destination) {
    const auto lock = origin_->callers_lock();
    if (to_destination) {
      origin_->destination->write(data_, elements_);
    } else if (bytes() != 0) {
      std::memcpy(const_cast<void*>(origin_->description.initial), data_, bytes());
    }
  }
  origin_->destination = nullptr;
  origin_->description.keep_alive = nullptr;
}

buffer_origin& buffer_storage::origin() {
  if (origin_ == nullptr) origin_ = std::make_unique<buffer_origin>();
  return *origin_;
}

const property_list& buffer_storage::properties() const noexcept {
  static const property_list none;
  return origin_ != nullptr ? origin_->properties : none;
}

void buffer_storage::allocate() {
  buffer_memory* const memory = origin_ != nullptr ? origin_->memory.get() : nullptr;
  data_ = nullptr;
  if (bytes() != 0 && bytes() <= small && memory == nullptr) {
    std::size_t space = sizeof small_;
    data_ = small_;
    data_ = std::align(small, bytes(), data_, space);
    is_small_ = true;
  } else if (elements_ != 0) {
    try {
      data_ = memory != nullptr ? memory->allocate(elements_) : ::operator new(bytes(), cache_line);
    } catch (const std::bad_alloc&) {
      throw_no_memory();
    }
  }
  in_place_ = false;
}

void buffer_storage::leave_callers_memory() {
  if (!in_place_ || accessed_ || properties().has_property<property::buffer::use_host_ptr>()) {
    return;
  }
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
