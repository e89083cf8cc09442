// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The tables of the roots: every row against its rule, by powers instead of roots.

#include <iterator>

#include "bits.hpp"
#include "quad.hpp"
#include "scalar/tables/dhypot.hpp"
#include "scalar/tables/dinvcbrt.hpp"
#include "scalar/tables/invsqrt.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

quad value_of(std::uint64_t pattern) { return std::bit_cast<double>(pattern); }
double size(quad x) { return std::fabs(static_cast<double>(x)); }

/// The middle of the i-th of 32 intervals of [1, 2).
quad middle(std::size_t i) { return quad(65 + 2 * i) / 64; }

TEST(RootTables, ReciprocalRoots) {
  ASSERT_EQ(std::size(scalar::_arrdInvSqrtHATab), 78u);
  for (std::size_t j = 0; j <= 64; ++j) {
    const quad m = j <= 32 ? quad(32 + j) / 32 : quad(j) / 16;
    const std::uint64_t word = scalar::_arrdInvSqrtHATab[j];
    EXPECT_EQ(word & 0x07ffffff, 0u) << j;  // 26 bits
    EXPECT_LT(size(value_of(word) * value_of(word) * m - 1), 2 * 0x1p-26) << j;
  }
  EXPECT_EQ(scalar::_arrdInvSqrtHATab[0], 0x3ff0000000000000u);
  EXPECT_EQ(scalar::_arrdInvSqrtHATab[64], 0x3fe0000000000000u);
}

TEST(RootTables, RowsOfHypot) {
  ASSERT_EQ(std::size(scalar::_arrdHypotHATab), 517u);
  for (std::size_t i = 0; i < 256; ++i) {
    const quad s = quad(257 + 2 * (i & 127)) / 256 * (i < 128 ? 1 : 2);
    const quad row = value_of(scalar::_arrdHypotHATab[2 * i]);
    const double multiple = static_cast<double>(row * 512);
    EXPECT_EQ(multiple, std::nearbyint(multiple)) << i;
    // Nearest: 1/sqrt(s) is between row - 1/1024 and row + 1/1024.
    EXPECT_GE((row + quad(1) / 1024) * (row + quad(1) / 1024) * s, 1) << i;
    EXPECT_LE((row - quad(1) / 1024) * (row - quad(1) / 1024) * s, 1) << i;
    EXPECT_EQ(value_of(scalar::_arrdHypotHATab[2 * i + 1]), row * row) << i;
  }
}

TEST(RootTables, InverseCubeRoots) {
  const auto& singles = scalar::internal_dinvcbrt_la_data;
  const auto& pairs = scalar::internal_dinvcbrt_ha_data;
  const auto& short_rows = scalar::_arrdInvCbrtHATab;
  ASSERT_EQ(std::size(singles), 32u + 96u);
  ASSERT_EQ(std::size(pairs), 32u + 192u);
  ASSERT_EQ(std::size(short_rows), 111u);
  for (std::size_t i = 0; i < 32; ++i) {
    EXPECT_LE(size(value_of(singles[i]) * middle(i) + 1), 0x1p-53);
    EXPECT_EQ(singles[i], pairs[i]);
  }
  for (std::size_t row = 0; row < 96; ++row) {
    const quad m = middle(row % 32) * (1 << row / 32);
    const quad high = value_of(pairs[32 + 2 * row]);
    const quad both = high + value_of(pairs[33 + 2 * row]);
    EXPECT_EQ(singles[32 + row], pairs[32 + 2 * row]);
    EXPECT_LE(size(high * high * high * m - 1), 3.01 * 0x1p-53) << row;
    EXPECT_LE(size(both * both * both * m - 1), 3.01 * 0x1p-106) << row;
    const quad cut = value_of(short_rows[row]);
    EXPECT_EQ(short_rows[row] & 0xfffffffff, 0u) << row;  // 17 bits
    EXPECT_LE(size(cut * cut * cut * m - 1), 3.01 * 0x1p-17) << row;
  }
  // The coefficients of (1 - e)^(-1/3).
  quad c = 1;
  for (int j = 1; j <= 9; ++j) {
    c = c * (3 * j - 2) / (3 * j);
    const double expected = static_cast<double>(c);
    EXPECT_EQ(std::bit_cast<double>(short_rows[96 + 9 - j]), expected) << j;
  }
}

}  // namespace
