// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <condition_variable>
#include <functional>
#include <mutex>
#include <thread>
#include <vector>

#include "command.hpp"

namespace sycl::detail {

/// Threads for host tasks: as many as there are tasks that run at one time, kept for later ones.
class host_threads {
 public:
  using runner = void (*)(std::shared_ptr<command>);

  explicit host_threads(runner run) noexcept : run_(run) {}

  void start(std::shared_ptr<command> task);
  /// Ends the threads; there must be no tasks.
  void stop();
  /// Whether the calling thread is one of these.
  static bool is_current() noexcept;

 private:
  void work();

  const runner run_;
  std::mutex mutex_;
  std::condition_variable changed_;
  std::vector<std::shared_ptr<command>> tasks_;
  std::vector<std::thread> threads_;
  std::size_t idle_ = 0;
  bool stopped_ = false;
};

}  // namespace sycl::detail
