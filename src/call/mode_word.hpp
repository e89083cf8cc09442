// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "arbor/lumen/vm/enums.hpp"

/// The bit groups of the mode word and the two rules by which words combine.
namespace arbor::lumen::vm::detail::mode_word {

inline constexpr std::uint32_t accuracy = 0xF;
inline constexpr std::uint32_t status_report = 0x300;
inline constexpr std::uint32_t slice_policy = 0x7000;
inline constexpr std::uint32_t bad_argument_policy = 0x30000;
inline constexpr std::uint32_t fallback_policy = 0xF00000;
inline constexpr std::uint32_t reserved_policy = 0x7000000;

inline constexpr std::uint32_t all_groups = accuracy | status_report | slice_policy |
                                            bad_argument_policy | fallback_policy | reserved_policy;

/// A group of a stored word counts as set if one of these bits is. Values made of the other bits
/// alone, such as `ha` or `slice_normal`, are the defaults, and so need no mark of their own.
inline constexpr std::uint32_t deciding_bits =
    0xB | 0x100 | 0x6000 | 0x20000 | 0x700000 | 0x6000000;

/// The groups in which `word` has a bit.
constexpr std::uint32_t groups_of(std::uint32_t word) {
  // Each group lies in a hexadecimal digit of its own.
  const std::uint32_t nonzero = (word | word >> 1 | word >> 2 | word >> 3) & 0x1111111;
  return nonzero * 0xF & all_groups;
}

/// `base` with each group that `word` names taken from `word`.
constexpr std::uint32_t merge(std::uint32_t base, std::uint32_t word) {
  const std::uint32_t named = groups_of(word & all_groups);
  return (base & ~named) | (word & named);
}

/// The mode in force where `stored` is the word of the queue, 0 if it has none.
constexpr std::uint32_t in_force(std::uint32_t stored) {
  const std::uint32_t named = groups_of(stored & deciding_bits);
  return (enums::default_mode & ~named) | (stored & named);
}

}  // namespace arbor::lumen::vm::detail::mode_word
