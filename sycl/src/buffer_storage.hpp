// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <memory>

#include "command.hpp"
#include "spin_mutex.hpp"
#include "sycl/detail/buffer_view.hpp"

namespace sycl::detail {

/// The memory of a buffer and the accesses to it that are not complete.
class buffer_storage : public std::enable_shared_from_this<buffer_storage> {
 public:
  buffer_storage(const buffer_description& description, std::unique_ptr<buffer_memory> memory,
                 const property_list& properties);
  ~buffer_storage();
  buffer_storage& operator=(const buffer_storage&) = delete;

  /// Guards the lists of accesses of all storages.
  static spin_mutex& accesses_mutex() noexcept;
  /// With accesses_mutex() held.
  void add_access(access_record& added, command& owner);
  void remove_access(access_record& removed) noexcept;

  void wait_for_accesses(std::size_t begin, std::size_t end);
  /// Stops working in the caller's memory, unless somebody may know the address already.
  void leave_callers_memory();

  void* data() const noexcept { return data_; }
  bool in_place() const noexcept { return in_place_; }
  std::size_t elements() const noexcept { return elements_; }
  std::size_t element_size() const noexcept { return element_size_; }

  const property_list properties;

  /// Some accessor has been made, one that writes if `write`.
  void note_access(bool write) noexcept {
    if (!accessed_.load(std::memory_order_relaxed)) accessed_ = true;
    if (write && !modified_.load(std::memory_order_relaxed)) modified_ = true;
  }
  bool modified() const noexcept { return modified_; }

 private:
  void allocate();

  /// Room for a buffer of a few elements, which then costs no allocation, aligned like any other.
  static constexpr std::size_t small = 64;
  alignas(std::max_align_t) std::byte small_[2 * small];
  bool is_small_ = false;

  std::size_t elements_;
  std::size_t element_size_;
  std::unique_ptr<buffer_memory> memory_;
  void* data_;
  bool in_place_;
  std::atomic<bool> accessed_{false};
  std::atomic<bool> modified_{false};
  access_record* first_ = nullptr;
  access_record* last_ = nullptr;
};

}  // namespace sycl::detail
