// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
//
// Written by fit/log1p_nolut.py.

#pragma once

#include <cstdint>

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Lowest first: (-ln(1 - k) - k - k^2/2)/k^3 at the multiples of 3/32 from -3/16 to 3/8;
/// times k^3 within 5.1e-19.
static constexpr std::uint64_t log1p_nolut_ha_coarse[6] = {
    0x3fd5553551dbb1e6,  // 0.3333257007023164
    0x3fd000aa23a7e1f7,  // 0.250040564365491
    0x3fc9bc00fea186d3,  // 0.20104992325928225
    0x3fc4973d287634c4,  // 0.16086544490500476
    0x3fbf89642c37c838,  // 0.12319017486132189
    0x3fd0b12e5d741898,  // 0.26081427694624315
};

/// Lowest first: (ln(1 - a) + a)/a^2 for |a| <= 0.1125; times a^2 within 2.3e-18.
static constexpr std::uint64_t log1p_nolut_ha_fine[12] = {
    0xbfdffffffffffffd,  // -0.49999999999999983
    0xbfd5555555555553,  // -0.3333333333333332
    0xbfd0000000003b52,  // -0.250000000000843
    0xbfc99999999a085d,  // -0.20000000000078702
    0xbfc5555553aa7777,  // -0.1666666658902007
    0xbfc2492490baa019,  // -0.1428571421322438
    0xbfc00002313416c4,  // -0.1250002613307314
    0xbfbc71cb344b9a90,  // -0.1111113550829066
    0xbfb996ff99dd82d2,  // -0.0999603033683443
    0xbfb74363b605c6fe,  // -0.09087203210745184
    0xbfb60ad32299fd3b,  // -0.08610267252696684
    0xbfb45aa710c65a5d,  // -0.07950824889699377
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
