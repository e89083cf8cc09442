// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include <cstdint>
#include <string>

#include "device/tuning_info.hpp"
#include "dispatch/dispatch_call.hpp"

namespace {

using arbor::lumen::vm::detail::tuning_factor;
using arbor::lumen::vm::detail::TuningInfo;

static_assert(sizeof(TuningInfo) == 4);

struct factors {
  const char* device;
  std::uint64_t word;
  std::uint32_t half, single, full, complex_single, complex_full;
};

// Above 1 on two tiers of one vendor's GPUs that are not integrated.
constexpr factors of_kernels[] = {
    {"jasper", 0x8002000900000010, 1, 2, 1, 1, 1},
    {"jasper without double", 0x8002000500000010, 1, 2, 1, 1, 1},
    {"beryl", 0x8002000900000020, 4, 4, 2, 1, 1},
    {"beryl without double", 0x8002000500000020, 4, 4, 2, 1, 1},
    {"not integrated, though not marked discrete", 0x8002000800000020, 4, 4, 2, 1, 1},
    {"both tiers, the lower counts", 0x8002000900000030, 1, 2, 1, 1, 1},
    {"garnet", 0x8002000A00000002, 1, 1, 1, 1, 1},
    {"topaz", 0x8002000900000004, 1, 1, 1, 1, 1},
    {"onyx", 0x8002000900000008, 1, 1, 1, 1, 1},
    {"integrated jasper", 0x8002000A00000010, 1, 1, 1, 1, 1},
    {"integrated beryl", 0x8002000A00000020, 1, 1, 1, 1, 1},
    {"beryl of another vendor", 0x0002000900000020, 1, 1, 1, 1, 1},
    {"jasper of another vendor", 0x0002000900000010, 1, 1, 1, 1, 1},
    {"CPU", 0x8001000000000000, 1, 1, 1, 1, 1},
    {"none", 0, 1, 1, 1, 1, 1},
};

std::uint32_t factor(std::uint64_t word, std::uint64_t precision, std::uint64_t low_key) {
  return tuning_factor(word, "exp", precision, precision | low_key);
}

TEST(TuningFactor, DependsOnTierAndPrecision) {
  for (const factors& f : of_kernels) {
    SCOPED_TRACE(f.device);
    EXPECT_EQ(f.half, factor(f.word, 0x100000000, 0x124));
    EXPECT_EQ(f.single, factor(f.word, 0x400000000, 0x124));
    EXPECT_EQ(f.full, factor(f.word, 0x800000000, 0x124));
    EXPECT_EQ(f.complex_single, factor(f.word, 0x1000000000, 0x124));
    EXPECT_EQ(f.complex_full, factor(f.word, 0x1800000000, 0x124));
  }
}

TEST(TuningFactor, IsOneForHostRows) {
  for (const factors& f : of_kernels) {
    for (const std::uint64_t precision : {0x400000000u, 0x800000000u, 0x1000000000u, 0x1800000000u})
      EXPECT_EQ(1u, factor(f.word, precision, 0x8014)) << f.device;
  }
}

TEST(TuningFactor, DoesNotDependOnNameFeatureOrAccuracy) {
  constexpr std::uint64_t beryl = 0x8002000900000020;
  for (const std::uint64_t low_key : {0x121u, 0x422u, 0x824u, 0x1124u, 0x1821u})
    EXPECT_EQ(4u, factor(beryl, 0x100000000, low_key));
  for (const char* name : {"", "exp", "sin", "anything"})
    EXPECT_EQ(2u, tuning_factor(beryl, name, 0x800000000, 0x800000124));
}

}  // namespace
