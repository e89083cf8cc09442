// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The rare path of sine and cosine at double and `ep`, in doubles alone.
#pragma once

#include <cstdint>

#include "scalar/complex/double_double.hpp"
#include "scalar/horner.hpp"
#include "scalar/log/reduction.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dsin.hpp"
#include "scalar/trig/parity.hpp"

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
    return of_placed(a < value(slices_from) ? by_parts_of_pi(a) : by_slices(a), x);
  }

  /// For finite |x| >= 2^30; some number for all others.
  LUMEN_MAIN octant_rest of_sliced(double x) {
    const double a = fabs(x);
    return of_placed(by_slices(select(a >= value(slices_from), a, value(slices_from))), x);
  }
  LUMEN_MAIN bool is_not_sliced(double x) {
    return is_outside(fabs(x), slices_from, 0x7fefffffffffffffu);
  }

 private:
  static constexpr std::uint64_t slices_from = 0x41d0000000000000;  // 2^30

  struct placed {
    std::uint64_t octant;
    double_double rest;
  };

  LUMEN_MAIN octant_rest of_placed(const placed& p, double x) {
    const std::uint64_t sign = sign_bit(x);
    const double_double rest =
        two_sum(value(bits(p.rest.high) ^ sign), value(bits(p.rest.low) ^ sign));
    const std::uint64_t quarters = (p.octant + 1) >> 1;
    const std::uint64_t negative = sign >> 63;
    return {(quarters ^ (0 - negative)) + negative, rest.high, rest.low};
  }

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
  LUMEN_MAIN placed by_slices(double a) {
    const std::uint64_t scale = std::uint64_t{200} << 52;  // taken from a, put on the slices
    const double scaled = value(bits(a) - scale);
    const double high = value(bits(scaled) & 0xfffffffff8000000u);  // 26 bits
    const double low = scaled - high;
    const std::uint64_t place = (bits(a) >> 52) - 1052;
    const std::uint64_t i = (static_cast<std::uint32_t>(place) * std::uint64_t{0x147ae}) >> 21;
    const std::uint64_t* slices = __dsin_ep_ReductionTab + static_cast<std::int32_t>(19 + i);

    double_double sum = {low * value(slices[0]), 0.0};
    sum = plus(sum, high * value(slices[1]));
    const std::uint64_t cut = 38 - (place - 25 * i);  // place/25 is i
    sum.high -= value(bits(sum.high) & (~std::uint64_t{0} << cut));
    sum = plus_slices<1>(sum, low, high, slices);
    sum = plus_slices<2>(sum, low, high, slices);
    const std::uint64_t octant = integer_part(sum.high);
    sum.high -= small_integer(octant);
    sum = plus(sum, select(is_odd(octant), -1.0, 0.0));
    sum = plus_slices<3>(sum, low, high, slices);
    sum = plus_slices<4>(sum, low, high, slices);
    sum = plus_slices<5>(sum, low, high, slices);
    sum = plus_slices<6>(sum, low, high, slices);
    sum = plus_slices<7>(sum, low, high, slices);

    // Times pi/4, the leading 27 bits exactly.
    const double leading = (sum.high + entry(4)) - entry(4);
    const double behind = (sum.high - leading) + sum.low;
    const double product = leading * entry(6);
    const double product_low = mad(behind, entry(6), mad(leading, entry(7), behind * entry(7)));
    return {octant, {product, product_low}};
  }

  LUMEN_MAIN double_double plus(double_double sum, double term) {
    const double_double s = two_sum(sum.high, term);
    return two_sum(s.high, sum.low + s.low);
  }

  template <int k>
  LUMEN_MAIN double_double plus_slices(double_double sum, double low, double high,
                                       const std::uint64_t* slices) {
    return plus(plus(sum, low * value(slices[k])), high * value(slices[k + 1]));
  }

  /// floor(sum) of 0 <= sum < 2^52.
  LUMEN_MAIN std::uint64_t integer_part(double sum) {
    const std::uint64_t shift = 1075 - (bits(sum) >> 52);
    const std::uint64_t mantissa = (bits(sum) & format<double>::fraction) | 0x0010000000000000u;
    return select(shift < 64, mantissa >> (shift & 63u), std::uint64_t{0});
  }
};

/// The sine of the place a and 2 pi shift/64; with a shift of 16 the cosine. From a row of a table
/// for the nearest of 64 steps of the turn, degree 9 and 8.
LUMEN_MAIN double sine_of_octants(const octant_rest& a, std::int32_t shift) {
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
