// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "queue_impl.hpp"

#include <mutex>
#include <utility>

#include "command.hpp"
#include "error_handler.hpp"
#include "native_objects.hpp"
#include "scheduler.hpp"

namespace sycl::detail {

void command_stream::append(command& added) noexcept {
  added.number = ++submitted;
  added.previous_in_stream = last;
  (last == nullptr ? first : last->next_in_stream) = &added;
  last = &added;
}

void command_stream::remove(command& finished) noexcept {
  const std::lock_guard lock(mutex);
  command* const before = finished.previous_in_stream;
  command* const after = finished.next_in_stream;
  (before == nullptr ? first : before->next_in_stream) = after;
  (after == nullptr ? last : after->previous_in_stream) = before;
}

void command_stream::wait() {
  std::uint64_t newest = 0;
  for (bool begun = false;; begun = true) {
    std::shared_ptr<command> unfinished;
    {
      const std::lock_guard lock(mutex);
      if (!begun) newest = submitted;
      if (in_order && !begun) {
        if (last != nullptr && !last->complete()) unfinished = last->shared_from_this();
      } else {
        command* candidate = first;
        while (candidate != nullptr && candidate->complete()) {
          candidate = candidate->next_in_stream;
        }
        if (candidate != nullptr && candidate->number <= newest) {
          unfinished = candidate->shared_from_this();
        }
      }
    }
    if (unfinished == nullptr) return;
    scheduler::instance().wait(*unfinished);
  }
}

queue_impl::queue_impl(std::shared_ptr<context_impl> context, std::shared_ptr<device_impl> device,
                       async_handler handler, const property_list& queue_properties,
                       std::shared_ptr<command_stream> native)
    : ctx(std::move(context)),
      dev(std::move(device)),
      properties(queue_properties),
      profiled(properties.has_property<property::queue::enable_profiling>()),
      stream(native != nullptr ? std::move(native) : std::make_shared<command_stream>()),
      handler_(std::move(handler)) {
  if (properties.has_property<property::queue::in_order>()) stream->in_order = true;
}

queue_impl::~queue_impl() {
  native_objects::forget(this);
  report_errors();
}

void queue_impl::submit(const std::shared_ptr<command>& submitted) {
  scheduler& runner = scheduler::instance();  // if it cannot be had, nothing is submitted
  command& c = *submitted;
  c.queue = shared_from_this();
  c.self = submitted;
  if (profiled) {
    c.profiled = true;
    c.submit_time = now();
  }
  {
    // The order in the stream and the order at the buffers must agree.
    const std::lock_guard lock(stream->mutex);
    if (stream->in_order && stream->last != nullptr) {
      c.add_dependency(stream->last->shared_from_this());
    }
    c.register_accesses();
    stream->append(c);
  }
  c.link();
  if (c.release_one()) runner.start(c);
}

void queue_impl::add_error(std::exception_ptr error) {
  const std::lock_guard lock(errors_mutex_);
  errors_.push_back(std::move(error));
}

void queue_impl::report_errors() {
  std::vector<std::exception_ptr> errors;
  {
    const std::lock_guard lock(errors_mutex_);
    errors.swap(errors_);
  }
  if (errors.empty()) return;
  const async_handler& chosen = handler_ ? handler_ : ctx->handler;
  if (chosen) {
    chosen(exception_list(std::move(errors)));
  } else {
    default_error_handler(errors);
  }
}

}  // namespace sycl::detail
