// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
//
// Written by fit/half_sine.py.

#pragma once

#include <cstdint>

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Lowest first: (sin r - r)/r^3 in r^2 for |r| <= 1.575; of the sine within 1.4e-6 relative.
static constexpr std::uint32_t half_sine_cubic[3] = {
    0xbe2aa8bb,  // -0.166659281
    0x3c083c69,  // 0.00831518415
    0xb942b0dc,  // -0.00018567167
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
