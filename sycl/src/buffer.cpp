// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <atomic>
#include <cstring>
#include <mutex>
#include <string>
#include <utility>

#include "buffer_storage.hpp"
#include "scheduler.hpp"
#include "sycl/detail/buffer_view.hpp"
#include "sycl/detail/region.hpp"
#include "sycl/event.hpp"

namespace sycl::detail {

buffer_memory::~buffer_memory() = default;
final_destination::~final_destination() = default;

/// What all views of a buffer share; gone with the last of them.
class buffer_core {
 public:
  buffer_core(buffer_description described, std::unique_ptr<buffer_memory> memory,
              const property_list& properties)
      : storage(std::make_shared<buffer_storage>(described, std::move(memory), properties)),
        description(std::move(described)),
        write_back(description.write_back) {}

  /// The contents go where they belong. Memory of the buffer's own that goes nowhere is left to
  /// the commands that still use it.
  ~buffer_core() {
    const bool to_caller = write_back && !redirected && storage->modified() && !storage->in_place();
    const bool to_destination = write_back && destination != nullptr;
    if (!to_caller && !to_destination && !storage->in_place()) return;
    storage->wait_for_accesses(0, storage->elements() * storage->element_size());
    if (!to_caller && !to_destination) return;
    std::unique_lock<std::mutex> lock;
    if (storage->properties.has_property<property::buffer::use_mutex>()) {
      lock = std::unique_lock(
          *storage->properties.get_property<property::buffer::use_mutex>().get_mutex_ptr());
    }
    if (to_destination) {
      destination->write(storage->data(), storage->elements());
    } else if (storage->elements() != 0) {
      std::memcpy(const_cast<void*>(description.initial), storage->data(),
                  storage->elements() * storage->element_size());
    }
  }

  const std::shared_ptr<buffer_storage> storage;
  const buffer_description description;
  std::unique_ptr<final_destination> destination;
  /// The contents do not go to the caller's memory any more.
  bool redirected = false;
  bool write_back;
};

buffer_view::buffer_view(buffer_description description, std::unique_ptr<buffer_memory> memory,
                         const property_list& properties)
    : core_(std::make_shared<buffer_core>(std::move(description), std::move(memory), properties)),
      region_{core_->storage.get(), 0,
              core_->description.elements * core_->description.element_size} {}

buffer_view::buffer_view(const buffer_view& parent, std::size_t offset, std::size_t bytes)
    : core_(parent.core_),
      region_{parent.region_.storage, parent.region_.begin + offset,
              parent.region_.begin + offset + bytes},
      sub_buffer_(true) {}

buffer_view::buffer_view(const buffer_view& parent)
    : core_(parent.core_), region_(parent.region_), sub_buffer_(parent.sub_buffer_) {}

buffer_view::~buffer_view() {
  if (destination_ == nullptr || !write_back_) return;
  core_->storage->wait_for_accesses(region_.begin, region_.end);
  destination_->write(region_data(region_), size() / element_size_);
}

const property_list& buffer_view::properties() const noexcept { return core_->storage->properties; }

void buffer_view::set_final_data(std::unique_ptr<final_destination> destination,
                                 std::size_t element_size) {
  if (sub_buffer_ || element_size != core_->description.element_size) {
    destination_ = std::move(destination);
    element_size_ = element_size;
    if (!sub_buffer_) core_->redirected = true;
  } else {
    core_->destination = std::move(destination);
    core_->redirected = true;
    core_->write_back = true;
  }
  if (!sub_buffer_) core_->storage->leave_callers_memory();
}

void buffer_view::set_write_back(bool enabled) {
  write_back_ = enabled;
  if (sub_buffer_) return;
  core_->write_back = enabled;
  if (!enabled) core_->storage->leave_callers_memory();
}

void* region_data(const region& bytes) noexcept {
  if (bytes.storage == nullptr) return nullptr;
  bytes.storage->note_access(false);
  return static_cast<unsigned char*>(bytes.storage->data()) + bytes.begin;
}

std::uint64_t new_accessor_number() noexcept {
  static constinit std::atomic<std::uint64_t> last{0};
  return last.fetch_add(1, std::memory_order_relaxed) + 1;
}

void check_access(access_mode mode, const property_list& properties) {
  if (mode == access_mode::read && properties.has_property<property::no_init>()) {
    throw exception(errc::invalid, "accessor cannot be both read_only and no_init");
  }
}

void check_access_range(std::size_t whole, std::size_t offset, std::size_t extent) {
  if (offset > whole || extent > whole - offset) {
    throw exception(errc::invalid, "the range [" + std::to_string(offset) + ", " +
                                       std::to_string(offset) + " + " + std::to_string(extent) +
                                       ") exceeds the buffer's " + std::to_string(whole));
  }
}

std::shared_ptr<void> begin_host_access(const region& bytes, access_mode mode) {
  scheduler& runner = scheduler::instance();
  const auto access = std::make_shared<command>();
  access->what = action::host_access;
  access->self = access;
  bytes.storage->note_access(mode != access_mode::read);
  access->add_access(bytes.storage->shared_from_this(), bytes.begin, bytes.end,
                     mode != access_mode::read);
  access->register_accesses();
  access->link();
  if (access->release_one()) {
    access->set_state(command_state::running);
  } else {
    for (event& before : access->wait_list()) before.wait();
    access->await(command_state::running);
  }
  return {access.get(), [&runner](void* ending) {
            runner.finish(std::move(static_cast<command*>(ending)->self));
          }};
}

}  // namespace sycl::detail
