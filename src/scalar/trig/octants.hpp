// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The rare path of sine and cosine at double and `ep`, in doubles alone.
#pragma once

#include <cstdint>

#include "scalar/complex/double_double.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dsin.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// x = quarters pi/2 + (rest + rest_low), |rest| <= pi/4 and a little, from the octant that |x| is
/// in: the odd one goes to the quarter turn behind it.
struct octant_rest {
  std::uint64_t quarters;  ///< modulo 4, of x's sign
  double rest;
  double rest_low;

  /// For finite |x| >= 2^23.
  LUMEN_DEVICE static octant_rest of(double x) {
    const double a = fabs(x);
    const placed p = a < value(0x41d0000000000000u) ? by_parts_of_pi(a) : by_slices(a);
    const std::uint64_t negative = bits(x) >> 63;
    const double sign = entry(2 + static_cast<std::int32_t>(negative));
    const double_double rest = two_sum(sign * p.rest.high, sign * p.rest.low);
    const std::uint64_t quarters = (p.octant + 1) >> 1;
    return {quarters * (1 - 2 * negative), rest.high, rest.low};
  }

 private:
  struct placed {
    std::uint64_t octant;
    double_double rest;
  };

  LUMEN_DEVICE static double entry(std::int32_t i) { return value(__dsin_ep_ReductionTab[i]); }

  /// Below 2^30: a less a multiple of pi/4 of 31 bits, by pi/4 in five parts. The products with the
  /// first four are exact.
  LUMEN_DEVICE static placed by_parts_of_pi(double a) {
    const double y = a * entry(8);
    const std::uint64_t mantissa = 0x80000000u | ((bits(y) & format<double>::fraction) >> 21);
    const std::uint64_t octant = mantissa >> (1054 - (bits(y) >> 52));
    const auto even = static_cast<double>(octant + (octant & 1u));
    const double start = a - even * entry(10);  // exact
    const double_double first = two_sum(start, -(even * entry(11)));
    const double_double second = two_sum(first.high, -(even * entry(12)));
    const double_double third = two_sum(second.high, -(even * entry(13)));
    const double low = ((first.low + second.low) + third.low) - even * entry(14);
    return {octant, {third.high, low}};
  }

  /// From 2^30: products of the two halves of a with those slices of 4/pi that matter. The first
  /// two lose multiples of the turn. The octant is split off as soon as the products that follow
  /// are below 2^-20, and the two words of the sum stay normalised, so that arguments next to a
  /// multiple of pi/2 keep their bits.
  LUMEN_DEVICE static placed by_slices(double a) {
    const std::uint64_t scale = std::uint64_t{200} << 52;  // taken from a, put on the slices
    const double scaled = value(bits(a) - scale);
    const double high = value(bits(scaled) & 0xfffffffff8000000u);  // 26 bits
    const double low = scaled - high;
    const std::uint64_t place = (bits(a) >> 52) - 1052;
    const std::uint64_t i = (place * 0x147aeu) >> 21;  // place/25
    const auto word = static_cast<std::int32_t>(19 + i);

    double sum = low * entry(word);
    double rest = 0.0;
    const auto add = [&sum, &rest](double term) {
      const double_double s = two_sum(sum, term);
      const double_double both = two_sum(s.high, rest + s.low);
      sum = both.high;
      rest = both.low;
    };
    const auto add_pair = [&](std::int32_t k) {
      add(low * entry(word + k));
      add(high * entry(word + k + 1));
    };
    add(high * entry(word + 1));
    const std::uint64_t cut = 38 - (place - 25 * i);
    sum -= value(bits(sum) & (~std::uint64_t{0} << cut));
    for (std::int32_t k = 1; k < 3; ++k) add_pair(k);
    const std::uint64_t octant = integer_part(sum);
    sum -= static_cast<double>(octant);
    add(entry(static_cast<std::int32_t>(octant & 1u)));
    for (std::int32_t k = 3; k < 8; ++k) add_pair(k);

    // Times pi/4, the leading 27 bits exactly.
    const double leading = (sum + entry(4)) - entry(4);
    const double behind = (sum - leading) + rest;
    const double product = leading * entry(6);
    const double product_low = mad(behind, entry(6), mad(leading, entry(7), behind * entry(7)));
    return {octant, {product, product_low}};
  }

  /// floor(sum) of 0 <= sum < 2^52.
  LUMEN_DEVICE static std::uint64_t integer_part(double sum) {
    const std::uint64_t shift = 1075 - (bits(sum) >> 52);
    const std::uint64_t mantissa = (bits(sum) & format<double>::fraction) | 0x0010000000000000u;
    return shift < 64 ? mantissa >> shift : 0;
  }
};

/// The sine of x and 2 pi shift/64; with a shift of 16 the cosine of x. From a row of a table for
/// the nearest of 64 steps of the turn, degree 9 and 8.
LUMEN_DEVICE inline double sine_of_octants(double x, std::int32_t shift) {
  const octant_rest a = octant_rest::of(x);
  const double shifter = value(0x4338000000000000u);  // 3·2^51
  const double c = a.rest * value(0x40245f306dc9c883u) + shifter;
  const double m = c - shifter;
  const double u0 = a.rest - m * value(0x3fb921fb54400000u);
  const double step_low = m * value(0x3d90b4611a600000u);
  const double u = u0 - step_low;
  const double ul = (((u0 - u) - step_low) - m * value(0x3b63198a2e037073u)) + a.rest_low;
  const std::uint64_t step =
      ((a.quarters << 4) & 0x30u) + bits(c) + static_cast<std::uint64_t>(shift);
  const std::uint64_t* row = __dsin_ep_CoutTab + 4 * static_cast<std::int32_t>(step & 63u);

  const double cosine_rest = value(row[0]), s = value(row[1]), s_low = value(row[2]),
               head = value(row[3]);
  const double cosine = head + cosine_rest;
  const double_double first = two_sum(s, head * u);
  const double_double sum = two_sum(first.high, cosine_rest * u);
  const double v = u * u;
  const double ps =
      horner(v, 0x3ec71de3a556c734u, 0xbf2a01a01a01a01au, 0x3f81111111111111u, 0xbfc5555555555555u);
  const double pc =
      horner(v, 0x3efa01a01a01a01au, 0xbf56c16c16c16c17u, 0x3fa5555555555555u, 0xbfe0000000000000u);
  const double of_low = mad(ul, mad(-s, u, cosine), s_low);
  const double higher = ((u * v) * ps) * cosine + (v * pc) * s;
  return sum.high + (((first.low + sum.low) + of_low) + higher);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
