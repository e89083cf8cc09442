// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "dispatch/select_key.hpp"

#include <gtest/gtest.h>

#include <array>
#include <cstdint>
#include <map>
#include <set>
#include <string>
#include <vector>

#include "dispatch/catalogue.hpp"
#include "dispatch/key.hpp"
#include "dispatch/reference_choice.hpp"

namespace {

using namespace arbor::lumen::tests;
namespace key = arbor::lumen::vm::detail::key;
using arbor::lumen::vm::detail::implementation_table;
using arbor::lumen::vm::detail::kernel_candidates;
using arbor::lumen::vm::detail::select_key;
using keys = std::vector<std::uint64_t>;

constexpr std::uint64_t half = 0x100000000, single = 0x400000000, full = 0x800000000,
                        complex_single = 0x1000000000, complex_full = 0x1800000000;
constexpr std::uint64_t beryl = 0x8002000900000020;
constexpr std::uint64_t garnet = 0x8002000A00000002;
constexpr std::uint64_t foreign_gpu = 0x0002000900000020;
constexpr std::uint64_t gpu_without_double = 0x8002000500000020;
constexpr std::uint64_t cpu = 0x0001000000000000;
constexpr std::uint64_t accelerator = 0x0004000000000000;

constexpr std::uint32_t default_mode = 0x1811204;
constexpr std::uint32_t relaxed = 0x800000, host = 0x100000, missing_throws = 0x400000;
constexpr std::uint32_t ha = 4, la = 12, ep = 15;
constexpr std::uint32_t normal = 0x1000, cyclic = 0x4000;

TEST(AccuracyLadder, GoesFromTheRoughestUp) {
  ASSERT_EQ(3, key::accuracy_steps);
  EXPECT_EQ(15u, key::accuracy_ladder[0].mode);
  EXPECT_EQ(1u, key::accuracy_ladder[0].code);
  EXPECT_EQ(12u, key::accuracy_ladder[1].mode);
  EXPECT_EQ(2u, key::accuracy_ladder[1].code);
  EXPECT_EQ(4u, key::accuracy_ladder[2].mode);
  EXPECT_EQ(4u, key::accuracy_ladder[2].code);
}

TEST(AccuracyLadder, StartsAtHighAccuracyUnlessToldOtherwise) {
  for (std::uint32_t nibble = 0; nibble < 16; ++nibble) {
    const int expected = nibble == 15 ? 0 : nibble == 12 ? 1 : 2;
    EXPECT_EQ(expected, key::ladder_start(nibble)) << nibble;
    EXPECT_EQ(expected, key::ladder_start(0xFFFFFFF0 | nibble)) << nibble;
  }
}

keys candidates(std::uint64_t precision, std::uint64_t device, std::uint32_t mode) {
  const auto list = kernel_candidates(precision, device, mode);
  return keys(list.begin(), list.end());
}

TEST(Candidates, OnAGpuWithDouble) {
  for (const std::uint64_t device : {beryl, garnet, foreign_gpu}) {
    for (const std::uint32_t policy : {0u, normal, 0x2000u, cyclic}) {
      for (const std::uint64_t p : {single, full, complex_single, complex_full})
        EXPECT_EQ((keys{p + 0x420, p + 0x120, p + 0x820}), candidates(p, device, policy));
      EXPECT_EQ(
          (keys{0x100000420, 0x100000120, 0x100000820, 0x100001420, 0x100001120, 0x100001820}),
          candidates(half, device, policy));
    }
  }
}

TEST(Candidates, OnAGpuWithoutDoubleAreNone) {
  for (const std::uint64_t p : {half, single, full, complex_single, complex_full}) {
    for (const std::uint32_t policy : {normal, cyclic})
      EXPECT_TRUE(candidates(p, gpu_without_double, policy).empty());
  }
}

TEST(Candidates, OnACpuAreThoseOfHalfAndOfCyclicSlices) {
  for (const std::uint32_t policy : {0u, normal, 0x2000u, 0x3000u, 0x5000u, 0x6000u, 0x7000u}) {
    for (const std::uint64_t p : {single, full, complex_single, complex_full})
      EXPECT_TRUE(candidates(p, cpu, policy).empty());
    EXPECT_EQ((keys{0x100001420, 0x100001120, 0x100001820}), candidates(half, cpu, policy));
  }
  for (const std::uint64_t p : {single, full, complex_single, complex_full})
    EXPECT_EQ((keys{p + 0x120, p + 0x820}), candidates(p, cpu, cyclic));
  EXPECT_EQ((keys{0x100000120, 0x100000820, 0x100001420, 0x100001120, 0x100001820}),
            candidates(half, cpu, cyclic));
}

TEST(Candidates, OnAnAcceleratorAreNone) {
  for (const std::uint64_t p : {half, single, full, complex_single, complex_full}) {
    EXPECT_TRUE(candidates(p, accelerator, normal).empty());
    EXPECT_TRUE(candidates(p, accelerator, cyclic).empty());
  }
}

std::uint64_t chosen(const std::string& function, std::uint64_t precision, std::uint64_t device,
                     std::uint32_t mode) {
  return select_key(precision, device, mode, full_table(function));
}

TEST(SelectKey, TakesHostRowsForAGpuWithoutDouble) {
  for (const std::string& function : catalogued_functions()) {
    const implementation_table table = full_table(function);
    for (const std::uint64_t p : {single, full, complex_single, complex_full}) {
      const bool served = table.find(p + 0x8014) != nullptr;
      EXPECT_EQ(served ? p + 0x8014 : 0, select_key(p, gpu_without_double, default_mode, table))
          << function;
    }
    EXPECT_EQ(0u, select_key(half, gpu_without_double, default_mode, table)) << function;
  }
}

TEST(SelectKey, TakesFloatKernelsForHalfWithoutAKernelOfItsOwn) {
  EXPECT_EQ(0x100001124u, chosen("abs", half, beryl, default_mode));
  EXPECT_EQ(0x100001122u, chosen("abs", half, beryl, la));
  EXPECT_EQ(0x100001121u, chosen("abs", half, beryl, ep));
  EXPECT_EQ(0x100001821u, chosen("tgamma", half, garnet, ep));
}

TEST(SelectKey, TakesHalfKernelsFirst) {
  EXPECT_EQ(0x100000124u, chosen("sin", half, beryl, default_mode));
}

TEST(SelectKey, TakesTheVariantThatHasTheAccuracy) {
  EXPECT_EQ(0x400000824u, chosen("cos", single, beryl, default_mode));
  EXPECT_EQ(0x400000122u, chosen("cos", single, beryl, la));
  EXPECT_EQ(0x1800000424u, chosen("exp", complex_full, beryl, default_mode));
}

TEST(SelectKey, PrefersKernelsWithoutTables) {
  EXPECT_EQ(0x800000424u, chosen("log1p", full, beryl, default_mode));
  EXPECT_EQ(0x800000422u, chosen("log1p", full, beryl, la));
}

TEST(SelectKey, GoesDownTheLadderOnAGpuThatMay) {
  EXPECT_EQ(0x800000122u, chosen("tgamma", full, beryl, default_mode));
  EXPECT_EQ(0u, chosen("tgamma", full, beryl, default_mode & ~relaxed));
  EXPECT_EQ(0x800008014u, chosen("tgamma", full, beryl, (default_mode & ~relaxed) | host));
  EXPECT_EQ(0x400000121u, chosen("j0", single, beryl, default_mode));
  EXPECT_EQ(0x400008014u, chosen("j0", single, cpu, default_mode));
}

TEST(SelectKey, GoesUpTheLadderWithoutLeave) {
  EXPECT_EQ(0x400000122u, chosen("atan2pi", single, beryl, la));
  EXPECT_EQ(0x800000422u, chosen("atan", full, beryl, la));
  // ln of complex double has gen rows for ep and la, and a nolut one for ha.
  EXPECT_EQ(0x1800000121u, chosen("ln", complex_full, beryl, ep));
  const implementation_table ha_only{{0x400000124, nullptr, "ha"}};
  EXPECT_EQ(0x400000124u, select_key(single, beryl, ep, ha_only));
  EXPECT_EQ(0x400000124u, select_key(single, beryl, la, ha_only));
  const implementation_table la_and_ha{{0x400000122, nullptr, "la"}, {0x400000424, nullptr, "ha"}};
  EXPECT_EQ(0x400000122u, select_key(single, beryl, ep, la_and_ha));
}

// Accuracy is the outer loop.
TEST(SelectKey, TriesAllVariantsAtOneAccuracyFirst) {
  const implementation_table table{{0x400000821, nullptr, ""}, {0x400000422, nullptr, ""}};
  EXPECT_EQ(0x400000821u, select_key(single, beryl, ep, table));
  EXPECT_EQ(0x400000422u, select_key(single, beryl, la, table));
  // On the way down too: la before ep, whatever their variants.
  EXPECT_EQ(0x400000422u, select_key(single, beryl, ha | relaxed, table));
  EXPECT_EQ(0u, select_key(single, beryl, ha, table));
}

TEST(SelectKey, GoesDownBeforeItGoesToTheHost) {
  const implementation_table table{{0x400000121, nullptr, ""}, {0x400008014, nullptr, ""}};
  EXPECT_EQ(0x400000121u, select_key(single, beryl, ha | relaxed, table));
  EXPECT_EQ(0x400000121u, select_key(single, beryl, ha | relaxed | host, table));
  EXPECT_EQ(0x400008014u, select_key(single, beryl, ha | host, table));
  EXPECT_EQ(0u, select_key(single, beryl, ha, table));
}

TEST(SelectKey, NeverGoesDownOnTheHost) {
  const implementation_table table{{0x400008011, nullptr, ""}, {0x400000121, nullptr, ""}};
  for (const std::uint64_t device : {cpu, accelerator, gpu_without_double}) {
    EXPECT_EQ(0u, select_key(single, device, ha | relaxed | host | cyclic, table));
    EXPECT_EQ(0u, select_key(single, device, la | relaxed | host, table));
  }
  EXPECT_EQ(0x400008011u, select_key(single, accelerator, ep | host, table));
}

TEST(SelectKey, NeverTakesRowsMadeForDevicesWithoutDouble) {
  const implementation_table table{{0x400000224, nullptr, ""}, {0x100001224, nullptr, ""}};
  for (const std::uint64_t device : {beryl, garnet, gpu_without_double, cpu, accelerator}) {
    for (const std::uint64_t p : {half, single}) {
      EXPECT_EQ(0u, select_key(p, device, ha | relaxed | host, table));
      EXPECT_EQ(0u, select_key(p, device, ep | relaxed | host | cyclic, table));
    }
  }
}

TEST(SelectKey, ServesHostOnlyFunctionsOnTheHost) {
  for (const char* function : {"linearfrac", "expint1"}) {
    for (const std::uint64_t device : {beryl, garnet, gpu_without_double, cpu, accelerator}) {
      EXPECT_EQ(0x400008014u, chosen(function, single, device, default_mode));
      EXPECT_EQ(0x800008011u, chosen(function, full, device, ep | host));
      EXPECT_EQ(0u, chosen(function, single, device, ha));
      EXPECT_EQ(0u, chosen(function, half, device, default_mode));
    }
  }
}

TEST(SelectKey, RunsACpuOnTheHostUnlessSlicesAreCyclic) {
  EXPECT_EQ(0x400008011u, chosen("exp", single, cpu, ep | normal | relaxed));
  EXPECT_EQ(0x400000121u, chosen("exp", single, cpu, ep | cyclic | relaxed));
  EXPECT_EQ(0x400000121u, chosen("exp", single, cpu, ep | cyclic));
  EXPECT_EQ(0u, chosen("exp", single, cpu, ep | normal));
}

TEST(SelectKey, ServesHalfOnACpuWithoutTheHost) {
  EXPECT_EQ(0x100001124u, chosen("abs", half, cpu, ha | normal));
  EXPECT_EQ(0x100001124u, chosen("abs", half, cpu, default_mode));
  // Plain half kernels are candidates of a CPU for cyclic slices only.
  EXPECT_EQ(0u, chosen("sin", half, cpu, default_mode));
  EXPECT_EQ(0x100000124u, chosen("sin", half, cpu, ha | cyclic));
}

TEST(SelectKey, TreatsAnAcceleratorAsACpuWithoutKernels) {
  EXPECT_EQ(0x400008014u, chosen("exp", single, accelerator, default_mode));
  EXPECT_EQ(0x400008014u, chosen("exp", single, accelerator, ha | cyclic | relaxed));
  EXPECT_EQ(0u, chosen("exp", single, accelerator, ha | cyclic));
  EXPECT_EQ(0u, chosen("abs", half, accelerator, default_mode));
}

// `mode_missing_throws` says what an unserved call does, not which calls are served.
TEST(SelectKey, ServesByTheFallbackBitsAlone) {
  EXPECT_EQ(0u, chosen("sin", single, gpu_without_double, ha | missing_throws));
  EXPECT_EQ(0x400000124u, chosen("abs", single, beryl, ha | missing_throws));
}

TEST(SelectKey, FindsNothingInAnEmptyTable) {
  const implementation_table empty{};
  for (const std::uint64_t device : {beryl, gpu_without_double, cpu, accelerator})
    EXPECT_EQ(0u, select_key(single, device, default_mode, empty));
}

TEST(SelectKey, FindsNothingForAnUnknownPrecision) {
  EXPECT_EQ(0u, chosen("exp", 0xff00000000, beryl, default_mode));
  EXPECT_EQ(0u, chosen("exp", 0xff00000000, cpu, default_mode));
}

struct known_device {
  std::uint64_t word;
  device_class is;
};
constexpr known_device known_devices[] = {
    {beryl, device_class::gpu_with_double},
    {garnet, device_class::gpu_with_double},
    {foreign_gpu, device_class::gpu_with_double},
    {gpu_without_double, device_class::gpu_without_double},
    {0x0002000600000002, device_class::gpu_without_double},
    {cpu, device_class::cpu},
    {0x8001000000000000, device_class::cpu},
    {accelerator, device_class::accelerator},
};

/// The expected keys of one function at one type on one device, by [tier][cyclic][relaxed][host].
using expected_keys = std::array<std::uint64_t, 24>;

std::size_t slot(std::size_t tier, bool is_cyclic, bool is_relaxed, bool has_host) {
  return ((tier * 2 + is_cyclic) * 2 + is_relaxed) * 2 + has_host;
}

expected_keys expectations(const reference_choice& choice, char type, device_class device) {
  static constexpr const char* tiers[] = {"ep", "la", "ha"};
  expected_keys expected{};
  for (std::size_t tier = 0; tier < 3; ++tier) {
    for (const bool is_cyclic : {false, true}) {
      for (const bool is_relaxed : {false, true}) {
        for (const bool has_host : {false, true}) {
          const auto row = choice({type, tiers[tier], device, is_cyclic, is_relaxed, has_host});
          expected[slot(tier, is_cyclic, is_relaxed, has_host)] = row ? row->key() : 0;
        }
      }
    }
  }
  return expected;
}

// Every function, type, device, accuracy nibble, slice policy and fallback, on tables with all the
// rows of the catalogue.
TEST(SelectKey, AgreesWithTheReferenceEverywhere) {
  const std::map<char, std::uint64_t> precisions{
      {'h', half}, {'s', single}, {'d', full}, {'c', complex_single}, {'z', complex_full}};
  std::size_t compared = 0, served = 0;
  for (const std::string& function : catalogued_functions()) {
    const implementation_table table = full_table(function);
    ASSERT_EQ(rows_of(function).size(), table.size()) << function;
    const reference_choice choice(rows_of(function));
    for (const auto& [type, precision] : precisions) {
      for (const known_device& device : known_devices) {
        const expected_keys expected = expectations(choice, type, device.is);
        for (std::uint32_t nibble = 0; nibble < 16; ++nibble) {
          const std::size_t tier = nibble == ep ? 0 : nibble == la ? 1 : 2;
          for (std::uint32_t policy = 0; policy < 8; ++policy) {
            for (std::uint32_t fallback = 0; fallback < 16; ++fallback) {
              const std::uint32_t mode = nibble | policy << 12 | fallback << 20 | 0x10200;
              const std::uint64_t key = select_key(precision, device.word, mode, table);
              ASSERT_EQ(expected[slot(tier, policy == 4, fallback >= 8, fallback % 2 == 1)], key)
                  << function << " " << type << ", device " << std::hex << device.word << ", mode "
                  << mode;
              ++compared;
              served += key != 0;
            }
          }
        }
      }
    }
  }
  EXPECT_EQ(91u * 5 * 8 * 16 * 8 * 16, compared);
  EXPECT_GT(served, compared / 4);
}

// The rows that no device reaches are those made for devices without double.
TEST(SelectKey, ReachesHostAndGeneralRowsButNoneWithoutDouble) {
  for (const std::string& function : catalogued_functions()) {
    const implementation_table table = full_table(function);
    std::set<std::uint64_t> reached;
    for (const std::uint64_t p : {half, single, full, complex_single, complex_full}) {
      for (const known_device& device : known_devices) {
        for (const std::uint32_t tier : {ha, la, ep}) {
          for (const std::uint32_t policy : {normal, cyclic})
            reached.insert(select_key(p, device.word, tier | policy | host, table));
        }
      }
    }
    for (const catalogued_row& row : rows_of(function)) {
      const bool expected = row.feature == "classic" || row.feature == "gen";
      if (!expected && row.feature != "nofp64") continue;
      EXPECT_EQ(expected, reached.contains(row.key())) << row.functor();
    }
  }
}

}  // namespace
