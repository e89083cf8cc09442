// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// What remains of an infinity when its integer part is taken out, by the sign of the infinity. At
/// float it is a zero of that sign. At double it is +0 for both signs: only the first two words are
/// ever read.
static constexpr std::uint32_t _zeros_32[2] = {0x00000000, 0x80000000};
static constexpr std::uint64_t _zeros_64[4] = {0x0000000000000000, 0x0000000000000000,
                                               0x0000000000000000, 0x0000000080000000};

LUMEN_DEVICE inline float zero_of_infinity(float x) { return value(_zeros_32[bits(x) >> 31]); }
LUMEN_DEVICE inline double zero_of_infinity(double x) { return value(_zeros_64[bits(x) >> 63]); }

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
