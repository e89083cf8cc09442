// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of the tangent at double.

#include "real.hpp"
#include "table.hpp"

namespace arbor::lumen::tables {
namespace {

table tangents() {
  table t{
      "internal_dtan_ha_data",
      "The first six words are constants of the reduction: 16/pi, the shifter, pi/16 in three\n"
      "words, and the largest argument of the main path. Word 6 + k, k = 0..15, is the tangent\n"
      "of k pi/16, and word 22 + k what it leaves out; that of 0 is -0, and for the pole stands\n"
      "-2^1024 in two words.",
      64,
      2,
      {0x40145f306dc9c883, 0x4338000000000000, 0x3fc921fb54442d18, 0x3c61a62633000000,
       0x3a645c06e0e68948, 0x40f000000e4db24c}};
  std::vector<std::uint64_t> low;
  for (int k = 0; k < 16; ++k) {
    if (k == 0 || k == 8) {
      t.words.push_back(k == 0 ? 0x8000000000000000 : 0xffefffffffffffff);
      low.push_back(k == 0 ? 0 : 0xfca0000000000000);
      continue;
    }
    if (k % 4 == 0) {  // the exact 1 and -1
      t.words.push_back(k == 4 ? 0x3ff0000000000000 : 0xbff0000000000000);
      low.push_back(0);
      continue;
    }
    const double_words a = split(tan(real::ratio(k, 16) * real::pi()));
    t.words.push_back(a.high);
    low.push_back(a.low);
  }
  t.words.insert(t.words.end(), low.begin(), low.end());
  return t;
}

const registration dtan("dtan", [] { return std::vector<table>{tangents()}; });

}  // namespace
}  // namespace arbor::lumen::tables
