// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of atan at double.

#include "real.hpp"
#include "table.hpp"

namespace arbor::lumen::tables {
namespace {

table quarters() {
  table t{"internal_datan_la_data_avx512", "Word j = 0..31: atan(j/4), nearest.", 64, 4, {}};
  for (int j = 0; j < 32; ++j) t.words.push_back(atan(real::ratio(j, 4)).double_word());
  return t;
}

/// k, a mask, and two words of the angle.
void add_row(table& t, const real& k, std::uint64_t mask, const real& angle) {
  const double_words words = split(angle);
  t.words.insert(t.words.end(), {k.double_word(), mask, words.high, words.low});
}

table segments() {
  table t{"internal_datan_ha_data",
          "Row i, for an angle with tangent a: k, the mask of a and of 1 in (a - k)/(ka + 1), and\n"
          "atan k in two words. Row 0, the largest a: -1/a, and pi/2.",
          64,
          4,
          {}};
  add_row(t, real(1), 0, real::pi() / real(2));
  for (const double k : {1.5, 1.0, 0.5, 0.0}) add_row(t, real(k), ~std::uint64_t{0}, atan(real(k)));
  return t;
}

const registration datan("datan", [] { return std::vector<table>{quarters(), segments()}; });

}  // namespace
}  // namespace arbor::lumen::tables
