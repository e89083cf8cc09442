// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <sycl/sycl.hpp>

#include "call/queue_key.hpp"

/// What a queue's device is, as dispatch sees it: a word of bits.
namespace arbor::lumen::vm::detail::device_word {

inline constexpr std::uint64_t garnet = 0x2;
inline constexpr std::uint64_t topaz = 0x4;
inline constexpr std::uint64_t onyx = 0x8;
inline constexpr std::uint64_t jasper = 0x10;
inline constexpr std::uint64_t beryl = 0x20;
inline constexpr std::uint64_t discrete = 0x100000000;
inline constexpr std::uint64_t integrated = 0x200000000;
inline constexpr std::uint64_t nofp64 = 0x400000000;
inline constexpr std::uint64_t fp64 = 0x800000000;
inline constexpr std::uint64_t cpu = 0x1000000000000;
inline constexpr std::uint64_t gpu = 0x2000000000000;
inline constexpr std::uint64_t accelerator = 0x4000000000000;
inline constexpr std::uint64_t norvane = 0x8000000000000000;

/// The vendor whose devices carry the `norvane` bit.
inline constexpr std::uint32_t norvane_vendor = 0x51A7;

/// The word of a device. An unknown GPU, of whatever vendor, counts as discrete and of the highest
/// tier, `beryl`.
std::uint64_t classify(const sycl::device& device);

/// The word of a queue's device, noted in the store. The queue must not be null.
std::uint64_t of_queue(const keyed_queue& queue);

}  // namespace arbor::lumen::vm::detail::device_word
