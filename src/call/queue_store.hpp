// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <array>
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

/// A word for each queue by its key, 0 until it is set. Entries are never removed and never move.
template <typename Word>
class queue_words {
 public:
  /// The mutex guards the map and is held only around access to it.
  explicit queue_words(std::mutex& mutex) : mutex_(mutex) {}

  /// The word of a queue. The reference is valid as long as the map is.
  std::atomic<Word>& operator[](std::uint64_t key) {
    entry* const known = recent(key).load(std::memory_order_acquire);
    return known != nullptr && known->first == key ? known->second : look_up(key);
  }

 private:
  struct fnv_hash {
    std::size_t operator()(std::uint64_t key) const { return fnv(key); }
  };
  using map = std::unordered_map<std::uint64_t, std::atomic<Word>, fnv_hash>;
  using entry = typename map::value_type;
  static constexpr std::size_t first_buckets = 8;
  static constexpr int recent_bits = 4;

  std::atomic<entry*>& recent(std::uint64_t key) { return recent_[key >> (64 - recent_bits)]; }
  std::atomic<Word>& look_up(std::uint64_t key);

  std::mutex& mutex_;
  map words_{first_buckets};
  /// Entries that were found lately: calls come in rows on a few queues, and take no lock then.
  std::array<std::atomic<entry*>, 1 << recent_bits> recent_{};
};

/// The process-wide store of per-queue state, with one mutex for all of it.
class queue_store {
 public:
  static queue_store& instance();

  /// A finished event that all callers share; what a call returns that has nothing to wait for.
  sycl::event default_event();

  /// The mode word stored for a queue, 0 if there is none.
  std::uint32_t stored_mode(std::uint64_t key) {
    return modes_[key].load(std::memory_order_relaxed);
  }

  /// Merges `mode` into the stored word, or into the default word if there is none.
  /// @returns the word stored before, 0 if there was none.
  std::uint32_t merge_mode(std::uint64_t key, std::uint32_t mode);

  /// The status word of a queue. The reference stays valid as long as the store lives.
  std::atomic<std::uint32_t>& status_word(std::uint64_t key) { return statuses_[key]; }

  /// Notes what the queue's device was classified as.
  void record_device_word(std::uint64_t key, std::uint64_t device_word);

  /// The handler that array-math kernels report to, null if there is none, and the callback that
  /// was registered with them before it.
  classic::error_handler* active_handler();
  void set_active_handler(classic::error_handler* handler);
  lumen_arr_error_callback saved_callback();
  void set_saved_callback(lumen_arr_error_callback callback);

 private:
  [[gnu::noinline]] queue_store();  // keeps instance() short
  void read_verbosity();

  std::mutex mutex_;
  queue_words<std::uint32_t> modes_{mutex_};
  queue_words<std::uint32_t> statuses_{mutex_};
  queue_words<std::uint64_t> device_words_{mutex_};
  classic::error_handler* active_handler_ = nullptr;
  lumen_arr_error_callback saved_callback_ = nullptr;
  std::atomic<std::int32_t> verbosity_{0};
};

}  // namespace arbor::lumen::vm::detail
