// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <chrono>
#include <cstdint>

namespace arbor::lumen::vm::tool {

/// A line on standard error that counts rows, from the second second on, if standard error is a
/// terminal.
class progress {
 public:
  progress();
  ~progress() { clear(); }
  progress(const progress&) = delete;
  progress& operator=(const progress&) = delete;

  /// Cheap enough to be called for every row.
  void count_row() {
    if (terminal_ && ++rows_ % rows_per_look == 0) look();
  }

  /// Takes the line away, so that something else can be printed.
  void clear();

 private:
  using clock = std::chrono::steady_clock;
  static constexpr std::int64_t rows_per_look = 1024;
  void look();

  bool terminal_;
  bool shown_ = false;
  std::int64_t rows_ = 0;
  clock::time_point next_;
};

}  // namespace arbor::lumen::vm::tool
