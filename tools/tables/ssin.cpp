// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The digits of 1/(2 pi) for the reductions at float.

#include "table.hpp"
#include "turns.hpp"

namespace arbor::lumen::tables {
namespace {

table inverse_turn_words() {
  table t{"__ssin_ha_invpi_tbl",
          "One word 0, then the first seven words of the binary fraction of 1/(2 pi).",
          32,
          8,
          {0}};
  const binary_digits turns = binary_digits::over_pi(0.5);
  for (int word = 0; word < 7; ++word) t.words.push_back(turns.word(1 + 32 * word, 32));
  return t;
}

const registration ssin("ssin", [] { return std::vector<table>{inverse_turn_words()}; });

}  // namespace
}  // namespace arbor::lumen::tables
