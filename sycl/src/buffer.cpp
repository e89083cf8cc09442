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

view_handle buffer_view::part(std::size_t offset, std::size_t bytes) {
  const std::size_t begin = region_.begin + offset;
  return view_handle(new buffer_view(whole(), {region_.storage, begin, begin + bytes}, true));
}

view_handle buffer_view::reinterpretation() {
  return view_handle(new buffer_view(whole(), region_, sub_buffer_));
}

view_handle buffer_view::whole() { return whole_.get() != nullptr ? whole_ : share(); }

void buffer_view::end() {
  if (whole_.get() == nullptr) return region_.storage->close();
  if (destination_ != nullptr && write_back_) {
    region_.storage->wait_for_accesses(region_.begin, region_.end);
    destination_->write(region_data(region_), size() / element_size_);
  }
  delete this;
}

const property_list& buffer_view::properties() const noexcept {
  return region_.storage->properties();
}

void buffer_view::set_final_data(std::unique_ptr<final_destination> destination,
                                 std::size_t element_size) {
  if (sub_buffer_ || element_size != region_.storage->element_size()) {
    destination_ = std::move(destination);
    element_size_ = element_size;
    if (!sub_buffer_) region_.storage->origin().redirected = true;
  } else {
    buffer_origin& origin = region_.storage->origin();
    origin.destination = std::move(destination);
    origin.redirected = true;
    origin.write_back = true;
  }
  if (!sub_buffer_) region_.storage->leave_callers_memory();
}

void buffer_view::set_write_back(bool enabled) {
  write_back_ = enabled;
  if (sub_buffer_) return;
  region_.storage->origin().write_back = enabled;
  if (!enabled) region_.storage->leave_callers_memory();
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
  access->add_access(bytes.storage->self(), bytes.begin, bytes.end, mode != access_mode::read);
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
