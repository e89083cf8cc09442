// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The tables of the exponentials: known rows to the bit, and every row against its rule.

#include <algorithm>
#include <cmath>
#include <iterator>

#include "exp_points.hpp"
#include "quad.hpp"
#include "scalar/tables/dexp10.hpp"
#include "scalar/tables/dexpm1.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

struct row {
  std::uint64_t first;
  std::uint64_t second;
};

template <std::size_t N>
void expect_rows(const std::uint64_t (&table)[N], std::initializer_list<row> rows) {
  std::size_t i = 0;
  for (const row& r : rows) {
    EXPECT_EQ(table[i++], r.first);
    EXPECT_EQ(table[i++], r.second);
  }
}

/// 2^(i/n) for a power of two n, to about 110 bits: by square roots, each improved by one step of
/// Newton's method.
quad root_of_two(std::size_t i, std::size_t n) {
  quad root = 2, result = 1;
  for (std::size_t digit = n / 2; digit != 0; digit /= 2) {
    const double rough = std::sqrt(static_cast<double>(root));
    quad s = rough;
    for (int step = 0; step < 3; ++step) s = (s + root / s) / 2;
    root = s;
    if ((i & digit) != 0) result *= root;
  }
  return result;
}

/// Seven factors and their product, each to 113 bits.
constexpr double root_error = 16 * 0x1p-113;

quad value_of(std::uint64_t pattern) { return std::bit_cast<double>(pattern); }

double relative(quad computed, quad exact) {
  return std::fabs(static_cast<double>((computed - exact) / exact));
}

TEST(ExpTables, Exp10Main) {
  expect_rows(scalar::internal_dexp10_ha_data, {{0x3ff0000000000000, 0},
                                                {0x3ff0163da9fb3335, 0x3c9b61299ab8cdb7},
                                                {0x3ff02c9a3e778061, 0xbc719083535b085d}});
  ASSERT_EQ(std::size(scalar::internal_dexp10_la_data), 128u);
  ASSERT_EQ(std::size(scalar::internal_dexp10_ha_data), 256u);
  for (std::size_t i = 0; i < 128; ++i) {
    const quad exact = root_of_two(i, 128);
    const std::uint64_t high = scalar::internal_dexp10_ha_data[2 * i];
    const std::uint64_t low = scalar::internal_dexp10_ha_data[2 * i + 1];
    EXPECT_EQ(scalar::internal_dexp10_la_data[i], high);
    EXPECT_LT(relative(value_of(high), exact), 9.5e-17);
    EXPECT_LT(relative(value_of(high) + value_of(low), exact), 5.7e-33 + root_error);
  }
}

template <std::size_t N>
void expect_rare_table(const std::uint64_t (&table)[N]) {
  ASSERT_EQ(N, 147u);
  for (std::size_t i = 0; i < 64; ++i) {
    const quad exact = root_of_two(i, 64);
    EXPECT_LT(relative(value_of(table[2 * i]) * (1 + value_of(table[2 * i + 1])), exact),
              5.4e-33 + root_error);
  }
  const std::uint64_t constants[] = {
      0x406a934f0979a371, 0x4338000000000000, 0x40026bb1bbb55515, 0x40053524c73cd20a,
      0x4000470591e2bc10, 0x3ff2bd77b840f0bf, 0x3fe1427c87c70a85, 0x40734413509f79fe,
      0xc0733a7146f72a41, 0xc07439b746e36b52, 0x3f734413509f0000, 0x3d1e7fbcc47c4acd,
      0x0010000000000001, 0x7fefffffffffffff, 0x0000000000000000, 0x3ff0000000000000,
      0x4000000000000000, 0x3c30000000000000, 0x41f8000000000000};
  EXPECT_TRUE(std::equal(std::begin(constants), std::end(constants), table + 128, table + N));
}

TEST(ExpTables, Exp10Rare) {
  expect_rare_table(scalar::__dexp10_ha__zordExp10Tab);
  expect_rare_table(scalar::__dexp10_la__zordExp10Tab);
  expect_rare_table(scalar::__dexp10_ep__zordExp10Tab);
}

/// Row j: fraction of the root with the index XORed into its top, and its relative rest, of which
/// bodies read the high half.
template <std::size_t N>
void expect_expm1_rows(const std::uint64_t (&table)[N], int index_shift) {
  for (std::size_t j = 0; j < N / 2; ++j) {
    const std::uint64_t fraction = table[2 * j] ^ (std::uint64_t{j} << index_shift);
    ASSERT_EQ(fraction >> 52, 0u);
    const quad high = value_of(fraction | 0x3ff0000000000000);
    const quad low = value_of(table[2 * j + 1] & 0xffffffff00000000);
    EXPECT_LT(relative(high * (1 + low), root_of_two(j, N / 2)), 0x1p-73);
  }
}

TEST(ExpTables, Expm1) {
  expect_rows(
      scalar::__dexpm1_la_Tbl_exp,
      {{0, 0}, {0x0000d9b0d3158574, 0x3c8cd2523567f613}, {0x0001b5586cf9890f, 0x3c979aa65d837b6d}});
  expect_rows(
      scalar::__dexpm1_ha_Tbl_exp,
      {{0, 0}, {0x0001b5586cf9890f, 0x3c979aa65d837b6d}, {0x000372b83c7d517b, 0xbc801b15eaa59348}});
  expect_expm1_rows(scalar::__dexpm1_la_Tbl_exp, 47);
  expect_expm1_rows(scalar::__dexpm1_ha_Tbl_exp, 48);
}

}  // namespace
