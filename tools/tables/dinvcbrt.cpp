// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of invcbrt at double.

#include "table.hpp"
#include "thirty_seconds.hpp"

namespace arbor::lumen::tables {
namespace {

table singles() {
  table t{"internal_dinvcbrt_la_data",
          "Word i = 0..31: -1/c for the middle c of the i-th of 32 intervals of [1, 2). Word\n"
          "32(k + 1) + i, k = 0..2: (2^k c)^(-1/3), to the nearest. Also for `ep`.",
          64,
          4,
          {}};
  append_reciprocals(t.words, -1, 64);
  for (int k = 0; k < 3; ++k) {
    for (int i = 0; i < 32; ++i) t.words.push_back(power_of_row(k, i, -1, 3).double_word());
  }
  return t;
}

table pairs() {
  table t{"internal_dinvcbrt_ha_data",
          "Word i = 0..31: -1/c for the middle c of the i-th of 32 intervals of [1, 2). Words\n"
          "32 + 2(32k + i) and the next, k = 0..2: (2^k c)^(-1/3) in two words.",
          64,
          4,
          {}};
  append_reciprocals(t.words, -1, 64);
  for (int k = 0; k < 3; ++k) {
    for (int i = 0; i < 32; ++i) append_pair(t.words, power_of_row(k, i, -1, 3), 64);
  }
  return t;
}

table rare_rows() {
  table t{
      "_arrdInvCbrtHATab",
      "Word 32k + i, k = 0..2: (2^k c)^(-1/3), rounded to 17 bits, for the middle c of the i-th\n"
      "of 32 intervals of [1, 2). From word 96 the constants of the path: the series of\n"
      "(1 - e)^(-1/3) from e^9 to e^1, 1, 1/2, 2^60, 2^20, -1, -0.",
      64,
      4,
      {}};
  for (int k = 0; k < 3; ++k) {
    for (int i = 0; i < 32; ++i)
      t.words.push_back(power_of_row(k, i, -1, 3).rounded_to(17).double_word());
  }
  int degree = 9;
  for (const real& c : binomial_series(-1, 3, degree))
    t.words.push_back((degree-- % 2 == 0 ? c : -c).double_word());
  t.words.insert(t.words.end(), {0x3ff0000000000000, 0x3fe0000000000000, 0x43b0000000000000,
                                 0x4130000000000000, 0xbff0000000000000, 0x8000000000000000});
  return t;
}

const registration dinvcbrt("dinvcbrt", [] {
  return std::vector<table>{singles(), pairs(), rare_rows()};
});

}  // namespace
}  // namespace arbor::lumen::tables
