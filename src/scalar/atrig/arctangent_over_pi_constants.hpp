// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
//
// Written by fit/arctangent_over_pi.py.

#pragma once

#include <cstdint>

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Lowest first: arctan(t)/(pi t) in z = t^2 on [0, 1], within 4.5e-10 relative.
static constexpr std::uint64_t arctangent_over_pi_coefficients[11] = {
    0x3fd45f306da2b82b,  // 0.31830988604167726
    0xbfbb29955375d0de,  // -0.10610326087573038
    0x3fb04c0f24e2b983,  // 0.06366057062652968
    0xbfa7453cee35a037,  // -0.045450119093232315
    0x3fa2028c8c8015ba,  // 0.03517569747058809
    0xbf9ca2818a94ab4f,  // -0.02796366127328592
    0x3f95ca66b83ef41e,  // 0.021279911990621618
    0xbf8ca30a03042e39,  // -0.013982847420741172
    0x3f7c91ee1c2275fe,  // 0.006975107304382442
    0xbf62554860e5fcd4,  // -0.0022379315989265822
    0x3f360fff708fd2af,  // 0.0003366469032351311
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
