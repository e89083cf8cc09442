// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The tables of angles: every row against its rule.

#include <iterator>

#include "atrig_cases.hpp"
#include "quad.hpp"
#include "scalar/tables/datan.hpp"
#include "scalar/tables/datan2.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

/// By Euler's series, whose terms fall by x²/(1 + x²) at least; for |x| <= 3/2 to about 110 bits.
quad arctan(quad x) {
  const quad ratio = x * x / (1 + x * x);
  quad term = x / (1 + x * x), sum = 0;
  for (int n = 1; n < 250; ++n) {
    sum += term;
    term *= ratio * (2 * n) / (2 * n + 1);
  }
  return sum;
}

quad pi() { return 16 * arctan(quad(1) / 5) - 4 * arctan(quad(1) / 239); }

/// Two words to their last bit: the first is the nearest double.
void expect_words(const std::uint64_t* words, quad exact, const std::string& what) {
  const double high = std::bit_cast<double>(words[0]), low = std::bit_cast<double>(words[1]);
  const quad rest = exact - high;
  EXPECT_LE(ulps(high, exact), 0.5) << what;
  const double bound = std::ldexp(std::fabs(static_cast<double>(exact)), -105);
  EXPECT_LE(std::fabs(static_cast<double>(rest - low)), bound) << what;
}

template <std::size_t N>
void expect_ratios(const std::uint64_t (&table)[N], quad unit) {
  ASSERT_EQ(N, 130u);
  for (int j = 0; j <= 64; ++j)
    expect_words(table + 2 * j, arctan(quad(j) / 64) / unit, "ratio " + std::to_string(j));
}

template <std::size_t N>
void expect_octants(const std::uint64_t (&table)[N], quad unit) {
  ASSERT_EQ(N, 24u);
  const quad bases[] = {0, pi() / 2, pi(), pi() / 2};
  const int signs[] = {1, -1, -1, 1};
  for (int i = 0; i < 4; ++i) {
    for (int j = 0; j < 3; ++j) {
      const quad angle = bases[i] + signs[i] * arctan(quad(j) / 2);
      expect_words(table + 2 * (3 * i + j), angle / unit, "octant " + std::to_string(i));
    }
  }
}

TEST(AtrigTables, Ratios) {
  expect_ratios(scalar::__datan2_la_CoutTab, 1);
  expect_ratios(scalar::__datan2pi_la_CoutTab, pi());
}

TEST(AtrigTables, Octants) {
  expect_octants(scalar::internal_datan2_ha_data, 1);
  expect_octants(scalar::internal_datan2pi_ha_data, pi());
}

/// The first two words of a row are those of atan's.
TEST(AtrigTables, Segments) {
  ASSERT_EQ(std::size(scalar::internal_datanpi_ha_data), 20u);
  for (int i = 0; i < 5; ++i) {
    const std::uint64_t* row = scalar::internal_datanpi_ha_data + 4 * i;
    EXPECT_EQ(row[0], scalar::internal_datan_ha_data[4 * i]) << i;
    EXPECT_EQ(row[1], scalar::internal_datan_ha_data[4 * i + 1]) << i;
    const quad k = std::bit_cast<double>(row[0]);
    expect_words(row + 2, i == 0 ? quad(1) / 2 : arctan(k) / pi(), "segment " + std::to_string(i));
  }
}

TEST(AtrigTables, Quarters) {
  ASSERT_EQ(std::size(scalar::internal_datan_la_data_avx512), 32u);
  for (int j = 0; j < 32; ++j) {
    const quad angle = j <= 4 ? arctan(quad(j) / 4) : pi() / 2 - arctan(quad(4) / j);
    EXPECT_LE(ulps(std::bit_cast<double>(scalar::internal_datan_la_data_avx512[j]), angle), 0.5)
        << j;
  }
}

}  // namespace
