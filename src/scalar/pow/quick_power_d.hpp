// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/log/reduction.hpp"
#include "scalar/pow/word_power_d.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dpow.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// x^y at double in single words, the main path of `ep`: for positive normal x, |y·ln x| < 708.396
/// and |y| < 2^1017. The logarithm has a row by an integer reciprocal and a polynomial of degree 4.
/// The exponential has a row of 2^(i/2048), rounded down, and the chord to the next one in place of
/// a polynomial: at most 1.43e-8 of the result above it.
struct quick_power_d {
  static constexpr int interleave = 4;

  LUMEN_MAIN main_result<double> main(double x, double y) {
    const auto a = integer_reciprocal::of(x);
    const double row = value(internal_dpow_ep_data[integer_reciprocal::single_word(a)]);
    const double exponent =
        fma(integer_reciprocal::exponent_of_row(a), value(0x3fe62e42fefa39efu), 0.0);
    double p = fma(value(0xbfd0000148058ee1u), a.t, value(0x3fd55555555543c5u));
    p = fma(p, a.t, value(0xbfdffffffffff81fu));
    const double w = fma(a.t, a.t, 0.0);
    const double q = fma(p, w, 0.0);
    const double l = ((a.t + q) + row) + exponent;
    const double product = fma(l, y, 0.0);

    const double steps = fma(product, value(0x40a71547652b82feu), 0.0);  // 2048 log2 e
    const double shifter = value(0x4338000000000000u);                   // 3·2^51
    const double shifted = (steps - 0.5) + shifter;
    const double n = shifted - shifter;
    const double f = steps - n;
    const double g = fma(f, value(0x3f362f3904051fa1u), 0.0);  // 2^(1/2048) - 1
    const auto i = static_cast<std::int64_t>(bits(shifted) & 0x7ffu);
    const double root = value(internal_dpow_ep_data[513 + i]);
    const double r = fma(root, g, root);
    const double power = value(bits(r) + ((bits(shifted) << 41) & 0xfff0000000000000u));
    const bool large = (bits(product) & format<double>::magnitude) >= 0x4086232b00000000u;
    return {power, flag_if<double>(not_for_main_path(x, y), large)};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
