// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Lookup tables of the scalar bodies, computed from their rules with MPFR.
///
/// A header of tables is one source file of this folder, of the same name: it computes the words of
/// its tables and registers the header. Nothing else needs to be told of it.
#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace arbor::lumen::tables {

/// One array. `comment` states the rule, the range of rows and the error.
struct table {
  std::string name;
  std::string comment;
  int word_bits;      ///< 32 or 64
  int words_per_row;  ///< how many words stand in a line of the header
  std::vector<std::uint64_t> words;
};

/// A header `scalar/tables/<name>.hpp`: one per family of tables.
struct header {
  std::string name;
  std::function<std::vector<table>()> make;
};

/// Registers a header, by a namespace-scope constant of a source file.
struct registration {
  registration(std::string name, std::function<std::vector<table>()> make);
};

/// The header of that name, or null.
const header* find_header(std::string_view name);

/// The text of a header.
std::string text_of(const header& header);

}  // namespace arbor::lumen::tables
