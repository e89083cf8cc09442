// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Every row that the catalogue states, also those without an implementation, and tables of them.
#pragma once

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <utility>
#include <vector>

#include "catalogue_lists.hpp"
#include "dispatch/table.hpp"

namespace arbor::lumen::tests {

struct catalogued_row {
  std::string function;
  char type;            ///< h, s, d, c or z
  std::string feature;  ///< gen, nolut, fp64only, nofp64 or classic
  bool cast;            ///< a half row that computes in float
  std::string tier;     ///< ha, la or ep

  bool on_host() const { return feature == "classic"; }

  /// The name of the scalar routine behind a kernel row.
  std::string functor() const {
    return function + "_" + type + "_" + tier + "_" + feature + (cast ? "_fp32cast" : "");
  }

  /// The row's dispatch key, field by field.
  std::uint64_t key() const {
    std::uint64_t key = on_host() ? 0x10 : 0x20;
    key += tier == "ep" ? 1 : tier == "la" ? 2 : 4;
    key += type == 'h' ? 0x1'0000'0000 : type == 's' ? 0x4'0000'0000 : 0;
    key += type == 'd' ? 0x8'0000'0000 : type == 'c' ? 0x10'0000'0000 : 0;
    key += type == 'z' ? 0x18'0000'0000 : 0;
    key += feature == "gen" ? 0x100 : feature == "nofp64" ? 0x200 : 0;
    key += feature == "nolut" ? 0x400 : feature == "fp64only" ? 0x800 : 0;
    key += feature == "classic" ? 0x8000 : 0;
    return cast ? key + 0x1000 : key;
  }
};

inline const std::vector<catalogued_row>& catalogued_rows() {
  // As constants first: a list of as many strings takes compilers a minute.
  struct row {
    const char* function;
    char type;
    const char* feature;
    bool cast;
    const char* tier;
  };
  static constexpr row constants[] = {
#define LUMEN_ROW(function, type, feature, cast, tier) {#function, #type[0], #feature, cast, #tier},
      LUMEN_ROWS(LUMEN_ROW)
#undef LUMEN_ROW
  };
  static const std::vector<catalogued_row> rows = [] {
    std::vector<catalogued_row> list;
    for (const row& r : constants) list.push_back({r.function, r.type, r.feature, r.cast, r.tier});
    return list;
  }();
  return rows;
}

inline std::vector<catalogued_row> rows_of(const std::string& function) {
  std::vector<catalogued_row> rows;
  for (const catalogued_row& row : catalogued_rows())
    if (row.function == function) rows.push_back(row);
  return rows;
}

/// The functions that have rows, which is all of them, in alphabetical order.
inline std::vector<std::string> catalogued_functions() {
  std::vector<std::string> names;
  for (const catalogued_row& row : catalogued_rows()) names.push_back(row.function);
  std::sort(names.begin(), names.end());
  names.erase(std::unique(names.begin(), names.end()), names.end());
  return names;
}

/// A table with all the rows of a function, none of which does anything.
inline vm::detail::implementation_table full_table(const std::string& function) {
  using vm::detail::implementation_table;
  constexpr std::size_t most = 32;
  constexpr auto nothing = [](const vm::detail::input::vxx&, vm::detail::TuningInfo) {
    return sycl::event();
  };
  const std::vector<catalogued_row> rows = rows_of(function);
  // A table takes its rows as a list, whose length is part of the source; the first row again fills
  // it up, since a key is held once.
  std::array<implementation_table::row, most> list{};
  for (std::size_t i = 0; i < most; ++i)
    list.at(i) = {rows.at(i < rows.size() ? i : 0).key(), nothing, "nothing"};
  return [&]<std::size_t... I>(std::index_sequence<I...>) {
    return implementation_table{list[I]...};
  }
  (std::make_index_sequence<most>{});
}

}  // namespace arbor::lumen::tests
