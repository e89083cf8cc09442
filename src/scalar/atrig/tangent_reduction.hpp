// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Reductions of the inverse tangent at double to a small argument and a base.
#pragma once

#include <cstdint>

#include "scalar/atrig/bitwise_choice.hpp"
#include "scalar/protocol.hpp"

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

/// Five segments of a = |x|: t = (a - k)/(1 + ka) with k = 0, 1/2, 1, 3/2, and -1/a for the last,
/// and the angle of k in two words. a - k is exact.
///
/// A row of the table is k, a mask for a and for 1, and the angle. Rows are chosen one after the
/// other: five are too few for gathers to pay.
struct tangent_segment {
  double t;
  double high;
  double low;

  LUMEN_MAIN tangent_segment of(double a, const std::uint64_t (&rows)[20]) {
    std::uint64_t row[4] = {rows[16], rows[17], rows[18], rows[19]};
    choose(a > value(0x3fdc0000ffffffffu), &rows[12], row);
    choose(a > value(0x3fe60000ffffffffu), &rows[8], row);
    choose(a > value(0x3ff30000ffffffffu), &rows[4], row);
    choose(!(a <= value(0x40038000ffffffffu)), &rows[0], row);
    const double k = value(row[0]);
    const double numerator = value(bits(a) & row[1]) - k;
    const double denominator = fma(k, a, value(format<double>::one & row[1]));
    return {quotient(numerator, denominator), value(row[2]), value(row[3])};
  }

 private:
  LUMEN_MAIN void choose(bool next, const std::uint64_t* next_row, std::uint64_t (&row)[4]) {
    row[0] = select(next, next_row[0], row[0]);
    row[1] = select(next, next_row[1], row[1]);
    row[2] = select(next, next_row[2], row[2]);
    row[3] = select(next, next_row[3], row[3]);
  }

  /// n/d, all but correctly rounded: the float reciprocal corrected once, and the quotient once.
  LUMEN_MAIN double quotient(double n, double d) {
    const auto seed = static_cast<double>(divide(1.0f, static_cast<float>(d)));
    const double reciprocal = fma(seed, fma(-d, seed, 1.0), seed);
    const double q = n * reciprocal;
    return fma(fma(-d, q, n), reciprocal, q);
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
