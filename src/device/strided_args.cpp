// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "device/strided_args.hpp"

#include <algorithm>
#include <stdexcept>

#include "arbor/lumen/exception.hpp"
#include "call/mode_word.hpp"

namespace arbor::lumen::vm::detail::device {
namespace {

/// The index of the last of `size` elements of a slice, modulo 2^64: a slice may end beyond what
/// memory can hold.
std::uint64_t last_index(const slice& s, std::int64_t size) {
  return static_cast<std::uint64_t>(s.start) +
         (static_cast<std::uint64_t>(size) - 1) * static_cast<std::uint64_t>(s.stride);
}

bool is_empty(const slice& s) {
  return s.size == 0 || static_cast<std::int64_t>(last_index(s, s.size)) < 0;
}

/// One more than the highest index that `count` work items use. Never negative, so that a call
/// that computes nothing stages nothing.
std::int64_t extent(const slice& s, std::int64_t count) {
  if (is_empty(s)) return 1;
  const std::int64_t size = s.stride > 0 ? std::min(count, s.size) : 1;
  return std::max<std::int64_t>(static_cast<std::int64_t>(last_index(s, size) + 1), 0);
}

template <int NI, int NO>
strided_args<NI, NO> unit_strides(std::int64_t count) {
  strided_args<NI, NO> args;
  for (int k = 0; k < NI; ++k) {
    args.divisor[k] = args.in_stride[k] = 1;
    args.in_size[k] = args.in_extent[k] = count;
  }
  for (int j = 0; j < NO; ++j) {
    args.out_stride[j] = 1;
    args.out_extent[j] = count;
  }
  args.count = count;
  return args;
}

bool is_quiet(const input::vxx& record) { return (record.mode & enums::badarg_quiet) != 0; }

/// The count of a call without slices.
std::int64_t whole_count(const input::vxx& record) {
  const std::int64_t count = record.effective_count();
  if (count < 0 && !is_quiet(record))
    throw invalid_argument("VM", record.name, "negative number of computations");
  return std::max<std::int64_t>(count, 0);
}

/// The count on which all slices agree, or their minimum where the policy allows it.
std::int64_t common_count(const input::vxx& record) {
  const std::int64_t size = record.out_slices.front().size;
  std::int64_t count = size;
  bool differ = false;
  for (const auto* slices : {&record.in_slices, &record.out_slices}) {
    for (const slice& s : *slices) {
      count = is_empty(s) ? 0 : std::min(count, s.size);
      differ = differ || s.size != size;
    }
  }
  const bool quiet = is_quiet(record);
  if (count == 0 && !quiet) throw invalid_argument("VM", record.name, "slice(s) is/are empty");
  if (differ && (record.mode & mode_word::slice_policy) == enums::slice_normal) {
    if (!quiet)
      throw invalid_argument("VM", record.name, "different slice sizes in slice_normal mode");
    return 0;
  }
  return count;
}

}  // namespace

template <int NI, int NO>
strided_args<NI, NO> describe(const input::vxx& record) {
  if (!record.has_slices()) return unit_strides<NI, NO>(whole_count(record));
  if (record.in_slices.size() != NI || record.out_slices.size() != NO)
    throw std::logic_error(std::string("ArborLumen::VM::").append(record.name) +
                           ": slice number different from template");

  strided_args<NI, NO> args;
  args.count = common_count(record);
  std::fill_n(args.divisor, NI, 1);
  if ((record.mode & mode_word::slice_policy) == enums::slice_cyclic && args.count >= 1) {
    args.cyclic = true;
    args.count = record.out_slices.front().size;
    std::int64_t combinations = 1;
    for (int k = NI - 1; k >= 0; --k) {
      const std::int64_t size = record.in_slices[static_cast<std::size_t>(k)].size;
      args.divisor[k] = combinations;
      std::int64_t product;
      if (size == 0 || __builtin_mul_overflow(combinations, size, &product) ||
          product < combinations)
        throw std::runtime_error("overflow on divisor calculation");
      combinations = product;
    }
  }
  for (int k = 0; k < NI; ++k) {
    const slice& s = record.in_slices[static_cast<std::size_t>(k)];
    args.in_start[k] = s.start;
    args.in_size[k] = s.size;
    args.in_stride[k] = s.stride;
    args.in_extent[k] = extent(s, args.count);
  }
  for (int j = 0; j < NO; ++j) {
    const slice& s = record.out_slices[static_cast<std::size_t>(j)];
    args.out_start[j] = s.start;
    args.out_stride[j] = s.stride;
    args.out_extent[j] = extent(s, args.count);
  }
  return args;
}

template strided_args<0, 1> describe(const input::vxx&);
template strided_args<0, 2> describe(const input::vxx&);
template strided_args<1, 1> describe(const input::vxx&);
template strided_args<1, 2> describe(const input::vxx&);
template strided_args<2, 1> describe(const input::vxx&);
template strided_args<3, 1> describe(const input::vxx&);

}  // namespace arbor::lumen::vm::detail::device
