// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "call/queue_store.hpp"

#include <cstdlib>

#include "call/mode_word.hpp"

namespace arbor::lumen::vm::detail {
queue_store& queue_store::instance() {
  static queue_store store;
  store.read_verbosity();
  return store;
}

// A level of 0 doubles as the mark that nothing was read, so it alone is read again.
void queue_store::read_verbosity() {
  if (verbosity_.load(std::memory_order_relaxed) != 0) return;
  const char* text = std::getenv("ARBORLUMEN_VM_VERBOSE");
  const bool digit = text != nullptr && *text >= '0' && *text <= '9';
  verbosity_.store(digit ? *text - '0' : -1, std::memory_order_relaxed);
}

sycl::event queue_store::default_event() {
  static const sycl::event shared;
  return shared;
}

std::uint32_t queue_store::stored_mode(std::uint64_t key) {
  const std::lock_guard lock(mutex_);
  const auto entry = modes_.find(key);
  return entry == modes_.end() ? 0 : entry->second;
}

std::uint32_t queue_store::merge_mode(std::uint64_t key, std::uint32_t mode) {
  const std::lock_guard lock(mutex_);
  const auto entry = modes_.find(key);
  if (entry == modes_.end()) {
    modes_.emplace(key, mode_word::merge(enums::default_mode, mode));
    return 0;
  }
  const std::uint32_t before = entry->second;
  entry->second = mode_word::merge(before, mode);
  return before;
}

std::atomic<std::uint32_t>& queue_store::status_word(std::uint64_t key) {
  const std::lock_guard lock(mutex_);
  return statuses_.try_emplace(key, 0u).first->second;
}

void queue_store::record_device_word(std::uint64_t key, std::uint64_t device_word) {
  const std::lock_guard lock(mutex_);
  if (last_device_word_ == nullptr || last_device_word_->first != key)
    last_device_word_ = &*device_words_.try_emplace(key).first;
  last_device_word_->second = device_word;
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
