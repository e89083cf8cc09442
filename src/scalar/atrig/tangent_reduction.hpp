// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Reductions of the inverse tangent at double to a small argument and a base.
#pragma once

#include <cstdint>

#include "scalar/atrig/bitwise_choice.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/datan.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// x up to 1, -1/x beyond: the float reciprocal, corrected once. Not for infinities.
struct short_reciprocal {
  double t;
  std::uint64_t direct;  ///< all bits set up to 1

  LUMEN_MAIN short_reciprocal of(double x) {
    const auto direct = mask_of<double>(fabs(x) <= 1.0);
    const auto seed = static_cast<double>(divide(1.0f, static_cast<float>(x)));
    const double e = fma(-x, seed, 1.0);
    return {chosen(direct, x, -fma(fma(e, e, e), seed, seed)), direct};
  }
};

/// Five segments of a = |x|: t = (a - k)/(1 + ka) with k = 0, 1/2, 1, 3/2, and -1/a for the last.
/// a - k is exact.
struct tangent_segment {
  std::int32_t row;  ///< first word of the segment's row in tables of four words
  double t;

  LUMEN_MAIN tangent_segment of(double a) {
    const std::uint64_t pattern = bits(a);
    const auto row =
        16 - 4 * (std::int32_t{pattern > 0x3fdc0000ffffffffu} + (pattern > 0x3fe60000ffffffffu) +
                  (pattern > 0x3ff30000ffffffffu) + (pattern > 0x40038000ffffffffu));
    const double k = value(internal_datan_ha_data[row]);
    const std::uint64_t kept = internal_datan_ha_data[row + 1];
    const double numerator = value(pattern & kept) - k;
    const double denominator = fma(k, a, value(format<double>::one & kept));
    return {row, quotient(numerator, denominator)};
  }

 private:
  /// n/d, all but correctly rounded: the float reciprocal corrected once, and the quotient once.
  LUMEN_MAIN double quotient(double n, double d) {
    const auto seed = static_cast<double>(divide(1.0f, static_cast<float>(d)));
    const double reciprocal = fma(seed, fma(-d, seed, 1.0), seed);
    const double q = n * reciprocal;
    return fma(fma(-d, q, n), reciprocal, q);
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
