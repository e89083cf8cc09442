// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The reduction of doubles of every size to the nearest quarter turn, in fixed point.
#pragma once

#include <cstdint>

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
    const auto e = static_cast<std::int32_t>(bits(a) >> 52);
    if (e < 1024) return {0, a, 0.0};
    words turn = place_in_turn(a, e);
    turn.shift_left(2);
    // One's complement makes the nearest quarter turn of the one below.
    const std::uint64_t negative = 0u - (turn.w[0] >> 63);
    const std::uint64_t quarters = turn.behind - negative;
    for (std::uint64_t& word : turn.w) word ^= negative;

    std::int32_t exponent = -66;
    while (static_cast<std::int64_t>(turn.w[0]) > 0) {
      turn.shift_left(1);
      --exponent;
    }
    const std::uint64_t u = turn.w[0] >> 32, v = turn.w[0] & low_half;
    const std::uint64_t product = u * 0xc90fdaa2u + ((u * 0x2168c235u + v * 0xc90fdaa2u) >> 32);
    const std::uint64_t top = product >> 63;
    const std::uint64_t m = product >> top;  // of 63 bits, in units of 2^exponent
    exponent += top != 0 ? 4 : 3;

    const std::uint64_t sign = negative & format<double>::sign;
    const auto field = static_cast<std::uint64_t>(exponent + 0x43c);
    const double high = value((((m + 0x200u) >> 10) + (field << 52)) | sign);
    // What the rounding left, -512..511.
    const auto rest = static_cast<std::int32_t>((m & 0x3ffu) ^ 0x200u) - 0x200;
    const double unit = value((static_cast<std::uint64_t>(exponent + 1023) << 52) | sign);
    return {quarters, high, static_cast<double>(rest) * unit};
  }

 private:
  static constexpr std::uint64_t low_half = 0xffffffffu;

  /// A fixed-point number of 192 bits below 1 and what was shifted out of it.
  struct words {
    std::uint64_t w[3];
    std::uint64_t behind;

    LUMEN_DEVICE void shift_left(int n) {
      behind = w[0] >> (64 - n);
      w[0] = (w[0] << n) | (w[1] >> (64 - n));
      w[1] = (w[1] << n) | (w[2] >> (64 - n));
      w[2] <<= n;
    }
  };

  /// frac(a/(2 pi)) in digits of 32 bits; products below the sixth digit do not count.
  LUMEN_DEVICE static words place_in_turn(double a, std::int32_t e) {
    const std::int32_t place = e - 1011;
    const std::uint32_t* table = __dsin_ha_InvPi_tbl + (place >> 5);
    const auto shift = static_cast<std::uint32_t>(place & 31);
    std::uint64_t d[6];
    for (int i = 0; i < 6; ++i) {
      const std::uint64_t both = (std::uint64_t{table[i]} << 32) | table[i + 1];
      d[i] = ((both << shift) >> 32) & low_half;
    }
    const std::uint64_t m_high = ((bits(a) >> 32) & 0x000fffffu) | 0x00100000u;
    const std::uint64_t m_low = bits(a) & low_half;
    // Digit i of the product has m_low·d[i] and m_high·d[i + 1].
    std::uint64_t digit[5];
    std::uint64_t carry = 0;
    for (int i = 4; i >= 0; --i) {
      const std::uint64_t p = m_low * d[i], q = m_high * d[i + 1];
      const std::uint64_t sum = carry + (p & low_half) + (q & low_half);
      digit[i] = sum & low_half;
      carry = (sum >> 32) + (p >> 32) + (q >> 32);
    }
    return {{(digit[0] << 32) | digit[1], (digit[2] << 32) | digit[3], digit[4] << 32}, 0};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
