// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <initializer_list>
#include <sycl/sycl.hpp>
#include <unordered_map>

#include "call/input.hpp"
#include "device/tuning_info.hpp"

namespace arbor::lumen::vm::detail {

/// Runs a call on one implementation.
using launcher = std::function<sycl::event(const input::vxx&, TuningInfo)>;

/// The implementations of one family by their keys, immutable once built.
class implementation_table {
 public:
  struct row {
    std::uint64_t key;
    sycl::event (*run)(const input::vxx&, TuningInfo);
    const char* implementation;  ///< name of the functor or of the host kernel behind the row
  };

  implementation_table(std::initializer_list<row> rows);

  struct entry {
    launcher run;
    const char* implementation;
  };
  /// The entry of a key, null if there is none.
  const entry* find(std::uint64_t key) const;

  std::size_t size() const { return entries_.size(); }

  /// Calls `visit(key, entry)` for every row, in no particular order.
  template <typename Visit>
  void for_each(Visit visit) const {
    for (const auto& [key, value] : entries_) visit(key, value);
  }

 private:
  struct hash {
    std::size_t operator()(std::uint64_t key) const { return key % 997; }
  };
  std::unordered_map<std::uint64_t, entry, hash> entries_;
};

}  // namespace arbor::lumen::vm::detail
