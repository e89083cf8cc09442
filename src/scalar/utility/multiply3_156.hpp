// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {
namespace special::impl {

/// A double as a pattern, and the code of how it came about.
struct pattern_and_code {
  std::uint64_t pattern;
  std::uint32_t code;
};

/// The position of the leading bit of its index.
static constexpr int log2[16] = {0, 0, 1, 1, 2, 2, 2, 2, 3, 3, 3, 3, 3, 3, 3, 3};

/// a·b·c with one rounding, on patterns. The three significands, of 53 bits, are multiplied exactly
/// as numbers of three limbs of 20 bits. Zeros, denormals, infinities and NaNs are not looked for:
/// they count as the numbers that their fields say. Exponents above 1022 give the pattern
/// 0x7fe0000000000000 of the sign, and code 1; below -1023 a zero of the sign, and code 2.
LUMEN_DEVICE inline pattern_and_code multiply3_156(std::uint64_t a, std::uint64_t b,
                                                   std::uint64_t c) {
  constexpr std::uint64_t limb_mask = 0xfffff;
  const std::uint64_t operands[3] = {a, b, c};
  std::uint64_t limbs[3][3];  // of each operand, highest first: 13, 20 and 20 bits
  int exponent = -0xbfd;
  for (int operand = 0; operand < 3; ++operand) {
    const std::uint64_t pattern = operands[operand];
    exponent += static_cast<int>((pattern >> 52) & 0x7ff);
    const std::uint64_t significand = (pattern & 0xfffffffffffff) | 0x10000000000000;
    limbs[operand][0] = significand >> 40;
    limbs[operand][1] = (significand >> 20) & limb_mask;
    limbs[operand][2] = significand & limb_mask;
  }
  std::uint64_t product[8] = {};
  for (int i = 0; i < 3; ++i) {
    for (int j = 0; j < 3; ++j) {
      for (int k = 0; k < 3; ++k)
        product[6 - (i + j + k)] += limbs[0][i] * limbs[1][j] * limbs[2][k];
    }
  }
  for (int limb = 0; limb < 7; ++limb) {
    product[limb + 1] += product[limb] >> 20;
    product[limb] &= limb_mask;
  }
  const std::uint64_t sign = (a ^ b ^ c) & 0x8000000000000000;
  const std::uint64_t top = product[7] << 40 | product[6] << 20 | product[5];
  const int position = log2[(top >> 56) & 0xf];
  exponent += position;
  if (exponent < -1023) return {sign, 2};
  if (exponent > 1022) return {sign | 0x7fe0000000000000, 1};

  const int shift = position + 4;
  const std::uint64_t fraction = (top >> shift) & 0xfffffffffffff;
  const bool guard = ((top >> (shift - 1)) & 1) != 0;
  const bool sticky = (top & ((std::uint64_t{1} << (shift - 1)) - 1)) != 0 ||
                      (product[4] | product[3] | product[2] | product[1] | product[0]) != 0;
  const std::uint64_t up = guard && (sticky || (fraction & 1) != 0) ? 1 : 0;
  // A fraction that rounds up to 1 carries into the exponent.
  return {sign | ((static_cast<std::uint64_t>(exponent + 1023) << 52) + fraction + up), 0};
}

}  // namespace special::impl

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
