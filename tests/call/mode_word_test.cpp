// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "call/mode_word.hpp"

#include <gtest/gtest.h>

#include <cstdint>
#include <random>
#include <string>

namespace {

using arbor::lumen::vm::detail::mode_word::in_force;
using arbor::lumen::vm::detail::mode_word::merge;

constexpr std::uint32_t fresh = 0x1811204;

/// A group of the word, the bits that make a stored value count, and what holds otherwise.
struct group_facts {
  const char* name;
  std::uint32_t mask;
  std::uint32_t lowest;
  std::uint32_t deciding;
  std::uint32_t fallback;
};

constexpr group_facts groups[] = {
    {"accuracy", 0xF, 0x1, 0xB, 0x4},
    {"status report", 0x300, 0x100, 0x100, 0x200},
    {"slice policy", 0x7000, 0x1000, 0x6000, 0x1000},
    {"bad argument", 0x30000, 0x10000, 0x20000, 0x10000},
    {"fallback", 0xF00000, 0x100000, 0x700000, 0x800000},
    {"reserved", 0x7000000, 0x1000000, 0x6000000, 0x1000000},
};
constexpr std::uint32_t all_groups = 0xF | 0x300 | 0x7000 | 0x30000 | 0xF00000 | 0x7000000;

/// Calls `visit(group, value)` for every value of every group, 0 included.
template <typename Visit>
void for_each_value(Visit visit) {
  for (const group_facts& group : groups) {
    for (std::uint32_t value = 0; value <= group.mask; value += group.lowest) visit(group, value);
  }
}

TEST(ModeWord, MergeReplacesNamedGroupsOnly) {
  for (const std::uint32_t base : {fresh, 0u, all_groups, 0x2222108u, 0xFFFFFFFFu}) {
    for_each_value([&](const group_facts& group, std::uint32_t value) {
      SCOPED_TRACE(std::string(group.name) + " " + std::to_string(value));
      const std::uint32_t expected = value == 0 ? base : (base & ~group.mask) + value;
      EXPECT_EQ(expected, merge(base, value));
    });
  }
}

TEST(ModeWord, MergeDoesNotOrValuesOfOneGroup) {
  EXPECT_EQ(0x181120Cu, merge(fresh, 12));
  EXPECT_EQ(0x1811204u, merge(0x181120F, 4));
  EXPECT_EQ(0x1821204u, merge(fresh, 0x20000));
  EXPECT_EQ(0x1411204u, merge(fresh, 0x400000));
}

TEST(ModeWord, MergeIgnoresBitsOfNoGroup) {
  EXPECT_EQ(fresh, merge(fresh, ~all_groups));
  EXPECT_EQ(0xF80C8CF0u, ~all_groups);
}

TEST(ModeWord, MergeOfAFullWordIsThatWord) {
  const std::uint32_t word = 0x4000000 | 0x400000 | 0x20000 | 0x4000 | 0x100 | 0xF;
  EXPECT_EQ(word, merge(fresh, word));
  EXPECT_EQ(word, merge(0, word));
}

TEST(ModeWord, InForceOfNothingIsTheDefault) { EXPECT_EQ(fresh, in_force(0)); }

TEST(ModeWord, InForceTakesAGroupByItsDecidingBits) {
  for_each_value([&](const group_facts& group, std::uint32_t value) {
    SCOPED_TRACE(std::string(group.name) + " " + std::to_string(value));
    const bool decided = (value & group.deciding) != 0;
    EXPECT_EQ((fresh & ~group.mask) + (decided ? value : group.fallback), in_force(value));
  });
}

// Values made of undecided bits alone are the defaults.
TEST(ModeWord, UndecidedValuesGiveTheDefault) {
  for (const std::uint32_t undecided : {0x4u, 0x200u, 0x1000u, 0x10000u, 0x800000u, 0x1000000u})
    EXPECT_EQ(fresh, in_force(undecided));
  // One deciding bit beside such a value keeps the whole group as it is.
  EXPECT_EQ(0x1811304u, in_force(0x300));
  EXPECT_EQ(0x1813204u, in_force(0x3000));
  EXPECT_EQ(0x1831204u, in_force(0x30000));
  EXPECT_EQ(0x1911204u, in_force(0x900000));
  EXPECT_EQ(0x3811204u, in_force(0x3000000));
  EXPECT_EQ(0x1811205u, in_force(0x5));
}

TEST(ModeWord, InForceDropsBitsOfNoGroup) {
  EXPECT_EQ(fresh, in_force(~all_groups));
  EXPECT_EQ(all_groups, in_force(0xFFFFFFFF));
}

// Every word that merging can store reads back as itself.
TEST(ModeWord, MergedWordsAreInForceAsTheyStand) {
  std::mt19937 random(20250611);
  std::uint32_t word = fresh;
  for (int i = 0; i < 100000; ++i) {
    word = merge(word, static_cast<std::uint32_t>(random()) & all_groups);
    ASSERT_EQ(word, in_force(word));
  }
}

}  // namespace
