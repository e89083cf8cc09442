// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "dispatch/families.hpp"

#include <gtest/gtest.h>

#include <atomic>
#include <cstdint>
#include <cstring>
#include <iostream>
#include <map>
#include <set>
#include <string>
#include <string_view>
#include <thread>
#include <vector>

#include "dispatch/catalogue.hpp"

namespace {

using namespace arbor::lumen::tests;
using arbor::lumen::vm::detail::families;
using arbor::lumen::vm::detail::family;
using arbor::lumen::vm::detail::implementation_table;
using arbor::lumen::vm::detail::utility_families;

// The internal utilities have families, overloads and rows of their own; they share the functors of
// their tiers and are not counted among these.
constexpr std::size_t public_families = 91;
constexpr std::size_t public_overloads = 1890;
constexpr std::size_t all_rows = 1797, utility_rows = 216;
constexpr std::size_t all_functors = 897;

TEST(Families, FirstCallFromManyThreadsBuildsEachTableOnce) {
  constexpr std::size_t threads_at_once = 8;
  std::vector<std::vector<const implementation_table*>> seen(threads_at_once);
  std::atomic<std::size_t> ready{0};
  std::vector<std::thread> threads;
  for (auto& tables : seen) {
    threads.emplace_back([&] {
      for (++ready; ready < threads_at_once;) std::this_thread::yield();
      for (const family& f : families()) tables.push_back(&f.table());
    });
  }
  for (std::thread& thread : threads) thread.join();
  for (const auto& tables : seen) EXPECT_EQ(seen.front(), tables);
  const std::set<const implementation_table*> distinct(seen.front().begin(), seen.front().end());
  EXPECT_EQ(public_families, distinct.size()) << "a table is shared between families";
}

TEST(Families, AreThoseOfTheCatalogue) {
  EXPECT_EQ(public_families, families().size());
  EXPECT_EQ(101u, families().size() + utility_families().size());
  std::vector<std::string> names;
  for (const family& f : families()) names.emplace_back(f.name);
  EXPECT_EQ(catalogued_functions(), names);
}

TEST(Families, HaveAllTheOverloads) {
  std::size_t overloads = 0;
  for (const family& f : families()) overloads += 6 * std::strlen(f.types);
  EXPECT_EQ(public_overloads, overloads);
  std::size_t sets = 0;
#define LUMEN_COUNT(function, shape, letter, input, output, handler) ++sets;
  LUMEN_OVERLOADS(LUMEN_COUNT)
#undef LUMEN_COUNT
  EXPECT_EQ(public_overloads, 6 * sets);
}

TEST(Families, StateTheirRows) {
  std::size_t rows = 0, functors = 0;
  for (const family& f : families()) {
    EXPECT_EQ(rows_of(f.name).size(), static_cast<std::size_t>(f.catalogued_rows)) << f.name;
    rows += static_cast<std::size_t>(f.catalogued_rows);
  }
  for (const catalogued_row& row : catalogued_rows()) functors += !row.on_host();
  EXPECT_EQ(all_rows - utility_rows, rows);
  for (const family& f : utility_families()) rows += static_cast<std::size_t>(f.catalogued_rows);
  EXPECT_EQ(all_rows, rows);
  EXPECT_EQ(all_functors, functors);
}

TEST(Families, TellTheirSignatures) {
  std::map<std::string, std::string> types;
#define LUMEN_TYPE(function, shape, letter, input, output, handler) types[#function] += #letter;
  LUMEN_OVERLOADS(LUMEN_TYPE)
#undef LUMEN_TYPE
  for (const family& f : families()) EXPECT_EQ(types[f.name], f.types) << f.name;
  const auto find = [](std::string_view name) {
    for (const family& f : families())
      if (f.name == name) return f;
    return family{};
  };
  EXPECT_STREQ("v61", find("linearfrac").shape);
  EXPECT_TRUE(find("linearfrac").handler);
  EXPECT_STREQ("v12", find("modf").shape);
  EXPECT_FALSE(find("modf").handler);
  EXPECT_STREQ("v21c", find("powx").shape);
  EXPECT_STREQ("hsdcz", find("powx").types);
  EXPECT_STREQ("sd", find("cis").types);
}

// A table may lack rows whose functor does not exist yet; it never holds one that the catalogue
// does not state, nor runs another functor in its place.
TEST(Families, HoldOnlyCataloguedRows) {
  for (const family& f : families()) {
    std::map<std::uint64_t, catalogued_row> stated;
    for (const catalogued_row& row : rows_of(f.name)) stated.emplace(row.key(), row);
    const implementation_table& table = f.table();
    EXPECT_LE(table.size(), 32u) << f.name;
    table.for_each([&](std::uint64_t key, const implementation_table::entry& entry) {
      const auto row = stated.find(key);
      if (row == stated.end()) {
        ADD_FAILURE() << f.name << " holds " << std::hex << key;
        return;
      }
      EXPECT_TRUE(entry.run) << row->second.functor();
      if (row->second.on_host()) return;
      EXPECT_EQ(row->second.functor(), entry.implementation);
    });
  }
}

TEST(Families, ServeTheHostAtAllTiersOfATypeOrAtNone) {
  for (const family& f : families()) {
    for (const std::uint64_t precision : {0x4ull, 0x8ull, 0x10ull, 0x18ull}) {
      const std::uint64_t host = (precision << 32) + 0x8010;
      int stated = 0;
      for (const catalogued_row& row : rows_of(f.name)) stated += (row.key() & ~7ull) == host;
      EXPECT_TRUE(stated == 0 || stated == 3) << f.name;
    }
    for (const std::uint64_t tier : {1u, 2u, 4u})
      EXPECT_EQ(nullptr, f.table().find(0x100008010 + tier))
          << f.name << " serves half on the host";
  }
}

TEST(Families, PrintProgress) {
  std::size_t rows = 0, begun = 0, complete = 0;
  std::set<std::string> functors;
  const auto count = [&](const family& f) {
    rows += f.table().size();
    begun += f.table().size() != 0;
    complete += f.table().size() == static_cast<std::size_t>(f.catalogued_rows);
  };
  for (const family& f : families()) {
    count(f);
    f.table().for_each([&](std::uint64_t key, const implementation_table::entry& entry) {
      if ((key & 0x20) != 0) functors.insert(entry.implementation);
    });
  }
  for (const family& f : utility_families()) count(f);
  std::cout << "rows present " << rows << " of " << all_rows << ", functors present "
            << functors.size() << " of " << all_functors << ", families with rows " << begun
            << ", with all their rows " << complete << ", of 101\n";
  EXPECT_LE(rows, all_rows);
  EXPECT_LE(functors.size(), all_functors);
  EXPECT_GT(rows, 0u);
}

}  // namespace
