// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <atomic>
#include <thread>

namespace sycl::detail {

/// Tells the processor that the thread is polling.
inline void pause() noexcept {
#if defined(__x86_64__) || defined(__i386__)
  __builtin_ia32_pause();
#elif defined(__aarch64__)
  asm volatile("yield");
#endif
}

/// For critical sections of a few dozen instructions.
class spin_mutex {
 public:
  void lock() noexcept {
    for (int attempt = 0; locked_.exchange(true, std::memory_order_acquire);) {
      while (locked_.load(std::memory_order_relaxed)) {
        // The owner may have lost its processor.
        if (++attempt % 64 == 0) {
          std::this_thread::yield();
        } else {
          pause();
        }
      }
    }
  }
  void unlock() noexcept { locked_.store(false, std::memory_order_release); }

 private:
  std::atomic<bool> locked_{false};
};

}  // namespace sycl::detail
