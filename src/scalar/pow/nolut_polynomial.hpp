// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
//
// Written by fit/pow_nolut.py.

#pragma once

#include <cstdint>

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// p, from the highest coefficient down, in ln(1 + t) = t - t^2/2 + (t^3/2)·(2/3 + p(t)) for
/// |t| <= 1/9, 2/3 as a double; the error of ln(1 + t) is below 1.4e-21 of t.
static constexpr std::uint64_t nolut_power_polynomial[16] = {
    0xbfbe5076359402e1,  // -0.11841524894772305
    0x3fbfdc3e56eadf2e,  // 0.12445439931877608
    0xbfbff1e76b514ebf,  // -0.12478491182383332
    0x3fc10b56b95c010d,  // 0.133158531672969
    0xbfc249407ccc2536,  // -0.14286047071099411
    0x3fc3b14ec3e1d67f,  // 0.1538485008674577
    0xbfc555551737e2e8,  // -0.1666666377421031
    0x3fc745d14e2bd84e,  // 0.181818164033475
    0xbfc9999999e623c5,  // -0.20000000013922495
    0x3fcc71c71c9b60f1,  // 0.22222222229789382
    0xbfcfffffffffd05f,  // -0.24999999999966158
    0x3fd24924924918da,  // 0.28571428571411916
    0xbfd555555555555b,  // -0.33333333333333365
    0x3fd999999999999c,  // 0.40000000000000013
    0xbfe0000000000000,  // -0.5
    0x3c8551a4308b5644,  // 3.6982416408549845e-17
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
