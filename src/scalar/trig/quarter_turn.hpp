// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The reduction of doubles of every size to the nearest quarter turn, in fixed point.
#pragma once

#include <cstdint>

#include "scalar/log/reduction.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dsin.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// a = quarters pi/2 + (rest + rest_low), but for full turns.
struct quarter_turn {
  std::uint64_t quarters;  ///< modulo 4
  double rest;
  double rest_low;

  /// For finite a >= 0 of every size: the 53 bits of a by those 192 bits of 1/(2 pi) that matter,
  /// normalised and multiplied by pi/4 in fixed point. The relative error is below 2^-61. Arguments
  /// below 2 are returned.
  LUMEN_DEVICE static quarter_turn nearest(double a) {
    if (bits(a) < 0x4000000000000000u) return {0, a, 0.0};
    const signed_place p = signed_place::of(place_in_turn(a));
    std::uint64_t w0 = p.w[0], w1 = p.w[1], w2 = p.w[2];
    std::int32_t shift = 0;
    while (static_cast<std::int64_t>(w0) > 0) {
      w0 = (w0 << 1) | (w1 >> 63);
      w1 = (w1 << 1) | (w2 >> 63);
      w2 <<= 1;
      ++shift;
    }
    return of_normalised(p, w0, static_cast<std::uint64_t>(shift));
  }

  /// The same without a branch for a >= 2; some number for all others, and where
  /// `next_to_quarter` is set: within 2^-52 of a multiple of the quarter turn.
  LUMEN_MAIN quarter_turn nearest_without_branch(double a, bool& next_to_quarter) {
    const signed_place p = signed_place::of(place_in_turn(select(a >= 2.0, a, 2.0)));
    // The exponent of the leading 52 bits tells how many of them are zero.
    const std::uint64_t leading = p.w[0] >> 12;
    const std::uint64_t shift = 1074 - (bits(small_integer(leading)) >> 52);
    const std::uint64_t w0 = (p.w[0] << (shift & 63u)) | ((p.w[1] >> 1) >> (~shift & 63u));
    next_to_quarter = leading == 0;
    return of_normalised(p, w0, shift);
  }

 private:
  static constexpr std::uint64_t low_half = 0xffffffffu;

  /// A fixed-point number of 192 bits below 1.
  struct words {
    std::uint64_t w[3];
  };

  /// A place in units of the quarter turn: the whole ones, and the rest to the nearest one.
  struct signed_place {
    std::uint64_t w[3];      ///< magnitude; one's complement made that of a negative rest
    std::uint64_t negative;  ///< all bits of it
    std::uint64_t quarters;

    LUMEN_MAIN signed_place of(const words& turn) {
      const std::uint64_t w0 = (turn.w[0] << 2) | (turn.w[1] >> 62);
      const std::uint64_t w1 = (turn.w[1] << 2) | (turn.w[2] >> 62);
      const std::uint64_t w2 = turn.w[2] << 2;
      const std::uint64_t negative = 0u - (w0 >> 63);
      return {
          {w0 ^ negative, w1 ^ negative, w2 ^ negative}, negative, (turn.w[0] >> 62) - negative};
    }
  };

  /// From the leading 64 bits of the rest, shifted left until the first one is set.
  LUMEN_MAIN quarter_turn of_normalised(const signed_place& p, std::uint64_t w0,
                                        std::uint64_t shift) {
    const std::uint64_t u = w0 >> 32, v = w0 & low_half;
    const std::uint64_t product = u * 0xc90fdaa2u + ((u * 0x2168c235u + v * 0xc90fdaa2u) >> 32);
    const std::uint64_t top = product >> 63;
    const std::uint64_t m = product >> top;  // of 63 bits, in units of 2^exponent
    const std::uint64_t exponent = top - 63 - shift;

    const std::uint64_t sign = p.negative & format<double>::sign;
    const double high = value((((m + 0x200u) >> 10) + ((exponent + 0x43c) << 52)) | sign);
    // What the rounding left, -512..511.
    const double rest = small_integer((m & 0x3ffu) ^ 0x200u) - 512.0;
    const double unit = value(((exponent + 1023) << 52) | sign);
    return {p.quarters, high, rest * unit};
  }

  /// frac(a/(2 pi)) in digits of 32 bits; products below the sixth digit do not count.
  LUMEN_MAIN words place_in_turn(double a) {
    const std::int32_t place = static_cast<std::int32_t>(bits(a) >> 52) - 1011;
    const std::uint32_t* table = __dsin_ha_InvPi_tbl + (place >> 5);
    const auto shift = static_cast<std::uint32_t>(place & 31);
    const auto digit_of = [table, shift](int i) {
      const std::uint64_t both = (std::uint64_t{table[i]} << 32) | table[i + 1];
      return ((both << shift) >> 32) & low_half;
    };
    const std::uint64_t d[6] = {digit_of(0), digit_of(1), digit_of(2),
                                digit_of(3), digit_of(4), digit_of(5)};
    const std::uint64_t m_high = ((bits(a) >> 32) & 0x000fffffu) | 0x00100000u;
    const std::uint64_t m_low = bits(a) & low_half;
    // Digit i of the product has m_low·d[i] and m_high·d[i + 1]; the carry is what is above it.
    const auto digit = [&](int i, std::uint64_t carry) {
      const std::uint64_t p = m_low * d[i], q = m_high * d[i + 1];
      const std::uint64_t sum = carry + (p & low_half) + (q & low_half);
      return carried{sum & low_half, (sum >> 32) + (p >> 32) + (q >> 32)};
    };
    const carried d4 = digit(4, 0), d3 = digit(3, d4.carry), d2 = digit(2, d3.carry),
                  d1 = digit(1, d2.carry), d0 = digit(0, d1.carry);
    return {{(d0.low << 32) | d1.low, (d2.low << 32) | d3.low, d4.low << 32}};
  }

  struct carried {
    std::uint64_t low;
    std::uint64_t carry;
  };
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
