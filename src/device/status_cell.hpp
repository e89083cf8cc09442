// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <sycl/sycl.hpp>

namespace arbor::lumen::vm::detail::device {

/// A word in device memory into which the kernel of one call under `global_status_report` ors the
/// status of its elements. Without that mode there is no cell and nothing waits.
class status_cell {
 public:
  /// Allocates and clears the word if `wanted`.
  status_cell(sycl::queue& queue, bool wanted);
  status_cell(const status_cell&) = delete;
  status_cell& operator=(const status_cell&) = delete;
  ~status_cell();

  /// The word, null if there is none.
  std::uint32_t* get() const { return word_; }

  /// Waits for the kernel, throws what it raised, ors the word into the queue's status and frees
  /// the word.
  void collect(sycl::event& kernel);

 private:
  sycl::queue& queue_;
  std::uint32_t* word_ = nullptr;
};

}  // namespace arbor::lumen::vm::detail::device
