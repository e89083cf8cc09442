// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of pow2o3.

#include "table.hpp"
#include "thirty_seconds.hpp"

namespace arbor::lumen::tables {
namespace {

table residues_s() {
  table t{"internal_spow2o3_la_data",
          "Word k = 0..2: 2^(2k/3), to the nearest. Also for `ep`.",
          32,
          3,
          {}};
  for (int k = 0; k < 3; ++k) t.words.push_back(exp2(real::ratio(2 * k, 3)).float_word());
  return t;
}

table rows_s() {
  table t{
      "_arrsPow2o3HATab",
      "Words 0 to 3: the polynomial of (1 + g)^(2/3) - 1 from g^4 to g^1. Word 4 + i, i = 0..31:\n"
      "1/c for the middle c of the i-th of 32 intervals of [1, 2). Words 36 + 2(32k + i) and the\n"
      "next, k = 0..2: (2^k c)^(2/3) in two words. From word 228 the scale of denormals, 2^99,\n"
      "and the power that it leaves in the result, 2^66. Also the rows of the main path at `ha`.",
      32,
      4,
      {0xbcebfbc9, 0x3d4a4588, 0xbde38e39, 0x3f2aaaab}};
  append_reciprocals(t.words, 1, 32);
  for (int k = 0; k < 3; ++k) {
    for (int i = 0; i < 32; ++i) append_pair(t.words, power_of_row(k, i, 2, 3), 32);
  }
  t.words.insert(t.words.end(), {0x71000000, 0x60800000});
  return t;
}

table singles_d() {
  table t{"internal_dpow2o3_la_data",
          "Word i = 0..31: -1/c for the middle c of the i-th of 32 intervals of [1, 2). Word\n"
          "32(k + 1) + i, k = 0..2: (2^k c)^(2/3), to the nearest. Also for `ep`.",
          64,
          4,
          {}};
  append_reciprocals(t.words, -1, 64);
  for (int k = 0; k < 3; ++k) {
    for (int i = 0; i < 32; ++i) t.words.push_back(power_of_row(k, i, 2, 3).double_word());
  }
  return t;
}

table pairs_d() {
  table t{"internal_dpow2o3_ha_data",
          "Word i = 0..31: -1/c for the middle c of the i-th of 32 intervals of [1, 2). Words\n"
          "32 + 2(32k + i) and the next, k = 0..2: (2^k c)^(2/3) in two words.",
          64,
          4,
          {}};
  append_reciprocals(t.words, -1, 64);
  for (int k = 0; k < 3; ++k) {
    for (int i = 0; i < 32; ++i) append_pair(t.words, power_of_row(k, i, 2, 3), 64);
  }
  return t;
}

table series_d() {
  table t{"internal_dpow2o3_ha_series",
          "The series of ((1 + g)^(2/3) - 1)/g from g^7 to g^0; for |g| <= 1/65 within 3.3e-19 of\n"
          "(1 + g)^(2/3).",
          64,
          4,
          {}};
  for (const real& c : binomial_series(2, 3, 8)) t.words.push_back(c.double_word());
  return t;
}

const registration pow2o3("pow2o3", [] {
  return std::vector<table>{residues_s(), rows_s(), singles_d(), pairs_d(), series_d()};
});

}  // namespace
}  // namespace arbor::lumen::tables
