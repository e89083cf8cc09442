// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <atomic>
#include <chrono>
#include <future>
#include <sycl/sycl.hpp>
#include <utility>

namespace arbor::lumen::tests {

/// A command that does not complete before the test opens it.
class gate {
 public:
  explicit gate(sycl::queue& queue)
      : event_(queue.submit([this](sycl::handler& group) {
          group.host_task([opened = opened_] { opened.wait(); });
        })) {}
  gate(const gate&) = delete;
  gate& operator=(const gate&) = delete;
  ~gate() {
    open();
    event_.wait();
  }

  void open() {
    if (!open_.exchange(true)) promise_.set_value();
  }
  const sycl::event& event() const { return event_; }

 private:
  std::atomic<bool> open_ = false;
  std::promise<void> promise_;
  std::shared_future<void> opened_ = promise_.get_future().share();
  sycl::event event_;
};

/// A call on a thread of its own, so that a test can tell whether it blocks.
template <typename Result>
class background {
 public:
  template <typename Call>
  explicit background(Call call) : result_(std::async(std::launch::async, std::move(call))) {}

  /// Whether the call is still under way after a while in which a call that does not block would
  /// have returned on any machine that is not stuck.
  bool blocks() const {
    return result_.wait_for(std::chrono::milliseconds(50)) == std::future_status::timeout;
  }
  /// Whether the call returns by itself. Waits far longer than any machine takes.
  bool returns() const {
    return result_.wait_for(std::chrono::seconds(30)) == std::future_status::ready;
  }
  Result get() { return result_.get(); }

 private:
  std::future<Result> result_;
};
template <typename Call>
background(Call) -> background<std::invoke_result_t<Call>>;

inline bool is_complete(const sycl::event& event) {
  return event.get_info<sycl::info::event::command_execution_status>() ==
         sycl::info::event_command_status::complete;
}

}  // namespace arbor::lumen::tests
