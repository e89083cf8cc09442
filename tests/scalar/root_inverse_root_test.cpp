// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/inverse_root.hpp"

#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>

namespace {

using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::bits;
using scalar::value;

/// How many of the floats from one pattern to another have an inverse root that is not the bits of
/// the division.
std::uint32_t different_inverses(std::uint32_t first, std::uint32_t last) {
  std::uint32_t different = 0;
  for (std::uint32_t b = first; b <= last; ++b) {
    const float y = value(b), root = std::sqrt(y);
    different += bits(scalar::inverse_of_root(y, root)) != bits(1.0f / root);
  }
  return different;
}

/// How many of the floats have another root by steps from an estimate that is off by `error`.
std::uint32_t different_roots(std::uint32_t first, std::uint32_t last, double error) {
  std::uint32_t different = 0;
  for (std::uint32_t b = first; b <= last; ++b) {
    const float x = value(b);
    const auto estimate = static_cast<float>((1 + error) / std::sqrt(static_cast<double>(x)));
    different += bits(scalar::root_by_estimate(x, estimate)) != bits(std::sqrt(x));
  }
  return different;
}

// The steps scale with powers of 4, so that two binades stand for all.
TEST(InverseRoot, EveryFraction) { EXPECT_EQ(different_inverses(0x3f800000, 0x407fffff), 0u); }

TEST(InverseRoot, EndsOfTheRange) {
  EXPECT_EQ(different_inverses(0x00800000, 0x0080ffff), 0u);
  EXPECT_EQ(different_inverses(0x7f7f0000, 0x7f7fffff), 0u);
}

TEST(SlowInverseRoot, EveryNormalNumber) {
  EXPECT_EQ(different_inverses(0x00800000, 0x7f7fffff), 0u);
}

TEST(InverseRoot, ZeroHasAFiniteInverse) {
  using pair = scalar::root_and_inverse;
  for (const pair p : {pair::by_division(0.0f), pair::by_steps(0.0f)})
    EXPECT_TRUE(std::isfinite(p.inverse));
}

TEST(InverseRoot, BothWaysAgree) {
  using pair = scalar::root_and_inverse;
  for (std::uint32_t b = 0x0e000000; b < 0x3f800000; b += 4099) {  // from 2^-99
    const pair division = pair::by_division(value(b)), steps = pair::by_steps(value(b));
    ASSERT_EQ(bits(division.root), bits(steps.root)) << b;
    ASSERT_EQ(bits(division.inverse), bits(steps.inverse)) << b;
  }
}

TEST(RootByEstimate, EveryFractionFromBothEndsOfTheEstimates) {
  for (const double error : {-0x1p-14, 0.0, 0x1p-14}) {
    EXPECT_EQ(different_roots(0x3f800000, 0x407fffff, error), 0u) << error;
    EXPECT_EQ(different_roots(0x1f800000, 0x1f80ffff, error), 0u) << error;  // from 2^-64
    EXPECT_EQ(different_roots(0x7f7f0000, 0x7f7fffff, error), 0u) << error;
  }
}

// Or the test would not see an error of the steps.
TEST(RootByEstimate, CoarserEstimatesDoNotDo) {
  EXPECT_NE(different_roots(0x3f800000, 0x407fffff, 0x1p-9), 0u);
}

}  // namespace
