// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "host_threads.hpp"

#include <utility>

namespace sycl::detail {

namespace {
thread_local bool on_host_thread = false;
}

bool host_threads::is_current() noexcept { return on_host_thread; }

void host_threads::start(std::shared_ptr<command> task) {
  const std::lock_guard lock(mutex_);
  tasks_.push_back(std::move(task));
  if (idle_ >= tasks_.size()) {
    changed_.notify_one();
  } else {
    threads_.emplace_back([this] { work(); });
  }
}

void host_threads::stop() {
  {
    const std::lock_guard lock(mutex_);
    stopped_ = true;
    changed_.notify_all();
  }
  for (std::thread& thread : threads_) thread.join();
  threads_.clear();
}

void host_threads::work() {
  on_host_thread = true;
  std::unique_lock lock(mutex_);
  for (;;) {
    ++idle_;
    changed_.wait(lock, [this] { return stopped_ || !tasks_.empty(); });
    --idle_;
    if (tasks_.empty()) return;
    std::shared_ptr<command> task = std::move(tasks_.front());
    tasks_.erase(tasks_.begin());
    lock.unlock();
    run_(std::move(task));
    lock.lock();
  }
}

}  // namespace sycl::detail
