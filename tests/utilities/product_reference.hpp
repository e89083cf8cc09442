// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <bit>
#include <cstdint>

namespace arbor::lumen::tests {

struct product_of_three {
  std::uint64_t pattern;
  std::uint32_t code;
};

/// The product of three significands of 53 bits, exactly, as `high`·2^53 and what is below it.
struct significand_product {
  unsigned __int128 high;
  bool rest;  ///< whether anything is below
};

inline significand_product exact_product(std::uint64_t a, std::uint64_t b, std::uint64_t c) {
  constexpr std::uint64_t low_bits = (std::uint64_t{1} << 53) - 1;
  const unsigned __int128 ab = static_cast<unsigned __int128>(a) * b;  // below 2^106
  const auto upper = static_cast<std::uint64_t>(ab >> 53);
  const auto lower = static_cast<std::uint64_t>(ab) & low_bits;
  const unsigned __int128 with_lower = static_cast<unsigned __int128>(lower) * c;
  return {static_cast<unsigned __int128>(upper) * c + (with_lower >> 53),
          (static_cast<std::uint64_t>(with_lower) & low_bits) != 0};
}

/// a·b·c to nearest even, on patterns whose fields are taken for those of normal numbers. The range
/// is decided by the exponent before rounding: above 1022 the result is 2^1023 and the code 1,
/// below -1023 it is 0 and the code 2.
inline product_of_three rounded_product(std::uint64_t a, std::uint64_t b, std::uint64_t c) {
  constexpr std::uint64_t unit = std::uint64_t{1} << 52;
  const auto significand = [](std::uint64_t p) { return (p % unit) + unit; };
  const auto exponent_of = [](std::uint64_t p) { return static_cast<int>(p / unit % 2048) - 1023; };
  const std::uint64_t sign = (a ^ b ^ c) & (std::uint64_t{1} << 63);

  const significand_product product = exact_product(significand(a), significand(b), significand(c));
  const int width = 128 - std::countl_zero(static_cast<std::uint64_t>(product.high >> 64));
  const int exponent = exponent_of(a) + exponent_of(b) + exponent_of(c) + (width - 104);
  if (exponent > 1022) return {sign + (std::uint64_t{2046} << 52), 1};
  if (exponent < -1023) return {sign, 2};

  const unsigned __int128 divisor = static_cast<unsigned __int128>(1) << (width - 53);
  const unsigned __int128 remainder = product.high % divisor;
  auto quotient = static_cast<std::uint64_t>(product.high / divisor);
  const bool above_half = remainder > divisor / 2 || (remainder == divisor / 2 && product.rest);
  const bool at_half = remainder == divisor / 2 && !product.rest;
  if (above_half || (at_half && quotient % 2 == 1)) ++quotient;
  // One for the implicit bit less: a quotient of 2^53 goes to the next exponent.
  return {sign + (static_cast<std::uint64_t>(exponent + 1023) << 52) + (quotient - unit), 0};
}

}  // namespace arbor::lumen::tests
