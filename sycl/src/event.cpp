// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "sycl/event.hpp"

#include <utility>

#include "command.hpp"
#include "scheduler.hpp"
#include "sycl/exception.hpp"

namespace sycl {

namespace {

/// Waits until a profiled command has got to the state.
const detail::command& reached(const std::shared_ptr<detail::command>& impl,
                               detail::command_state state) {
  if (!impl->profiled) {
    throw exception(errc::invalid,
                    "the event's queue was not made with property::queue::enable_profiling");
  }
  impl->await(state);
  return *impl;
}

void report(const detail::command& finished) {
  if (const std::shared_ptr<detail::queue_impl> queue = finished.reporter.lock()) {
    queue->report_errors();
  }
}

}  // namespace

event::event() : impl_(std::make_shared<detail::command>()) {
  impl_->close();
  impl_->state.store(detail::command_state::complete, std::memory_order_relaxed);
}

backend event::get_backend() const noexcept { return impl_->from; }

std::vector<event> event::get_wait_list() { return impl_->wait_list(); }

void event::wait() {
  if (!impl_->complete()) detail::scheduler::instance().wait(*impl_);
}

void event::wait(const std::vector<event>& events) {
  for (event each : events) each.wait();
}

void event::wait_and_throw() {
  wait();
  report(*impl_);
}

void event::wait_and_throw(const std::vector<event>& events) {
  wait(events);
  for (const event& each : events) report(*each.impl_);
}

template <>
ARBOR_LUMEN_SYCL_API info::event_command_status
event::get_info<info::event::command_execution_status>() const {
  switch (impl_->state.load(std::memory_order_acquire)) {
    case detail::command_state::submitted:
      return info::event_command_status::submitted;
    case detail::command_state::running:
      return info::event_command_status::running;
    case detail::command_state::complete:
      break;
  }
  return info::event_command_status::complete;
}

template <>
ARBOR_LUMEN_SYCL_API std::uint64_t
event::get_profiling_info<info::event_profiling::command_submit>() const {
  return reached(impl_, detail::command_state::submitted).submit_time;
}
template <>
ARBOR_LUMEN_SYCL_API std::uint64_t event::get_profiling_info<info::event_profiling::command_start>()
    const {
  return reached(impl_, detail::command_state::running).start_time;
}
template <>
ARBOR_LUMEN_SYCL_API std::uint64_t event::get_profiling_info<info::event_profiling::command_end>()
    const {
  return reached(impl_, detail::command_state::complete).end_time;
}

}  // namespace sycl
