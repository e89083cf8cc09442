// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of log2 at double.

#include "log_rows.hpp"

namespace arbor::lumen::tables {
namespace {

table pairs() {
  return {
      "internal_dlog2_ha_data",
      "R = 369..738; below 512 the row of R is at word 4(R - 369), from there at word\n"
      "572 + 2(R - 512): -log2(R/738) less 1023, the high word\n"
      "a multiple of 2^-42.",
      64, 2,
      biased_pairs({64, 369, 738, 1023, {0x3ff0000000000000, 0}, -42, {}}, 512, binary_logarithm)};
}

constexpr long reciprocal_unit = 2048;

/// The rounded reciprocal of the middle of the i-th of 256 intervals of [1, 2).
real middle_reciprocal(int i) {
  const long divisor = 512 + 2 * i + 1;
  return real::ratio((2 * 512 * reciprocal_unit + divisor) / (2 * divisor), reciprocal_unit);
}

table reciprocals_of_rare_path(const std::string& tier) {
  table t{"__dlog2_" + tier + "___libm_rcp_table_256",
          "Word i = 0..255: round(2048/(1 + (2i + 1)/512))/2048.",
          32,
          8,
          {}};
  for (int i = 0; i < 256; ++i) t.words.push_back(middle_reciprocal(i).float_word());
  return t;
}

table logarithms_of_rare_path(const std::string& tier) {
  table t{"__dlog2_" + tier + "___libm_log2_table_256",
          "Words 2i and 2i + 1, i = 0..255: the low and the high word of -log2 of the i-th\n"
          "reciprocal; the high word is a multiple of 2^-20, the sum is exact to 2^-75.",
          64,
          2,
          {}};
  for (int i = 0; i < 256; ++i) {
    const real logarithm = -log2(middle_reciprocal(i));
    const real high = nearest_multiple(logarithm, -20);
    t.words.insert(t.words.end(), {(logarithm - high).double_word(), high.double_word()});
  }
  return t;
}

const registration dlog2("dlog2", [] {
  std::vector<table> list = {pairs(),
                             single_values("internal_dlog2_la_data", "log2", binary_logarithm),
                             single_values("internal_dlog2_ep_data", "log2", binary_logarithm)};
  for (const char* tier : {"ha", "la", "ep"}) {
    list.push_back(reciprocals_of_rare_path(tier));
    list.push_back(logarithms_of_rare_path(tier));
  }
  return list;
});

}  // namespace
}  // namespace arbor::lumen::tables
