// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <atomic>

#include <sycl/sycl.hpp>

/// Holds a host task, and all that depends on it, until it is opened. Opens at the latest when it
/// goes out of scope, so that a failing test ends.
class gate {
 public:
  gate() = default;
  gate(const gate&) = delete;
  gate& operator=(const gate&) = delete;
  ~gate() {
    open();
    passed_.wait();
  }

  /// Submits the task that waits at the gate.
  sycl::event close(sycl::queue& q) {
    passed_ = q.submit([&](sycl::handler& cgh) { cgh.host_task([this] { hold(); }); });
    return passed_;
  }
  /// Waits in a host task until the gate is open; passes() tells which task that is.
  void hold() const { open_.wait(false); }
  void passes(const sycl::event& e) { passed_ = e; }
  void open() {
    open_ = true;
    open_.notify_all();
  }

 private:
  std::atomic<bool> open_{false};
  sycl::event passed_;
};

inline bool is_complete(const sycl::event& e) {
  return e.get_info<sycl::info::event::command_execution_status>() ==
         sycl::info::event_command_status::complete;
}
