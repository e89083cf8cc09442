// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstdint>
#include <exception>
#include <memory>
#include <vector>

#include "context_impl.hpp"
#include "device_impl.hpp"
#include "spin_mutex.hpp"
#include "sycl/exception.hpp"
#include "sycl/property.hpp"

namespace sycl::detail {

class command;

/// The unfinished commands of a queue in the order of their submission: what stands under a queue,
/// and under all queues that are made from its native handle.
struct command_stream {
  spin_mutex mutex;
  command* first = nullptr;
  command* last = nullptr;
  std::uint64_t submitted = 0;
  bool in_order = false;

  void append(command& added) noexcept;
  void remove(command& finished) noexcept;
  /// Waits for the commands that are in the stream now.
  void wait();
};

class queue_impl : public std::enable_shared_from_this<queue_impl> {
 public:
  queue_impl(std::shared_ptr<context_impl> ctx, std::shared_ptr<device_impl> dev,
             async_handler handler, const property_list& properties,
             std::shared_ptr<command_stream> stream = nullptr);
  ~queue_impl();

  /// Makes the command part of the stream and starts it when nothing is before it.
  void submit(const std::shared_ptr<command>& submitted);
  void add_error(std::exception_ptr error);
  void report_errors();

  const std::shared_ptr<context_impl> ctx;
  const std::shared_ptr<device_impl> dev;
  const property_list properties;
  const bool profiled;
  const std::shared_ptr<command_stream> stream;

 private:
  const async_handler handler_;
  spin_mutex errors_mutex_;
  std::vector<std::exception_ptr> errors_;
};

}  // namespace sycl::detail
