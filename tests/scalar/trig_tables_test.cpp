// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The tables of the trigonometric functions: known rows to the bit, and every row against its
/// rule.

#include <algorithm>
#include <initializer_list>
#include <iterator>
#include <type_traits>

#include "scalar/tables/dsin.hpp"
#include "scalar/tables/dtan.hpp"
#include "scalar/tables/ssin.hpp"
#include "scalar/tables/stan.hpp"
#include "trig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

template <typename U, std::size_t N>
void expect_words(const U (&table)[N], std::size_t first,
                  std::initializer_list<std::type_identity_t<U>> words) {
  for (const U word : words) {
    ASSERT_LT(first, N);
    EXPECT_EQ(table[first], word) << std::hex << "word " << first;
    ++first;
  }
}

double of(std::uint64_t pattern) { return std::bit_cast<double>(pattern); }
double of(std::uint32_t pattern) { return std::bit_cast<float>(pattern); }

constexpr std::uint32_t inverse_turn[] = {0x28be60db, 0x9391054a, 0x7f09d5f4, 0x7d4d3770,
                                          0x36d8a566, 0x4f10e410, 0x7f9458ea, 0xf7aef158};

TEST(TrigTables, DigitsOfTheInverseTurn) {
  expect_words(scalar::__dsin_ha_InvPi_tbl, 0, {0u, 0u});
  ASSERT_EQ(std::size(scalar::__dsin_ha_InvPi_tbl), 44u);
  EXPECT_TRUE(std::equal(std::begin(inverse_turn), std::end(inverse_turn),
                         scalar::__dsin_ha_InvPi_tbl + 2));
  expect_words(scalar::__ssin_ha_invpi_tbl, 0, {0u});
  ASSERT_EQ(std::size(scalar::__ssin_ha_invpi_tbl), 8u);
  EXPECT_TRUE(std::equal(std::begin(inverse_turn), std::begin(inverse_turn) + 7,
                         scalar::__ssin_ha_invpi_tbl + 1));
}

/// Each row is the one before shifted by a digit, which is the next of the words of 1/(2 pi).
TEST(TrigTables, RowsOfTheInverseTurn) {
  const auto& rows = scalar::internal_dsin_la_reduction_data;
  ASSERT_EQ(std::size(rows), 3u * 2048);
  expect_words(rows, 3 * 1075, {0x28be60db9391054au, 0x7f09d5f47d4d3770u, 0x36d8a5664f10e410u});
  EXPECT_EQ(std::count(rows, rows + 3 * 886, 0u), 3 * 886);
  EXPECT_EQ(rows[3 * 886 + 2], 1u);
  for (std::size_t e = 1; e < 2048; ++e) {
    for (std::size_t word = 0; word < 3; ++word) {
      const std::uint64_t above = rows[3 * (e - 1) + word];
      const std::uint64_t carried =
          word < 2 ? rows[3 * (e - 1) + word + 1] >> 63 : rows[3 * e + 2] & 1;
      ASSERT_EQ(rows[3 * e + word], (above << 1) | carried) << e;
    }
    // The last digit of row e is the digit at 2^-(e - 883).
    const std::size_t digit = e - 884;
    if (e >= 884 && digit < 42 * 32) {
      const std::uint32_t word = scalar::__dsin_ha_InvPi_tbl[2 + digit / 32];
      ASSERT_EQ(rows[3 * e + 2] & 1, (word >> (31 - digit % 32)) & 1) << e;
    }
  }
  const auto& floats = scalar::internal_stan_la_reduction_data;
  ASSERT_EQ(std::size(floats), 3u * 256);
  expect_words(floats, 3 * 150, {0x28be60dbu, 0x9391054au, 0x7f09d5f4u});
  for (std::size_t e = 0; e < 255; ++e) {  // as a row of doubles with the same weight
    const std::size_t row = e - 150 + 1075;
    ASSERT_EQ(floats[3 * e], rows[3 * row] >> 32);
    ASSERT_EQ(floats[3 * e + 1], rows[3 * row] & 0xffffffff);
    ASSERT_EQ(floats[3 * e + 2], rows[3 * row + 1] >> 32);
  }
}

/// |a - (b + c)| for an exact value of high precision.
class rule {
 public:
  rule() { mpfr_inits2(300, angle_, value_, nullptr); }
  ~rule() { mpfr_clears(angle_, value_, nullptr); }
  rule(const rule&) = delete;
  rule& operator=(const rule&) = delete;

  /// f(pi a/b) less the parts, as a magnitude.
  template <typename... Parts>
  double error(trig f, long a, long b, Parts... parts) {
    mpfr_const_pi(angle_, MPFR_RNDN);
    mpfr_mul_si(angle_, angle_, a, MPFR_RNDN);
    mpfr_div_si(angle_, angle_, b, MPFR_RNDN);
    const auto function = f == trig::sine ? mpfr_sin : f == trig::cosine ? mpfr_cos : mpfr_tan;
    function(value_, angle_, MPFR_RNDN);
    (mpfr_sub_d(value_, value_, parts, MPFR_RNDN), ...);
    return std::fabs(mpfr_get_d(value_, MPFR_RNDN));
  }

 private:
  mpfr_t angle_;
  mpfr_t value_;
};

bool is_power_of_two_or_zero(double x) {
  return x == 0 || (std::bit_cast<std::uint64_t>(x) & 0x000fffffffffffff) == 0;
}

TEST(TrigTables, Rows512) {
  const auto& rows = scalar::internal_dsin_la_data_ha;
  ASSERT_EQ(std::size(rows), 4u * 512);
  expect_words(
      rows, 4 * 1,
      {0xbf13bd2c8da49511u, 0x3ff0000000000000u, 0x3f8921d1fcdec784u, 0x3c29878ea0000000u});
  expect_words(
      rows, 4 * 64,
      {0x3fca827999fcef32u, 0x3fe0000000000000u, 0x3fe6a09e667f3bcdu, 0xbc8bdd3400000000u});
  // Row 1 of the cosine is row 129 of the sine.
  expect_words(
      rows, 4 * 129,
      {0x3f6b78b80c84e1eeu, 0xbf90000000000000u, 0x3fefff62169b92dbu, 0x3c85dda3c0000000u});
  rule exact;
  for (int j = 0; j < 512; ++j) {
    const std::uint64_t* row = rows + 4 * j;
    EXPECT_LT(exact.error(trig::cosine, j, 256, of(row[0]), of(row[1])), 0x1p-54) << j;
    EXPECT_LT(exact.error(trig::sine, j, 256, of(row[2]), of(row[3])), 0x1p-76) << j;
    EXPECT_TRUE(is_power_of_two_or_zero(of(row[1]))) << j;
    EXPECT_EQ(row[3] & 0x1fffffff, 0u) << j;
  }
}

TEST(TrigTables, Rows64) {
  const auto& rows = scalar::__dsin_ep_CoutTab;
  ASSERT_EQ(std::size(rows), 4u * 64);
  expect_words(
      rows, 4 * 1,
      {0xbf73b92e176d6d31u, 0x3fb917a6bc29b42cu, 0xbc3e2718e0000000u, 0x3ff0000000000000u});
  rule exact;
  for (int j = 0; j < 64; ++j) {
    const std::uint64_t* row = rows + 4 * j;
    EXPECT_LT(exact.error(trig::cosine, j, 32, of(row[0]), of(row[3])), 0x1p-54) << j;
    EXPECT_LT(exact.error(trig::sine, j, 32, of(row[1]), of(row[2])), 0x1p-77) << j;
    EXPECT_TRUE(is_power_of_two_or_zero(of(row[3]))) << j;
  }
}

TEST(TrigTables, SlicesOfTheOctants) {
  const auto& table = scalar::__dsin_ep_ReductionTab;
  ASSERT_EQ(std::size(table), 70u);
  expect_words(table, 0,
               {0x0000000000000000u, 0xbff0000000000000u, 0x3ff0000000000000u, 0xbff0000000000000u,
                0x4198000000000000u, 0x41a0000000000000u, 0x3fe921fb40000000u, 0x3e64442d18469899u,
                0x3ff45f306dc9c883u, 0x40b0000000000000u, 0x3fe921fa00000000u, 0x3ea5444300000000u,
                0xbd373dca00000000u, 0xbbf3b39a00000000u, 0x3a845c06e0e68948u, 0x3fe921fb54000000u,
                0x3e010b4612000000u, 0xbc2676733c000000u, 0x3a61701b839a2520u});
  expect_words(
      table, 20,
      {0x4c745f3060000000u, 0x4aeb939100000000u, 0x494529fc20000000u, 0x47ad5f47c0000000u});
  // Slice i holds the digits of 1/(2 pi) from 25 i + 3 on, of weight 8.
  for (int i = 0; i < 50; ++i) {
    double slice = 0;
    for (int digit = 25 * i; digit < 25 * i + 25; ++digit) {
      const int place = digit + 2;  // of 1/(2 pi), behind the point
      if (place >= 42 * 32) continue;
      const std::uint32_t word = scalar::__dsin_ha_InvPi_tbl[2 + place / 32];
      slice = 2 * slice + ((word >> (31 - place % 32)) & 1);
    }
    if (25 * i + 27 <= 42 * 32) {
      EXPECT_EQ(of(table[20 + i]), std::ldexp(slice, 200 - 24 - 25 * i)) << i;
    }
  }
}

TEST(TrigTables, TangentsOfSixteenths) {
  const auto& table = scalar::internal_dtan_ha_data;
  expect_words(table, 6, {0x8000000000000000u});
  expect_words(table, 14, {0xffefffffffffffffu});
  expect_words(table, 30, {0xfca0000000000000u});
  rule exact;
  for (int k = 1; k < 16; ++k) {
    if (k == 8) continue;
    EXPECT_LT(exact.error(trig::tangent, k, 16, of(table[6 + k]), of(table[22 + k])), 0x1p-104)
        << k;
  }
}

TEST(TrigTables, TangentRows) {
  const auto& table = scalar::internal_stan_la_data;
  ASSERT_EQ(std::size(table), 10u * 128);
  expect_words(table, 640,
               {0u, 0u, 0x3f800000u, 0u, 0u, 0x3e800000u, 0x3daaaaabu, 0u, 0x3cb5e28bu, 0u});
  rule exact;
  for (int j = 0; j < 128; ++j) {
    const std::uint32_t* row = table + 10 * j;
    const bool near_pole = 32 <= j && j <= 95;
    EXPECT_EQ(of(row[2]), near_pole ? 1.0 : 0.0) << j;
    EXPECT_TRUE(is_power_of_two_or_zero(of(row[5]))) << j;
    // tan(t + r) at the ends and inside of the interval. The first term that is left out is at most
    // 2/15 (pi/256)^4 of the tangent.
    for (const int part : {-4, -3, -1, 1, 3, 4}) {
      const double r = part * 0.0030679615757712823;  // pi/1024
      const double distance = (of(row[0]) - r) + of(row[1]);
      const double pole = near_pole ? 1 / distance : 0.0;
      const double rest =
          of(row[3]) + of(row[4]) +
          r * (of(row[5]) + of(row[6]) + r * (of(row[7]) + r * (of(row[8]) + r * of(row[9]))));
      const double tangent = pole + rest;
      EXPECT_LT(exact.error(trig::tangent, 8 * j + part, 1024, pole, rest),
                3.1e-9 * std::max(std::fabs(tangent), 0.01))
          << j << " " << part;
    }
  }
}

}  // namespace
