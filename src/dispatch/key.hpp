// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

/// The dispatch key: by which launchers are found. One code from each of four fields.
namespace arbor::lumen::vm::detail::key {

inline constexpr std::uint64_t accuracy_field = 0x7;
inline constexpr std::uint64_t ep = 0x1;
inline constexpr std::uint64_t la = 0x2;
inline constexpr std::uint64_t ha = 0x4;

inline constexpr std::uint64_t device_field = 0xF0;
inline constexpr std::uint64_t cpu = 0x10;
inline constexpr std::uint64_t gpu = 0x20;

inline constexpr std::uint64_t feature_field = 0xFF00;
inline constexpr std::uint64_t gen = 0x100;
inline constexpr std::uint64_t nofp64 = 0x200;
inline constexpr std::uint64_t nolut = 0x400;
inline constexpr std::uint64_t fp64only = 0x800;
inline constexpr std::uint64_t fp32cast = 0x1000;  ///< ored onto one of the four above
inline constexpr std::uint64_t classic = 0x8000;

inline constexpr std::uint64_t precision_field = 0xFF00000000;
inline constexpr std::uint64_t half = 0x100000000;

/// The accuracies from the roughest to the finest: the nibble of the mode word, the code of the
/// key.
struct accuracy_step {
  std::uint32_t mode;
  std::uint64_t code;
};
inline constexpr int accuracy_steps = 3;
inline constexpr accuracy_step accuracy_ladder[accuracy_steps] = {{15, ep}, {12, la}, {4, ha}};

/// Where a mode word starts on the ladder; a word without a known accuracy asks for `ha`.
constexpr int ladder_start(std::uint32_t mode) {
  switch (mode & 0xF) {
    case 15:
      return 0;
    case 12:
      return 1;
    default:
      return 2;
  }
}

}  // namespace arbor::lumen::vm::detail::key
