// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "call/queue_store.hpp"

#include <cstdlib>

#include "call/mode_word.hpp"

namespace arbor::lumen::vm::detail {
template <typename Word>
std::atomic<Word>& queue_words<Word>::look_up(std::uint64_t key) {
  const std::lock_guard lock(mutex_);
  entry& found = *words_.try_emplace(key).first;
  recent(key).store(&found, std::memory_order_release);
  return found.second;
}

template class queue_words<std::uint32_t>;
template class queue_words<std::uint64_t>;

queue_store::queue_store() = default;

queue_store& queue_store::instance() {
  static queue_store store;
  // A level of 0 doubles as the mark that nothing was read, so it alone is read again.
  if (store.verbosity_.load(std::memory_order_relaxed) == 0) store.read_verbosity();
  return store;
}

void queue_store::read_verbosity() {
  const char* text = std::getenv("ARBORLUMEN_VM_VERBOSE");
  const bool digit = text != nullptr && *text >= '0' && *text <= '9';
  verbosity_.store(digit ? *text - '0' : -1, std::memory_order_relaxed);
}

sycl::event queue_store::default_event() {
  static const sycl::event shared;
  return shared;
}

std::uint32_t queue_store::merge_mode(std::uint64_t key, std::uint32_t mode) {
  std::atomic<std::uint32_t>& stored = modes_[key];
  std::uint32_t before = stored.load(std::memory_order_relaxed);
  const auto merged = [&] {
    return mode_word::merge(before != 0 ? before : enums::default_mode, mode);
  };
  while (!stored.compare_exchange_weak(before, merged(), std::memory_order_relaxed)) {
  }
  return before;
}

void queue_store::record_device_word(std::uint64_t key, std::uint64_t device_word) {
  std::atomic<std::uint64_t>& noted = device_words_[key];
  if (noted.load(std::memory_order_relaxed) != device_word)
    noted.store(device_word, std::memory_order_relaxed);
}

classic::error_handler* queue_store::active_handler() {
  const std::lock_guard lock(mutex_);
  return active_handler_;
}

void queue_store::set_active_handler(classic::error_handler* handler) {
  const std::lock_guard lock(mutex_);
  active_handler_ = handler;
}

lumen_arr_error_callback queue_store::saved_callback() {
  const std::lock_guard lock(mutex_);
  return saved_callback_;
}

void queue_store::set_saved_callback(lumen_arr_error_callback callback) {
  const std::lock_guard lock(mutex_);
  saved_callback_ = callback;
}

}  // namespace arbor::lumen::vm::detail
