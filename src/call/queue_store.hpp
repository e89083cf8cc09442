// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <mutex>
#include <sycl/sycl.hpp>
#include <unordered_map>

#include "call/queue_key.hpp"
#include "lumen_arr.h"

namespace arbor::lumen::vm::detail {

namespace classic {
class error_handler;
}

/// The process-wide store of per-queue state. Entries are never removed. One mutex guards the maps
/// and what belongs to the active handler, and is held only around access to them.
class queue_store {
 public:
  static queue_store& instance();

  /// A finished event that all callers share; what a call returns that has nothing to wait for.
  sycl::event default_event();

  /// The mode word stored for a queue, 0 if there is none.
  std::uint32_t stored_mode(std::uint64_t key);

  /// Merges `mode` into the stored word, or into the default word if there is none.
  /// @returns the word stored before, 0 if there was none.
  std::uint32_t merge_mode(std::uint64_t key, std::uint32_t mode);

  /// The status word of a queue, made at zero if absent. The reference stays valid as long as the
  /// store lives, so it may be ored into outside the lock.
  std::atomic<std::uint32_t>& status_word(std::uint64_t key);

  /// Notes what the queue's device was classified as.
  void record_device_word(std::uint64_t key, std::uint64_t device_word);

  /// The handler that array-math kernels report to, null if there is none, and the callback that
  /// was registered with them before it.
  classic::error_handler* active_handler();
  void set_active_handler(classic::error_handler* handler);
  lumen_arr_error_callback saved_callback();
  void set_saved_callback(lumen_arr_error_callback callback);

 private:
  queue_store() = default;
  void read_verbosity();

  struct fnv_hash {
    std::size_t operator()(std::uint64_t key) const { return fnv(key); }
  };
  template <typename V>
  using map = std::unordered_map<std::uint64_t, V, fnv_hash>;
  static constexpr std::size_t first_buckets = 8;

  std::mutex mutex_;
  map<std::uint32_t> modes_{first_buckets};
  map<std::atomic<std::uint32_t>> statuses_{first_buckets};
  map<std::uint64_t> device_words_{first_buckets};
  /// The entry that was written last: calls come in rows on one queue.
  map<std::uint64_t>::value_type* last_device_word_ = nullptr;
  classic::error_handler* active_handler_ = nullptr;
  lumen_arr_error_callback saved_callback_ = nullptr;
  std::atomic<std::int32_t> verbosity_{0};
};

}  // namespace arbor::lumen::vm::detail
