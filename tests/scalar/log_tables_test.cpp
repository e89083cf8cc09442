// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The tables of the logarithms: known rows to the bit, and every row against its rule.

#include <algorithm>
#include <iterator>

#include "log_cases.hpp"
#include "quad.hpp"
#include "scalar/tables/dln.hpp"
#include "scalar/tables/dlog10.hpp"
#include "scalar/tables/dlog1p.hpp"
#include "scalar/tables/dlog2.hpp"
#include "scalar/tables/sln.hpp"
#include "scalar/tables/slog10.hpp"
#include "scalar/tables/slog1p.hpp"
#include "scalar/tables/slog2.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

quad value_of(std::uint32_t pattern) { return std::bit_cast<float>(pattern); }
quad value_of(std::uint64_t pattern) { return std::bit_cast<double>(pattern); }

/// ln x for 1/4 < x < 4, to about 110 bits: by the series of 2·artanh((x - 1)/(x + 1)).
quad natural(quad x) {
  const quad z = (x - 1) / (x + 1);
  quad term = 2 * z, sum = 0;
  for (int k = 1; k < 300; k += 2, term *= z * z) sum += term / k;
  return sum;
}
quad binary(quad x) { return natural(x) / natural(2); }
quad decimal(quad x) { return natural(x) / (3 * natural(2) + natural(quad(5) / 4)); }

double size(quad x) { return std::fabs(static_cast<double>(x)); }

/// What the quad arithmetic itself is good for.
constexpr double quad_error = 0x1p-108;

template <typename U>
struct known_row {
  int i;
  U first;
  U second;
  U third;
};

template <typename U, std::size_t N>
void expect_rows(const U (&table)[N], std::initializer_list<known_row<U>> rows) {
  for (const auto& r : rows) {
    EXPECT_EQ(table[3 * r.i], r.first) << r.i;
    EXPECT_EQ(table[3 * r.i + 1], r.second) << r.i;
    EXPECT_EQ(table[3 * r.i + 2], r.third) << r.i;
  }
}

template <typename U, std::size_t N, std::size_t M>
void expect_constants(const U (&table)[N], const U (&constants)[M]) {
  ASSERT_EQ(N, 195 + M);
  EXPECT_TRUE(std::equal(std::begin(constants), std::end(constants), table + 195));
}

/// The number of significant bits of a short high word.
template <typename U>
int significant_bits(U word) {
  constexpr int digits = sizeof(U) == 4 ? 24 : 53;
  return digits - std::min(digits - 1, std::countr_zero(word));
}

/// Every row: the reciprocal on its grid, times `scale` and rounded; two words of its logarithm.
template <typename U, std::size_t N>
void expect_breakpoints(const U (&table)[N], int grid, double scale, quad (*logarithm)(quad),
                        double error, int high_bits) {
  for (int i = 0; i <= 64; ++i) {
    const double reciprocal = std::round(grid * 64.0 / (64 + i)) / grid;
    // Ties, exact halves of a unit, go up.
    const double product = reciprocal * scale;
    const quad first = value_of(table[3 * i]);
    const double unit = std::ldexp(1.0, std::ilogb(product) - (sizeof(U) == 4 ? 23 : 52));
    EXPECT_EQ(static_cast<double>(first), std::floor(product / unit + 0.5) * unit) << i;
    const quad sum = value_of(table[3 * i + 1]) + value_of(table[3 * i + 2]);
    EXPECT_LT(size(sum + logarithm(reciprocal)), error + quad_error) << i;
    EXPECT_LE(significant_bits(table[3 * i + 1]), high_bits) << i;
  }
}

constexpr std::uint32_t sln_constants[] = {
    0x3f317200, 0x35bfbe8e, 0x48000040, 0x46000000, 0x3c200000, 0x4d000000, 0x00000000, 0x3f800000,
    0xbf000000, 0x3eaaaaab, 0xbe800000, 0x3e4ccccd, 0xbe2aaaab, 0x3e124e01, 0xbe0005a0};
constexpr std::uint32_t slog1p_constants[] = {
    0x3f317200, 0x35bfbe8e, 0x48000040, 0x46000000, 0x3c200000, 0x53800000, 0x00000000, 0x3f800000,
    0xbf000000, 0x3eaaaaab, 0xbe800000, 0x3e4ccccd, 0xbe2aaaab, 0x3e124e01, 0xbe0005a0};
constexpr std::uint64_t dln_constants[] = {
    0x3fe62e42fefa3800, 0x3d2ef35793c76730, 0x42d0000000000040, 0x4140000000000000,
    0x3f84000000000000, 0x43b0000000000000, 0x0000000000000000, 0x3ff0000000000000,
    0xbfe0000000000000, 0x3fd5555555555613, 0xbfd0000000000262, 0x3fc9999997b36c81,
    0xbfc555555228b38f, 0x3fc249c02481059d, 0xbfc000b405a2836d};

template <std::size_t N>
void expect_natural(const std::uint32_t (&table)[N]) {
  expect_rows<std::uint32_t>(table, {{0, 0x3f800000, 0x00000000, 0x00000000},
                                     {1, 0x3f7c0000, 0x3c810000, 0x35acb127},
                                     {3, 0x3f740000, 0x3d44c000, 0xb7d57ad8},
                                     {32, 0x3f2a0000, 0x3ed19a00, 0x3580449f},
                                     {64, 0x3f000000, 0x3f317200, 0x35bfbe8e}});
  expect_breakpoints(table, 128, 1, natural, 3.4e-13, 18);
}

template <std::size_t N>
void expect_natural(const std::uint64_t (&table)[N]) {
  expect_rows<std::uint64_t>(table,
                             {{0, 0x3ff0000000000000, 0, 0},
                              {1, 0x3fef800000000000, 0x3f90205658a00000, 0xbd894f716c1b8bdf},
                              {2, 0x3fef080000000000, 0x3f9f7a9b16800000, 0xbd7f5ea936c720c1},
                              {64, 0x3fe0000000000000, 0x3fe62e42fefa3800, 0x3d2ef35793c76730}});
  expect_breakpoints(table, 2048, 1, natural, 1.2e-28, 42);
  expect_constants(table, dln_constants);
}

TEST(LogTables, LnBreakpoints) {
  expect_natural(scalar::__sln_ha_CoutTab);
  expect_natural(scalar::__sln_la_CoutTab);
  expect_natural(scalar::__sln_ep_CoutTab);
  expect_constants(scalar::__sln_ha_CoutTab, sln_constants);
  expect_constants(scalar::__sln_la_CoutTab, sln_constants);
  expect_constants(scalar::__sln_ep_CoutTab, sln_constants);
  expect_natural(scalar::__dln_ha_CoutTab);
}

TEST(LogTables, Log1pBreakpoints) {
  expect_natural(scalar::__slog1p_ha_CoutTab);
  expect_natural(scalar::__slog1p_la_CoutTab);
  expect_natural(scalar::__slog1p_ep_CoutTab);
  expect_constants(scalar::__slog1p_ha_CoutTab, slog1p_constants);
  expect_constants(scalar::__slog1p_la_CoutTab, slog1p_constants);
  expect_constants(scalar::__slog1p_ep_CoutTab, slog1p_constants);
  expect_natural(scalar::__dlog1p_ha_CoutTab);
  expect_natural(scalar::__dlog1p_la_CoutTab);
  expect_natural(scalar::__dlog1p_ep_CoutTab);
}

template <std::size_t N>
void expect_slog2(const std::uint32_t (&table)[N]) {
  EXPECT_EQ(N, 212u);
  expect_rows<std::uint32_t>(
      table, {{1, 0x43b5c797, 0x3cba0000, 0x377ba188}, {64, 0x4338aa40, 0x3f800000, 0}});
  expect_breakpoints(table, 2048, 369.330078125, binary, 3.4e-13, 18);
}

template <std::size_t N>
void expect_slog10(const std::uint32_t (&table)[N]) {
  EXPECT_EQ(N, 212u);
  expect_rows<std::uint32_t>(
      table, {{1, 0x42dae290, 0x3be00000, 0x366a02b9}, {64, 0x425e5c00, 0x3e9a2080, 0x355427de}});
  expect_breakpoints(table, 128, 111.1796875, decimal, 3.4e-13, 18);
}

template <std::size_t N>
void expect_dlog10(const std::uint64_t (&table)[N]) {
  EXPECT_EQ(N, 212u);
  expect_rows<std::uint64_t>(table,
                             {{0, 0x3fdbc00000000000, 0, 0},
                              {64, 0x3fcbc00000000000, 0x3fd34413509f8000, 0xbd380433b83b532a}});
  expect_breakpoints(table, 128, 0.43359375, decimal, 1.2e-28, 42);
}

TEST(LogTables, ScaledBreakpoints) {
  expect_slog2(scalar::__slog2_la_CoutTab);
  expect_slog2(scalar::__slog2_ep_CoutTab);
  expect_slog10(scalar::__slog10_la_CoutTab);
  expect_slog10(scalar::__slog10_ep_CoutTab);
  expect_dlog10(scalar::__dlog10_ha_CoutTab);
  expect_dlog10(scalar::__dlog10_la_CoutTab);
  expect_dlog10(scalar::__dlog10_ep_CoutTab);
}

/// Five of the products are exact ties, and stand one unit above the nearest even word.
TEST(LogTables, TiesOfTheScaledReciprocals) {
  int above = 0;
  for (int i = 0; i <= 64; ++i) {
    const double product = std::round(2048 * 64.0 / (64 + i)) / 2048 * 369.330078125;
    const std::uint32_t even = std::bit_cast<std::uint32_t>(static_cast<float>(product));
    const std::uint32_t difference = scalar::__slog2_la_CoutTab[3 * i] - even;
    EXPECT_LE(difference, 1u);
    above += static_cast<int>(difference);
  }
  EXPECT_EQ(above, 5);
}

/// One pair: high + low + log(R/unit) + bias·(two_high + two_low) = 0, and the high word is a
/// multiple of 2^high_unit.
template <typename U>
struct pair_rule {
  int unit, bias;
  U two_high, two_low;
  int high_unit;
  double error;
};

template <typename U>
void expect_pair(U high, U low, int r, const pair_rule<U>& rule, quad (*logarithm)(quad)) {
  const quad two = value_of(rule.two_high) + value_of(rule.two_low);
  // Half the unit is one logarithm of two, in the same two words.
  const quad exact = 2 * r == rule.unit ? -two : logarithm(quad(r) / rule.unit);
  const quad sum = value_of(high) + value_of(low) + rule.bias * two;
  EXPECT_LT(size(sum + exact), rule.error + quad_error) << r;
  const double scaled = std::ldexp(static_cast<double>(value_of(high)), -rule.high_unit);
  EXPECT_EQ(scaled, std::floor(scaled)) << r;
}

constexpr pair_rule<std::uint64_t> natural_pairs = {
    1024, 1023, 0x3fe62e42fefa0000, 0x3d7cf79abc9e0000, -36, 0x1p-76};

TEST(LogTables, NaturalPairs) {
  using scalar::internal_dln_ha_data;
  ASSERT_EQ(std::size(internal_dln_ha_data), 1026u);
  EXPECT_EQ(internal_dln_ha_data[0], 0xc086232bdd7a8300);
  EXPECT_EQ(internal_dln_ha_data[1], 0xbe1ce91eef3fb100);
  EXPECT_EQ(internal_dln_ha_data[1024], 0xc08628b76e3a4180);
  EXPECT_EQ(internal_dln_ha_data[1025], 0xbe1cf05cd5eed880);
  for (int r = 512; r <= 1024; ++r)
    expect_pair(internal_dln_ha_data[2 * (r - 512)], internal_dln_ha_data[2 * (r - 512) + 1], r,
                natural_pairs, natural);
  EXPECT_TRUE(std::equal(std::begin(internal_dln_ha_data), std::end(internal_dln_ha_data),
                         std::begin(scalar::internal_dlog1p_ha_data),
                         std::end(scalar::internal_dlog1p_ha_data)));
}

TEST(LogTables, Log1pFloatPairs) {
  using scalar::internal_slog1p_ha_data;
  ASSERT_EQ(std::size(internal_slog1p_ha_data), 258u);
  const pair_rule<std::uint32_t> rule = {256, 127, 0x3f317200, 0x35bfbe00, -15, 0x1p-37};
  for (int r = 128; r <= 256; ++r)
    expect_pair(internal_slog1p_ha_data[2 * (r - 128)], internal_slog1p_ha_data[2 * (r - 128) + 1],
                r, rule, natural);
}

TEST(LogTables, Log2Pairs) {
  using scalar::internal_dlog2_ha_data;
  ASSERT_EQ(std::size(internal_dlog2_ha_data), 1026u);
  EXPECT_EQ(internal_dlog2_ha_data[0], 0xc08ff00000000000);
  EXPECT_EQ(internal_dlog2_ha_data[1], 0x0000000000000000);
  EXPECT_EQ(internal_dlog2_ha_data[1024], 0xc08ff80000000000);
  EXPECT_EQ(internal_dlog2_ha_data[1025], 0x8000000000000000);
  // -log2(R/1.44140625) - 1014, as 1.44140625·512 = 738.
  const pair_rule<std::uint64_t> rule = {738, 1023, 0x3ff0000000000000, 0, -43, 0x1p-95};
  for (int r = 369; r <= 738; ++r) {
    const int word = r < 512 ? 4 * (r - 369) : 572 + 2 * (r - 512);
    expect_pair(internal_dlog2_ha_data[word], internal_dlog2_ha_data[word + 1], r, rule, binary);
  }
}

TEST(LogTables, Log10Pairs) {
  using scalar::internal_dlog10_ha_data;
  ASSERT_EQ(std::size(internal_dlog10_ha_data), 514u);
  const pair_rule<std::uint64_t> rule = {444, 1023,   0x3fd34413509f0000, 0x3d7e7fbcc47c0000,
                                         -38, 0x1p-75};
  for (int r = 222; r <= 444; ++r) {
    const int word = r < 256 ? 4 * (r - 222) : 136 + 2 * (r - 256);
    expect_pair(internal_dlog10_ha_data[word], internal_dlog10_ha_data[word + 1], r, rule, decimal);
  }
}

template <std::size_t N>
void expect_single_values(const std::uint64_t (&table)[N], quad (*logarithm)(quad)) {
  ASSERT_EQ(N, 513u);
  for (int r = 512; r <= 1024; ++r) {
    const quad exact = -logarithm(quad(r) / (r <= 724 ? 512 : 1024));
    const auto nearest = static_cast<double>(exact);
    EXPECT_EQ(std::bit_cast<double>(table[r - 512]), nearest) << r;
    EXPECT_LT(size(exact), 0.5);
  }
  EXPECT_EQ(table[512], 0x8000000000000000);
}

TEST(LogTables, SingleValues) {
  expect_single_values(scalar::internal_dlog2_la_data, binary);
  expect_single_values(scalar::internal_dlog2_ep_data, binary);
  expect_single_values(scalar::internal_dlog10_la_data, decimal);
  expect_single_values(scalar::internal_dlog10_ep_data, decimal);
  expect_single_values(scalar::internal_dlog1p_la_data, natural);
  expect_single_values(scalar::internal_dlog1p_ep_data, natural);
}

template <std::size_t N, std::size_t M>
void expect_log2_rare(const std::uint32_t (&reciprocals)[N], const std::uint64_t (&logarithms)[M]) {
  ASSERT_EQ(N, 256u);
  ASSERT_EQ(M, 512u);
  EXPECT_EQ(reciprocals[0], 0x3f7f8000u);
  for (int i = 0; i < 256; ++i) {
    const double reciprocal = std::round(2048 / (1 + (2 * i + 1) / 512.0)) / 2048;
    EXPECT_EQ(static_cast<double>(value_of(reciprocals[i])), reciprocal) << i;
    const quad low = value_of(logarithms[2 * i]);
    const quad high = value_of(logarithms[2 * i + 1]);
    EXPECT_LT(size(high + low + binary(reciprocal)), 2.65e-23) << i;
    const double scaled = std::ldexp(static_cast<double>(high), 20);
    EXPECT_EQ(scaled, std::floor(scaled)) << i;
  }
}

TEST(LogTables, Log2Rare) {
  expect_log2_rare(scalar::__dlog2_ha___libm_rcp_table_256,
                   scalar::__dlog2_ha___libm_log2_table_256);
  expect_log2_rare(scalar::__dlog2_la___libm_rcp_table_256,
                   scalar::__dlog2_la___libm_log2_table_256);
  expect_log2_rare(scalar::__dlog2_ep___libm_rcp_table_256,
                   scalar::__dlog2_ep___libm_log2_table_256);
}

}  // namespace
