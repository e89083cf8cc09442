// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of expm1 at double.

#include "real.hpp"
#include "table.hpp"

namespace arbor::lumen::tables {
namespace {

/// 2^(j/rows) for j = 0..rows - 1, the index j XORed into the top of the fraction.
table roots(const std::string& name, int rows, int index_shift, const std::string& comment) {
  table t{name, comment, 64, 2, {}};
  for (int j = 0; j < rows; ++j) {
    const double_words root = relative_split(exp2(real::ratio(j, rows)));
    const std::uint64_t fraction = root.high & 0x000fffffffffffff;
    t.words.insert(t.words.end(), {fraction ^ (std::uint64_t(j) << index_shift), root.low});
  }
  return t;
}

const registration dexpm1("dexpm1", [] {
  return std::vector<table>{
      roots("__dexpm1_la_Tbl_exp", 32, 47,
            "Row j, for 2^(j/32) = high·(1 + low), j = 0..31: the fraction of high with j·2^47\n"
            "XORed into it, and low. As bodies read the high half of low alone, the row is exact\n"
            "to 2^-73 relative."),
      roots("__dexpm1_ha_Tbl_exp", 16, 48,
            "Row j, for 2^(j/16) = high·(1 + low), j = 0..15: the fraction of high with j·2^48\n"
            "XORed into it, and low. As bodies read the high half of low alone, the row is exact\n"
            "to 2^-73 relative.")};
});

}  // namespace
}  // namespace arbor::lumen::tables
