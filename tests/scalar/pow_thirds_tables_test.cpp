// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The tables of pow2o3 and pow3o2: every row against its rule, by powers instead of roots.

#include <iterator>

#include "bits.hpp"
#include "quad.hpp"
#include "scalar/tables/pow2o3.hpp"
#include "scalar/tables/pow3o2.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

quad value_of(std::uint32_t pattern) { return std::bit_cast<float>(pattern); }
quad value_of(std::uint64_t pattern) { return std::bit_cast<double>(pattern); }
double size(quad x) { return std::fabs(static_cast<double>(x)); }

/// The middle of the i-th of 32 intervals of [1, 2).
quad middle(std::size_t i) { return quad(65 + 2 * i) / 64; }
quad middle_of_row(std::size_t row) { return middle(row % 32) * (1 << row / 32); }

quad square(quad x) { return x * x; }
quad cube(quad x) { return x * x * x; }

/// Half a unit in the last place of one word and of two, relative.
template <typename U>
constexpr double one_word = sizeof(U) == 4 ? 0x1p-24 : 0x1p-53;
template <typename U>
constexpr double two_words = one_word<U>* one_word<U>;

template <typename U>
void expect_reciprocals(const U* words, int sign) {
  for (std::size_t i = 0; i < 32; ++i)
    EXPECT_LE(size(value_of(words[i]) * middle(i) - sign), one_word<U>) << i;
}

/// Pairs whose power `left` is the power `right` of the row's middle.
template <typename U>
void expect_pairs(const U* words, quad (*left)(quad), quad (*right)(quad), double factor) {
  for (std::size_t row = 0; row < 96; ++row) {
    const quad exact = right(middle_of_row(row));
    const quad high = value_of(words[2 * row]);
    const quad both = high + value_of(words[2 * row + 1]);
    EXPECT_LE(size(left(high) / exact - 1), factor * one_word<U>) << row;
    EXPECT_LE(size(left(both) / exact - 1), factor * two_words<U>) << row;
  }
}

/// The coefficients of (1 + g)^power, highest first.
void expect_series(const std::uint64_t* words, quad power, int degree) {
  quad c = 1;
  for (int j = 1; j <= degree; ++j) {
    c = c * (power - (j - 1)) / j;
    EXPECT_LE(size(value_of(words[degree - j]) / c - 1), 1.01 * 0x1p-53) << j;
  }
}

TEST(PowTables, Pow2o3Float) {
  ASSERT_EQ(std::size(scalar::_arrsPow2o3HATab), 230u);
  expect_reciprocals(scalar::_arrsPow2o3HATab + 4, 1);
  expect_pairs(scalar::_arrsPow2o3HATab + 0x24, cube, square, 3.01);
  ASSERT_EQ(std::size(scalar::internal_spow2o3_la_data), 3u);
  for (std::size_t k = 0; k < 3; ++k) {
    const quad root = value_of(scalar::internal_spow2o3_la_data[k]);
    EXPECT_LE(size(cube(root) / (1 << 2 * k) - 1), 3.01 * 0x1p-24);
  }
}

TEST(PowTables, Pow2o3Double) {
  const auto& singles = scalar::internal_dpow2o3_la_data;
  const auto& pairs = scalar::internal_dpow2o3_ha_data;
  ASSERT_EQ(std::size(singles), 32u + 96u);
  ASSERT_EQ(std::size(pairs), 32u + 192u);
  expect_reciprocals(singles, -1);
  expect_reciprocals(pairs, -1);
  expect_pairs(pairs + 32, cube, square, 3.01);
  for (std::size_t row = 0; row < 96; ++row) EXPECT_EQ(singles[32 + row], pairs[32 + 2 * row]);
  ASSERT_EQ(std::size(scalar::internal_dpow2o3_ha_series), 8u);
  expect_series(scalar::internal_dpow2o3_ha_series, quad(2) / 3, 8);
}

TEST(PowTables, Pow3o2) {
  ASSERT_EQ(std::size(scalar::_arrsPow3o2SHATab), 232u);
  expect_reciprocals(scalar::_arrsPow3o2SHATab + 5, -1);
  expect_pairs(scalar::_arrsPow3o2SHATab + 0x25, square, cube, 2.01);
  ASSERT_EQ(std::size(scalar::_arrsPow3o2HATab), 235u);
  expect_series(scalar::_arrsPow3o2HATab, quad(3) / 2, 8);
  expect_reciprocals(scalar::_arrsPow3o2HATab + 8, -1);
  expect_pairs(scalar::_arrsPow3o2HATab + 40, square, cube, 2.01);
}

}  // namespace
