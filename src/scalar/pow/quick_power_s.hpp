// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/log/reduction.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// x^y at float in single words, the main path of `ep`: e^(y·ln x) with the reduction to [2/3, 4/3)
/// and a polynomial of degree 8, and an exponential of degree 3. For positive normal x but the
/// largest number, |y·ln x| <= 87.30 and y finite.
struct quick_power_s {
  LUMEN_MAIN main_result<float> main(float x, float y) {
    const auto a = two_thirds<float>::of(x);
    const float r = a.r;
    float q = horner(r, 0xbe1b6a22u, 0x3e2db86bu, 0xbe289358u, 0x3e4afb81u, 0xbe80061du,
                     0x3eaaaee7u, 0xbf000000u);
    q = fma(q, r, 0.0f);
    float s = fma(q, r, r);
    s = fma(a.k, value(0x35bfbe8eu), s);
    const float l = fma(a.k, value(0x3f317200u), s);

    const float p = fma(l, y, 0.0f);
    const float shifter = value(0x4b400000u);  // 3·2^22
    const float shifted = fma(p, value(0x3fb8aa3bu), shifter);
    const float n = shifted - shifter;
    const float g = fma(-n, value(0x3f317218u), p);
    const float power = horner(g, 0x3e2963acu, 0x3f00f2d6u, 0x3f8003deu, 0x3f800000u);
    const bool not_served =
        static_cast<std::int32_t>(bits(x) + 0x7f800000u) > static_cast<std::int32_t>(0xfefffffeu);
    const bool large = bits(fabs(p)) > 0x42ae9a00u;
    return {value((bits(shifted) << 23) + bits(power)),
            flag_if<float>(not_served, is_special(y), large)};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
