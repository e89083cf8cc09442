// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of log1p at float.

#include "log_rows.hpp"

namespace arbor::lumen::tables {
namespace {

table breakpoints(const std::string& tier) {
  table t{
      "__slog1p_" + tier + "_CoutTab",
      "Row i = 0..64, for the breakpoint 1 + i/64: its reciprocal rounded to a multiple of 1/128,\n"
      "and the two words of the reciprocal's -ln, exact to 3.4e-13. From word 195 the constants\n"
      "of the path: the two words of ln 2, the shifter to the index, the splitter, the bound of\n"
      "the neighbourhood of 1, the scale of denormals, 0, 1, and (ln(1 + t) - t)/t^2 from the\n"
      "lowest term up.",
      32, 3, breakpoint_rows({32, 128, 1, natural_logarithm, {-14, -16, 3.4e-13}})};
  t.words.insert(t.words.end(), {0x3f317200, 0x35bfbe8e, 0x48000040, 0x46000000, 0x3c200000,
                                 0x53800000, 0, 0x3f800000, 0xbf000000, 0x3eaaaaab, 0xbe800000,
                                 0x3e4ccccd, 0xbe2aaaab, 0x3e124e01, 0xbe0005a0});
  return t;
}

table pairs() {
  return {
      "internal_slog1p_ha_data",
      "Words 2(R - 128) and the next one, R = 128..256: -ln(R/256) less 127 times ln 2, whose\n"
      "words are 0x3f317200 and 0x35bfbe00.",
      32, 2,
      biased_pairs({32, 128, 256, 127, {0x3f317200, 0x35bfbe00}, -15, {}}, 128, natural_logarithm)};
}

const registration slog1p("slog1p", [] {
  return std::vector<table>{pairs(), breakpoints("ha"), breakpoints("la"), breakpoints("ep")};
});

}  // namespace
}  // namespace arbor::lumen::tables
