// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>

#include "arbor/lumen/vm/enums.hpp"
#include "dispatch/device_word.hpp"
#include "dispatch/key.hpp"
#include "dispatch/table.hpp"

namespace arbor::lumen::vm::detail {

/// Partial keys (precision, device and feature, no accuracy) in the order in which they are tried.
class candidate_list {
 public:
  candidate_list() {}  // slots get their values with a push
  void push_front(std::uint64_t candidate) { slots_[--first_] = candidate; }
  void push_back(std::uint64_t candidate) { slots_[last_++] = candidate; }
  const std::uint64_t* begin() const { return slots_.data() + first_; }
  const std::uint64_t* end() const { return slots_.data() + last_; }
  std::size_t size() const { return last_ - first_; }

 private:
  static constexpr std::size_t middle = 8;
  std::array<std::uint64_t, 16> slots_;
  std::size_t first_ = middle;
  std::size_t last_ = middle;
};

/// The kernel rows that may serve a call of this precision and mode on this device. The rows made
/// for devices without double are in the tables, but no device has them as candidates: such a
/// device is served by the host. A CPU runs device kernels for half and for cyclic slices.
candidate_list kernel_candidates(std::uint64_t precision, std::uint64_t device_word,
                                 std::uint32_t mode);

/// The three parts of a search.
enum class search_pass { ascending, descending, host };

/// Visits the keys of `candidates` from the step `first` of the accuracy ladder to the step `last`,
/// up or down, until `accept(pass, key)` is true. Accuracy is the outer loop: at each accuracy
/// every candidate is tried before the next accuracy is.
/// @returns the accepted key, 0 if there is none
template <typename Accept>
std::uint64_t climb(search_pass pass, int first, int last, const candidate_list& candidates,
                    Accept&& accept) {
  const int direction = first <= last ? 1 : -1;
  for (int step = first; step != last + direction; step += direction) {
    for (const std::uint64_t candidate : candidates) {
      const std::uint64_t key = candidate | key::accuracy_ladder[step].code;
      if (accept(pass, key)) return key;
    }
  }
  return 0;
}

/// Visits the keys that may serve a call, best first, until `accept(pass, key)` is true. First come
/// the kernel rows of the accuracy asked for and of finer ones; then, on a GPU under
/// `mode_relaxed_fallback`, those of every accuracy from the finest down; then, if the mode admits
/// the host, the rows of the accuracy asked for and of finer ones again, each led by the host row.
/// @returns the accepted key, 0 if there is none
template <typename Accept>
std::uint64_t search(std::uint64_t precision, std::uint64_t device_word, std::uint32_t mode,
                     Accept&& accept) {
  constexpr int finest = key::accuracy_steps - 1;
  const int start = key::ladder_start(mode);
  candidate_list candidates = kernel_candidates(precision, device_word, mode);
  if (const std::uint64_t key = climb(search_pass::ascending, start, finest, candidates, accept))
    return key;

  const bool relaxed = (mode & enums::mode_relaxed_fallback) != 0;
  if (relaxed && (device_word & device_word::gpu) != 0) {
    if (const std::uint64_t key = climb(search_pass::descending, finest, 0, candidates, accept))
      return key;
  }
  if (!relaxed && (mode & enums::mode_host_fallback) == 0) return 0;
  candidates.push_front(precision | key::cpu | key::classic);
  return climb(search_pass::host, start, finest, candidates, accept);
}

/// A row with its key; 0 and null if there is none.
struct keyed_row {
  std::uint64_t key;
  const implementation_table::entry* entry;
};

/// The row that serves a call: the first of the search that `table` holds.
keyed_row select_row(std::uint64_t precision, std::uint64_t device_word, std::uint32_t mode,
                     const implementation_table& table);

/// The key of that row.
std::uint64_t select_key(std::uint64_t precision, std::uint64_t device_word, std::uint32_t mode,
                         const implementation_table& table);

}  // namespace arbor::lumen::vm::detail
