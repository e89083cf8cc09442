// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "dispatch/table.hpp"

#include <gtest/gtest.h>

#include <cstdint>
#include <map>
#include <string>
#include <type_traits>
#include <utility>

#include "dispatch/catalogue.hpp"

namespace {

using namespace arbor::lumen::vm::detail;
using arbor::lumen::tests::catalogued_functions;
using arbor::lumen::tests::full_table;
using arbor::lumen::tests::rows_of;

static_assert(std::is_same_v<launcher, std::function<sycl::event(const input::vxx&, TuningInfo)>>);
// What a table gives out cannot be changed through it.
static_assert(std::is_same_v<decltype(std::declval<implementation_table&>().find(0)),
                             const implementation_table::entry*>);

int calls_of_first, calls_of_second;
sycl::event first(const input::vxx&, TuningInfo) {
  ++calls_of_first;
  return {};
}
sycl::event second(const input::vxx&, TuningInfo) {
  ++calls_of_second;
  return {};
}

TEST(Table, FindsRowsByTheirWholeKey) {
  const implementation_table table{{0x400000124, first, "a"}, {0x400000122, second, "b"}};
  ASSERT_NE(nullptr, table.find(0x400000124));
  ASSERT_NE(nullptr, table.find(0x400000122));
  EXPECT_STREQ("a", table.find(0x400000124)->implementation);
  EXPECT_STREQ("b", table.find(0x400000122)->implementation);
  for (const std::uint64_t absent :
       {0x0ull, 0x400000121ull, 0x800000124ull, 0x400000024ull, 0x400008014ull, 0x40000012Cull})
    EXPECT_EQ(nullptr, table.find(absent)) << std::hex << absent;
}

TEST(Table, RunsTheLauncherOfARow) {
  const implementation_table table{{0x400000124, first, "a"}, {0x400000122, second, "b"}};
  calls_of_first = calls_of_second = 0;
  const input::vxx record;
  table.find(0x400000122)->run(record, TuningInfo{1});
  EXPECT_EQ(0, calls_of_first);
  EXPECT_EQ(1, calls_of_second);
}

// Keys that differ by a multiple of the hash's modulus.
TEST(Table, TellsKeysOfOneHashApart) {
  constexpr std::uint64_t key = 0x400000124, same_hash = key + 997, far = key + 997 * 4096;
  const implementation_table table{{key, first, "a"}, {same_hash, second, "b"}, {far, first, "c"}};
  EXPECT_EQ(3u, table.size());
  EXPECT_STREQ("a", table.find(key)->implementation);
  EXPECT_STREQ("b", table.find(same_hash)->implementation);
  EXPECT_STREQ("c", table.find(far)->implementation);
  EXPECT_EQ(nullptr, table.find(key + 2 * 997));
}

TEST(Table, MayBeEmpty) {
  const implementation_table table{};
  EXPECT_EQ(0u, table.size());
  EXPECT_EQ(nullptr, table.find(0));
}

TEST(Table, HoldsEveryCataloguedRowAndNoOther) {
  for (const std::string& function : catalogued_functions()) {
    const implementation_table table = full_table(function);
    const auto rows = rows_of(function);
    EXPECT_LE(rows.size(), 32u) << function;
    EXPECT_EQ(rows.size(), table.size()) << function;
    std::map<std::uint64_t, int> visits;
    table.for_each([&](std::uint64_t key, const implementation_table::entry&) { ++visits[key]; });
    EXPECT_EQ(rows.size(), visits.size()) << function;
    for (const auto& row : rows) {
      EXPECT_EQ(1, visits[row.key()]) << row.functor();
      EXPECT_NE(nullptr, table.find(row.key())) << row.functor();
    }
  }
}

}  // namespace
