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

inline constexpr std::uint32_t groups[] = {
    accuracy, status_report, slice_policy, bad_argument_policy, fallback_policy, reserved_policy};

/// A group of a stored word counts as set if one of these bits is. Values made of the other bits
/// alone, such as `ha` or `slice_normal`, are the defaults, and so need no mark of their own.
inline constexpr std::uint32_t deciding_bits[] = {0xB, 0x100, 0x6000, 0x20000, 0x700000, 0x6000000};

/// `base` with each group that `word` names taken from `word`.
constexpr std::uint32_t merge(std::uint32_t base, std::uint32_t word) {
  std::uint32_t named = 0;
  for (const std::uint32_t group : groups) named |= (word & group) != 0 ? group : 0;
  return (base & ~named) | (word & named);
}

/// The mode in force where `stored` is the word of the queue, 0 if it has none.
constexpr std::uint32_t in_force(std::uint32_t stored) {
  std::uint32_t named = 0;
  for (int i = 0; i < 6; ++i) named |= (stored & deciding_bits[i]) != 0 ? groups[i] : 0;
  return (enums::default_mode & ~named) | (stored & named);
}

}  // namespace arbor::lumen::vm::detail::mode_word
