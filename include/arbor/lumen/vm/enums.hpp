// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

namespace arbor::lumen::vm::enums {

/// What a caller asks of a call, or of all calls on a queue: a word of six independent bit groups.
/// Combine at most one value from each group with `|`. A group left at zero takes the value in
/// force for the queue.
enum mode : std::uint32_t {
  not_defined = 0x0,  ///< every group comes from the queue

  ha = 0x4,  ///< high accuracy (the default)
  la = 0xC,  ///< low accuracy
  ep = 0xF,  ///< enhanced performance

  global_status_report = 0x100,     ///< every call also accumulates status into the queue's word
  no_global_status_report = 0x200,  ///< no accumulation (the default)

  slice_normal = 0x1000,   ///< all slices of a call must have one size (the default)
  slice_minimum = 0x2000,  ///< the smallest slice size is the count
  slice_cyclic = 0x4000,   ///< inputs are indexed cyclically; the output slice gives the count

  badarg_exception = 0x10000,  ///< a bad argument throws (the default)
  badarg_quiet = 0x20000,      ///< a bad argument raises `bad_argument`; the call does nothing

  mode_host_fallback = 0x100000,     ///< the host may serve what the device cannot
  mode_missing_throws = 0x400000,    ///< a call that nothing serves throws `unimplemented`
  mode_relaxed_fallback = 0x800000,  ///< as `mode_host_fallback`, and a GPU may first use a lower
                                     ///< accuracy (the default)

  default_mode = 0x1811204  ///< the mode of a fresh queue: all the defaults
};

/// What happened to elements of a call; bits that may be set at once.
enum status : std::uint32_t {
  success = 0,             ///< nothing happened
  errdom = 1,              ///< an argument outside the function's domain
  sing = 2,                ///< a pole
  overflow = 4,            ///< a result too large for its type
  underflow = 8,           ///< a result too small for its type
  accuracy_warning = 128,  ///< a host kernel could not keep its accuracy
  bad_argument = 256       ///< a call rejected quietly, or one that nothing serves
};

constexpr mode operator|(mode a, mode b) {
  return static_cast<mode>(static_cast<std::uint32_t>(a) | static_cast<std::uint32_t>(b));
}
constexpr mode operator&(mode a, mode b) {
  return static_cast<mode>(static_cast<std::uint32_t>(a) & static_cast<std::uint32_t>(b));
}
constexpr mode operator~(mode a) { return static_cast<mode>(~static_cast<std::uint32_t>(a)); }
constexpr mode& operator|=(mode& a, mode b) { return a = a | b; }
constexpr mode& operator&=(mode& a, mode b) { return a = a & b; }

constexpr status operator|(status a, status b) {
  return static_cast<status>(static_cast<std::uint32_t>(a) | static_cast<std::uint32_t>(b));
}
constexpr status operator&(status a, status b) {
  return static_cast<status>(static_cast<std::uint32_t>(a) & static_cast<std::uint32_t>(b));
}
constexpr status operator~(status a) { return static_cast<status>(~static_cast<std::uint32_t>(a)); }
constexpr status& operator|=(status& a, status b) { return a = a | b; }
constexpr status& operator&=(status& a, status b) { return a = a & b; }

}  // namespace arbor::lumen::vm::enums
