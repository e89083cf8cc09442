// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The instrument itself: errors that are known beforehand.

#include "ulp_error.hpp"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>

#include "functor.hpp"
#include "measurement.hpp"
#include "reference.hpp"

namespace arbor::lumen::accuracy {
namespace {

double error(const number_format& format, double result, const char* exact) {
  mpfr_t x;
  mpfr_init2(x, 200);
  mpfr_set_str(x, exact, 0, MPFR_RNDN);
  ulp_error error_of(format);
  const double e = error_of(result, x);
  mpfr_clear(x);
  return e;
}

TEST(UlpError, CountsUnitsOfTheExactValuesBinade) {
  EXPECT_EQ(error(float_format, 1.0, "1"), 0);
  EXPECT_EQ(error(float_format, 1.0 + 0x1p-23, "1"), 1);
  EXPECT_EQ(error(float_format, 1.0 - 0x1p-24, "1"), -0.5);
  EXPECT_EQ(error(double_format, 1.5, "0x1.80000000000008p0"), -0.5);
  EXPECT_EQ(error(half_format, -2.0, "-0x1.ffcp0"), -1);
}

TEST(UlpError, CountsDenormalsInTheirUnit) {
  EXPECT_EQ(error(float_format, 0x1p-149, "0x1p-150"), 0.5);
  EXPECT_EQ(error(double_format, 0.0, "0x1p-1075"), -0.5);
  EXPECT_EQ(error(half_format, 0x3p-24, "0x1p-24"), 2);
  EXPECT_EQ(error(half_format, 0.0, "0"), 0);
}

TEST(UlpError, TreatsInfinityAsTheNextPowerOfTwo) {
  const double inf = std::numeric_limits<double>::infinity();
  EXPECT_EQ(error(float_format, inf, "0x1.fffffep127"), 1);
  EXPECT_EQ(error(float_format, inf, "0x1.ffffffp127"), 0);  // halfway: rounds to infinity
  EXPECT_EQ(error(float_format, 0x1.fffffep127, "0x1p129"), -1);
  EXPECT_EQ(error(float_format, -inf, "0x1p200"), -0x1p25);
  EXPECT_EQ(error(double_format, inf, "inf"), 0);
  EXPECT_EQ(error(double_format, -inf, "-inf"), 0);
}

TEST(UlpError, DemandsNaNWhereTheExactValueIsOne) {
  const double nan = std::numeric_limits<double>::quiet_NaN();
  EXPECT_EQ(error(float_format, nan, "nan"), 0);
  EXPECT_TRUE(std::isinf(error(float_format, nan, "1")));
  EXPECT_TRUE(std::isinf(error(float_format, 1.0, "nan")));
}

TEST(NumberFormat, RanksAllHalvesInOrder) {
  for (std::int64_t rank = half_format.rank(0xfc00); rank < half_format.rank(0x7c00); ++rank) {
    EXPECT_LE(half_format.value(half_format.at_rank(rank)),
              half_format.value(half_format.at_rank(rank + 1)));
    EXPECT_EQ(half_format.rank(half_format.at_rank(rank)), rank);
  }
}

/// A subject that is wrong by a known amount at one argument.
TEST(Measurement, FindsTheWorstArgument) {
  const reference* r = find_reference("exp");
  ASSERT_NE(r, nullptr);
  const subject wrong{"wrong", &float_format, 1, 1,
                      [](const void* const* in, void* const* out, std::size_t n) {
                        for (std::size_t i = 0; i < n; ++i) {
                          const float x = static_cast<const float*>(in[0])[i];
                          const auto y = static_cast<float>(std::exp(static_cast<double>(x)));
                          static_cast<float*>(out[0])[i] = x == 1.5f ? y + 0x64p-21f : y;
                        }
                      }};
  sampling samples;
  samples.ranges = {{1.49, 1.51}};
  samples.step = 1;
  const measurement m = measure({&wrong, 1}, *r, samples).front();
  EXPECT_NEAR(m.largest, 100, 0.5);
  EXPECT_EQ(m.worst_argument[0], 0x3fc00000u);
  EXPECT_LT(m.mean(), 0.5);
  EXPECT_EQ(m.count, float_format.pattern(1.51) - float_format.pattern(1.49) + 1);
}

}  // namespace
}  // namespace arbor::lumen::accuracy
