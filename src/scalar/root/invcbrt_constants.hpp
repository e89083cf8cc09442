// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
//
// Written by fit/invcbrt.py.

#pragma once

#include <cstdint>

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Highest first: (1 + f)^(-1/3) - 1 for |f| <= 1/3, relative to (1 + f)^(-1/3) within
/// 3.0e-8.
static constexpr std::uint32_t invcbrt_la_polynomial_s[9] = {
    0x3dec126e,  // 0.115269527
    0xbe00415a,  // -0.125249296
    0x3ddf159d,  // 0.108927943
    0xbdfb3416,  // -0.12265794
    0x3e138e22,  // 0.144096881
    0xbe310ec2,  // -0.172907859
    0x3e638e15,  // 0.222221687
    0xbeaaaa97,  // -0.333332747
    0x80000000,  // -0
};

/// Highest first: ((1 + g)^(-1/3) - 1)/g for |g| <= 1/65; times g within 2.9e-19.
static constexpr std::uint64_t invcbrt_ha_polynomial_d[8] = {
    0x3fb7916f918ce97d,  // 0.09206292441823467
    0xbfb9b5e1c3d7772a,  // -0.10043154746332719
    0x3fbc67c9e7ae9ff4,  // 0.11095868974973638
    0xbfbff4c325eca21d,  // -0.12482852626693171
    0x3fc26fabb85cda51,  // 0.1440329218109633
    0xbfc61f9add3c3469,  // -0.17283950617312208
    0x3fcc71c71c71c71c,  // 0.2222222222222222
    0xbfd5555555555555,  // -0.3333333333333333
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
