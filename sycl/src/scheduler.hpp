// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <thread>
#include <vector>

#include "command.hpp"
#include "host_threads.hpp"
#include "spin_mutex.hpp"

namespace sycl::detail {

/// Runs commands that have nothing left to wait for.
///
/// Ready kernels stand in one list, first come, first served. A thread that takes a kernel runs
/// growing pieces of it and times them; when what remains is worth the help of others, the kernel
/// goes back to the head of the list as a shared one, and all threads that come by take pieces of
/// it. A thread without work polls the list for some microseconds, one thread at a time, and then
/// sleeps. Host tasks have threads of their own, so that kernels progress while they block.
class scheduler {
 public:
  /// Starts the threads the first time. errc::runtime if LUMEN_SYCL_THREADS is no number.
  static scheduler& instance();

  /// Runs the command as soon as a thread has time; it must have nothing to wait for.
  void start(command& ready);
  /// Returns when the command is complete. The calling thread runs it, or part of it, if it is a
  /// kernel that no thread has got to.
  void wait(command& awaited);
  /// Completes a command: releases what it holds and starts what waits for it.
  void finish(std::shared_ptr<command> done);

  unsigned threads() const noexcept { return threads_; }

 private:
  explicit scheduler(unsigned threads);
  ~scheduler() = default;

  static void at_exit();

  void work();
  std::shared_ptr<command> take();
  bool poll() const noexcept;
  void run(std::shared_ptr<command> taken, bool go_on);
  bool run_alone(command& taken);
  bool run_pieces(command& taken);
  void run_items(command& taken, std::size_t begin, std::size_t end) noexcept;
  void share(command& taken, std::size_t done, std::uint64_t estimate);
  std::shared_ptr<command> finish(std::shared_ptr<command> done, bool go_on);
  bool help(command& awaited);
  void run_host_task(std::shared_ptr<command> task);
  void run_inline();

  void push_back(command& ready) noexcept;
  void unlink(command& listed) noexcept;
  /// Accounts for `count` sleepers as woken; the caller then posts as many permits.
  unsigned claim_sleepers(unsigned count) noexcept;
  void post(unsigned permits) noexcept;
  void drain_and_stop();

  const unsigned threads_;
  /// Polling on the only processor would keep others from the work.
  const bool polls_;
  host_threads host_threads_;
  std::vector<std::thread> workers_;

  alignas(64) spin_mutex mutex_;
  command* first_ = nullptr;
  command* last_ = nullptr;
  unsigned sleepers_ = 0;
  bool polling_ = false;
  bool stopped_ = false;
  alignas(64) std::atomic<bool> available_{false};
  std::atomic<std::uint32_t> permits_{0};
  /// Commands started and not finished.
  std::atomic<std::uint64_t> in_flight_{0};
};

}  // namespace sycl::detail
