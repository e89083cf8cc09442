// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <map>
#include <string>
#include <vector>

#include "dispatch/catalogue.hpp"
#include "dispatch/families.hpp"

namespace {

using arbor::lumen::tests::catalogued_row;
using arbor::lumen::vm::detail::families;
using arbor::lumen::vm::detail::family;
using arbor::lumen::vm::detail::implementation_table;
using arbor::lumen::vm::detail::utility_families;

struct utility {
  const char* name;
  const char* shape;
  const char* kernel_types;  ///< the other types are served by the host alone
};
constexpr utility all_utilities[] = {
    {"assign", "vc1", "sdcz"}, {"assign2", "vc2", "sdcz"}, {"compare", "v21c", "sd"},
    {"compare2", "v21", "sd"}, {"copy1", "v11", "sdcz"},   {"copy2", "v12", "sd"},
    {"faa", "v31", "sdcz"},    {"fma", "v31", "sdcz"},     {"fmm", "v31", "sdcz"},
    {"iota", "vi2c1", "sd"},
};

/// The rows of a utility, with what each runs: one functor of a type for every accuracy.
std::map<std::uint64_t, std::string> expected_rows(const utility& u) {
  std::map<std::uint64_t, std::string> rows;
  for (const char type : std::string("sdcz")) {
    const std::string functor = std::string(u.name) + "_" + type;
    for (const char* tier : {"ha", "la", "ep"}) {
      const catalogued_row host{u.name, type, "classic", false, tier};
      rows.emplace(host.key(), "host loop over " + functor);
      const catalogued_row kernel{u.name, type, "gen", false, tier};
      if (std::strchr(u.kernel_types, type) != nullptr) rows.emplace(kernel.key(), functor);
    }
  }
  return rows;
}

TEST(UtilityFamilies, AreTenWithoutHandler) {
  ASSERT_EQ(std::size(all_utilities), utility_families().size());
  for (std::size_t i = 0; i < std::size(all_utilities); ++i) {
    const family& f = utility_families()[i];
    EXPECT_STREQ(all_utilities[i].name, f.name);
    EXPECT_STREQ(all_utilities[i].shape, f.shape);
    EXPECT_STREQ("sdcz", f.types);
    EXPECT_FALSE(f.handler);
  }
}

TEST(UtilityFamilies, HoldAllTheirRows) {
  std::size_t rows = 0;
  for (const utility& u : all_utilities) {
    const auto find = [&]() -> const family* {
      for (const family& f : utility_families())
        if (std::string(u.name) == f.name) return &f;
      return nullptr;
    };
    const family* f = find();
    ASSERT_NE(nullptr, f) << u.name;
    std::map<std::uint64_t, std::string> held;
    f->table().for_each([&](std::uint64_t key, const implementation_table::entry& entry) {
      held.emplace(key, entry.implementation);
    });
    EXPECT_EQ(expected_rows(u), held) << u.name;
    EXPECT_EQ(held.size(), static_cast<std::size_t>(f->catalogued_rows)) << u.name;
    rows += held.size();
  }
  EXPECT_EQ(216u, rows);
}

TEST(UtilityFamilies, AreTheRestOfAllRows) {
  int rows = 0;
  for (const family& f : families()) rows += f.catalogued_rows;
  for (const family& f : utility_families()) rows += f.catalogued_rows;
  EXPECT_EQ(1797, rows);
}

}  // namespace
