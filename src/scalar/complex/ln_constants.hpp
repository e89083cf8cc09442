// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
//
// Written by fit/ln.py.

#pragma once

#include <cstdint>

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Highest first: (ln(1 + t)/2 - t/2)/t on [-1/2, 1], the powers from 21 to 30; the
/// logarithm within 2.0e-16 of itself.
static constexpr std::uint64_t half_log1p_high[10] = {
    0x3f3e741ca327f41f,  // 0.0004646844783165477
    0xbf708871e6589126,  // -0.004036374016809929
    0x3f8f57604091759f,  // 0.015303375215973967
    0xbfa0ba590408185f,  // -0.03267172025884756
    0x3fa565ad865d7d94,  // 0.04179136529159702
    0xbf9f7b141004e6be,  // -0.03074294421933276
    0x3f8768f174785814,  // 0.011430631987462227
    0xbf7b4583873965fc,  // -0.0066580903836324055
    0x3f926077dcffe779,  // 0.017946122039553345
    0xbf9c493a882b2dc5,  // -0.027623095093799472
};

/// Those from 11 to 20.
static constexpr std::uint64_t half_log1p_middle[10] = {
    0x3f9c1f24f235d701,  // 0.02746255615553306
    0xbf99347a651e4cc9,  // -0.02461425058534131
    0x3f99b68bbad6e772,  // 0.025110419539238156
    0xbf9c39c850b9f22d,  // -0.027564172675271493
    0x3f9e567d1c58c946,  // 0.029626803259995137
    0xbfa00a5f02e7145d,  // -0.031329125503852785
    0x3fa10e3cc45bc350,  // 0.03331174752191279
    0xbfa2476622a251fa,  // -0.03570098088053793
    0x3fa3b15c8f7533d4,  // 0.038462536346379445
    0xbfa55581e9d0083d,  // -0.04166799525411633
};

/// Those from 0 to 10.
static constexpr std::uint64_t half_log1p_low[11] = {
    0x3fa745d1fda804b0,  // 0.04545456143751758
    0xbfa99996d2a03883,  // -0.04999991723171695
    0x3fac71c6f772e0a8,  // 0.05555555124868877
    0xbfb000000d993145,  // -0.0625000031661261
    0x3fb2492493259dd7,  // 0.0714285716290911
    0xbfb5555555093f3c,  // -0.08333333326413322
    0x3fb9999999957e6c,  // 0.09999999999626547
    0xbfc0000000006621,  // -0.12500000000072567
    0x3fc5555555555896,  // 0.16666666666668978
    0xbfcfffffffffffb0,  // -0.24999999999999778
    0xbc7c6f043d7aa41f,  // -2.466226741020867e-17
};

/// Highest first: (artanh f - f)/f^3 of f^2 for |f| <= (√2 - 1)/(√2 + 1);
/// artanh f within 5.4e-19 of itself.
static constexpr std::uint64_t artanh_rest[10] = {
    0x3fabedb01af0c1fe,  // 0.054547789848928815
    0x3faab83e04a47f78,  // 0.05218690687820432
    0x3fae2029616bb132,  // 0.05883912386147684
    0x3fb1110b8d10b6bb,  // 0.06666633790947689
    0x3fb3b13b261100c9,  // 0.0769230812011329
    0x3fb745d17437e31a,  // 0.09090909087525426
    0x3fbc71c71c71f255,  // 0.11111111111126466
    0x3fc2492492492486,  // 0.14285714285714252
    0x3fc999999999999a,  // 0.2
    0x3fd5555555555555,  // 0.3333333333333333
};

/// Highest first: the same for |f| <= 1/3; artanh f within 1.0e-11 of itself.
static constexpr std::uint64_t artanh_rest_c[6] = {
    0x3fba9bafb0c93ac9,  // 0.10393808427873376
    0x3fb65ad56d9e0064,  // 0.08732351232720387
    0x3fbc7fb3587cdba6,  // 0.11132355604500663
    0x3fc248f579c7d0d0,  // 0.1428515286094183
    0x3fc9999a0d3dcfed,  // 0.2000000538497483
    0x3fd55555553e7594,  // 0.33333333325011805
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
