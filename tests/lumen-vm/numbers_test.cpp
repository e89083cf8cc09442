// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "numbers.hpp"

#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <limits>
#include <random>

#include "words.hpp"

namespace {

using arbor::lumen::vm::tool::bad_number;
using arbor::lumen::vm::tool::parse_real;
using arbor::lumen::vm::tool::status_words;
using arbor::lumen::vm::tool::text_width;
using arbor::lumen::vm::tool::to_bits;
using arbor::lumen::vm::tool::to_text;

std::uint16_t half_bits(const std::string& text) {
  return sycl::bit_cast<std::uint16_t>(parse_real<sycl::half>(text));
}

TEST(ParseReal, ReadsDecimalAndHexadecimal) {
  EXPECT_EQ(parse_real<float>("0.1"), 0.1F);
  EXPECT_EQ(parse_real<double>("0.1"), 0.1);
  EXPECT_EQ(parse_real<double>("-0x1.8p-3"), -0.1875);
  EXPECT_EQ(parse_real<float>("+2e-45"), std::numeric_limits<float>::denorm_min());
  EXPECT_TRUE(std::signbit(parse_real<float>("-0")));
}

TEST(ParseReal, ReadsInfinitiesAndNans) {
  EXPECT_EQ(parse_real<float>("inf"), std::numeric_limits<float>::infinity());
  EXPECT_EQ(parse_real<double>("-Infinity"), -std::numeric_limits<double>::infinity());
  EXPECT_EQ(half_bits("-inf"), 0xFC00);
  EXPECT_TRUE(std::isnan(parse_real<double>("nan")));
  EXPECT_TRUE(std::isnan(static_cast<float>(parse_real<sycl::half>("NaN"))));
}

TEST(ParseReal, RejectsWhatIsNoNumber) {
  for (const char* text : {"", "x", "1x", "1,5", "0x", "--1", "1 2", "e5", "infin"}) {
    EXPECT_THROW(parse_real<float>(text), bad_number) << text;
    EXPECT_THROW(parse_real<double>(text), bad_number) << text;
    EXPECT_THROW(parse_real<sycl::half>(text), bad_number) << text;
  }
}

TEST(ParseReal, RejectsFiniteNumbersBeyondTheRange) {
  EXPECT_THROW(parse_real<float>("1e39"), bad_number);
  EXPECT_THROW(parse_real<double>("-1e309"), bad_number);
  EXPECT_THROW(parse_real<sycl::half>("65520"), bad_number);
  EXPECT_THROW(parse_real<sycl::half>("1e39"), bad_number);
  EXPECT_EQ(half_bits("65519.999999999999999999999"), 0x7BFF);
  EXPECT_EQ(parse_real<float>("1e-60"), 0.0F);
}

TEST(ParseReal, RoundsOnceAtHalf) {
  // 1 + 2^-11 is the midpoint of 1 and the next half; the third digit group tells the side only
  // beyond the precision of float.
  EXPECT_EQ(half_bits("1.00048828125"), 0x3C00);
  EXPECT_EQ(half_bits("1.00048828125000000000000000001"), 0x3C01);
  EXPECT_EQ(half_bits("1.00048828124999999999999999999"), 0x3C00);
  EXPECT_EQ(half_bits("-1.00048828125000000000000000001"), 0xBC01);
  EXPECT_EQ(half_bits("0x1p-25"), 0x0000);
  EXPECT_EQ(half_bits("0x1.00000000000000001p-25"), 0x0001);
}

TEST(ToText, RestoresEveryHalf) {
  for (std::uint32_t pattern = 0; pattern < 0x10000; ++pattern) {
    const auto value = sycl::bit_cast<sycl::half>(static_cast<std::uint16_t>(pattern));
    const std::string text = to_text(value);
    ASSERT_LE(text.size(), static_cast<std::size_t>(text_width<sycl::half>)) << text;
    if (!std::isnan(static_cast<float>(value))) {
      ASSERT_EQ(half_bits(text), pattern) << text;
    }
  }
}

template <typename R, typename Pattern>
void expect_restored_at_random() {
  std::mt19937_64 random(7);
  for (int i = 0; i < 200000; ++i) {
    const auto value = sycl::bit_cast<R>(static_cast<Pattern>(random()));
    if (!std::isfinite(value)) continue;
    const std::string text = to_text(value);
    ASSERT_LE(text.size(), static_cast<std::size_t>(text_width<R>)) << text;
    ASSERT_EQ(sycl::bit_cast<Pattern>(parse_real<R>(text)), sycl::bit_cast<Pattern>(value)) << text;
  }
}

TEST(ToText, RestoresFloats) { expect_restored_at_random<float, std::uint32_t>(); }
TEST(ToText, RestoresDoubles) { expect_restored_at_random<double, std::uint64_t>(); }

TEST(ToText, IsShortest) {
  EXPECT_EQ(to_text(0.1F), "0.1");
  EXPECT_EQ(to_text(0.1), "0.1");
  EXPECT_EQ(to_text(sycl::half(0.1F)), "0.1");
  EXPECT_EQ(to_text(-0.0), "-0");
  EXPECT_EQ(to_text(std::numeric_limits<double>::infinity()), "inf");
}

TEST(ToBits, HasAllDigits) {
  EXPECT_EQ(to_bits(sycl::half(1.0F)), "0x3c00");
  EXPECT_EQ(to_bits(0.0F), "0x00000000");
  EXPECT_EQ(to_bits(-2.0), "0xc000000000000000");
}

TEST(StatusWords, NamesEveryBit) {
  EXPECT_EQ(status_words(0), "success");
  EXPECT_EQ(status_words(1), "errdom");
  EXPECT_EQ(status_words(2 | 4), "sing|overflow");
  EXPECT_EQ(status_words(8 | 128 | 256), "underflow|accuracy_warning|bad_argument");
  EXPECT_EQ(status_words(8 | 0x400), "underflow|0x400");
}

}  // namespace
