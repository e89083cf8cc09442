// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <memory>
#include <mutex>

#include "command.hpp"
#include "spin_mutex.hpp"
#include "sycl/detail/buffer_view.hpp"

namespace sycl::detail {

/// What a buffer has beside its memory, unless it began as uninitialised memory of the default
/// allocator and nothing was said of its contents.
struct buffer_origin {
  /// The buffer works in the memory that it was given.
  bool in_place() const noexcept;
  /// Keeps the mutex of property::buffer::use_mutex, if there is one.
  std::unique_lock<std::mutex> callers_lock() const;

  buffer_description description;
  std::unique_ptr<buffer_memory> memory;
  property_list properties;
  std::unique_ptr<final_destination> destination;
  /// The contents do not go to the caller's memory any more.
  bool redirected = false;
  bool write_back = false;
};

/// What all views of a buffer share: its memory, the accesses to it that are not complete, and what
/// becomes of the contents. It lives until the last view is gone and the last command that uses it
/// is complete; until then the view of the whole buffer owns it.
class buffer_storage {
 public:
  /// A null origin stands for an empty one.
  buffer_storage(std::size_t elements, std::size_t element_size,
                 std::unique_ptr<buffer_origin> origin);
  ~buffer_storage();
  buffer_storage(const buffer_storage&) = delete;
  buffer_storage& operator=(const buffer_storage&) = delete;

  /// For a command. The buffer must be alive.
  const std::shared_ptr<buffer_storage>& self() const noexcept { return self_; }

  /// The contents go where they belong. Memory of the buffer's own that goes nowhere is left to
  /// the commands that still use it.
  void close();
  buffer_origin& origin();
  const property_list& properties() const noexcept;

  /// Guards the lists of accesses of all storages.
  static spin_mutex& accesses_mutex() noexcept;
  /// With accesses_mutex() held.
  void add_access(access_record& added, command& owner);
  void remove_access(access_record& removed) noexcept;

  void wait_for_accesses(std::size_t begin, std::size_t end);
  /// Stops working in the caller's memory, unless somebody may know the address already.
  void leave_callers_memory();

  void* data() const noexcept { return data_; }
  std::size_t element_size() const noexcept { return element_size_; }

  /// Some accessor has been made, one that writes if `write`.
  void note_access(bool write) noexcept {
    if (!accessed_.load(std::memory_order_relaxed)) accessed_ = true;
    if (write && !modified_.load(std::memory_order_relaxed)) modified_ = true;
  }

 private:
  friend class buffer_view;
  friend class deferred_view;

  /// The view of the whole of a new storage.
  static view_handle make(std::size_t elements, std::size_t element_size,
                          std::unique_ptr<buffer_origin> origin);

  std::size_t bytes() const noexcept { return whole_.size(); }
  void allocate();

  /// Room for a buffer of a few elements, which then costs no allocation, aligned like any other.
  static constexpr std::size_t small = deferred_view::small;
  alignas(std::max_align_t) std::byte small_[2 * small];
  bool is_small_ = false;

  std::size_t elements_;
  std::size_t element_size_;
  std::unique_ptr<buffer_origin> origin_;
  void* data_ = nullptr;
  bool in_place_;
  std::atomic<bool> accessed_{false};
  std::atomic<bool> modified_{false};
  access_record* first_ = nullptr;
  access_record* last_ = nullptr;
  buffer_view whole_;
  std::shared_ptr<buffer_storage> self_;
};

}  // namespace sycl::detail
