// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <initializer_list>
#include <sycl/sycl.hpp>
#include <vector>

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

  /// Of rows with the same key the first counts. No row has key 0.
  implementation_table(std::initializer_list<row> rows);

  struct entry {
    launcher run;
    const char* implementation;
  };
  /// The entry of a key, null if there is none.
  const entry* find(std::uint64_t key) const {
    const slot& found = slots_[place_of(key)];
    return found.key == 0 ? nullptr : &found.value;
  }

  std::size_t size() const { return size_; }

  /// Calls `visit(key, entry)` for every row, in no particular order.
  template <typename Visit>
  void for_each(Visit visit) const {
    for (const slot& each : slots_) {
      if (each.key != 0) visit(each.key, each.value);
    }
  }

 private:
  struct slot {
    std::uint64_t key = 0;  ///< 0: empty
    entry value{};
  };

  /// Where the key stands, or the empty place at which the search for it ends.
  std::size_t place_of(std::uint64_t key) const {
    std::size_t place = key % 997 & mask_;
    while (slots_[place].key != key && slots_[place].key != 0) place = (place + 1) & mask_;
    return place;
  }

  std::vector<slot> slots_;  ///< a power of two of them, at most half of them taken
  std::size_t mask_;         ///< their number less one
  std::size_t size_ = 0;
};

}  // namespace arbor::lumen::vm::detail
