// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <memory>
#include <utility>
#include <vector>

#include "backend.hpp"
#include "detail/export.hpp"
#include "detail/handle.hpp"
#include "info.hpp"

namespace sycl {

/// The state of a command.
class ARBOR_LUMEN_SYCL_API event {
 public:
  /// An event that is complete, as that of a command without work.
  event();

  backend get_backend() const noexcept;
  /// The commands this one still waits for; those it depended on and that have finished are gone.
  std::vector<event> get_wait_list();

  void wait();
  static void wait(const std::vector<event>& events);
  void wait_and_throw();
  static void wait_and_throw(const std::vector<event>& events);

  template <typename Param>
  typename Param::return_type get_info() const;
  /// errc::invalid unless the queue has property::queue::enable_profiling. Start and end times
  /// exist, and are waited for, as the command gets there.
  template <typename Param>
  typename Param::return_type get_profiling_info() const;

  friend bool operator==(const event& a, const event& b) noexcept { return a.impl_ == b.impl_; }

 private:
  friend struct detail::handle_access;
  explicit event(std::shared_ptr<detail::command> impl) noexcept : impl_(std::move(impl)) {}

  std::shared_ptr<detail::command> impl_;
};

}  // namespace sycl

template <>
struct std::hash<sycl::event> : sycl::detail::handle_hash<sycl::event> {};
