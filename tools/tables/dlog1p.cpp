// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of log1p at double.

#include "log_rows.hpp"

namespace arbor::lumen::tables {
namespace {

table breakpoints(const std::string& tier) {
  table t{
      "__dlog1p_" + tier + "_CoutTab",
      "Row i = 0..64, for the breakpoint 1 + i/64: its reciprocal rounded to a multiple of\n"
      "1/2048, and the two words of the reciprocal's -ln, exact to 1.2e-28. From word 195 the\n"
      "constants of the path: the two words of ln 2, the shifter to the index, the splitter, the\n"
      "bound of the neighbourhood of 1, the scale of denormals, 0, 1, and (ln(1 + t) - t)/t^2\n"
      "from the lowest term up.",
      64, 3, breakpoint_rows({64, 2048, 1, natural_logarithm, {-37, -42, 1.2e-28}})};
  t.words.insert(t.words.end(),
                 {0x3fe62e42fefa3800, 0x3d2ef35793c76730, 0x42d0000000000040, 0x4140000000000000,
                  0x3f84000000000000, 0x43b0000000000000, 0x0000000000000000, 0x3ff0000000000000,
                  0xbfe0000000000000, 0x3fd5555555555613, 0xbfd0000000000262, 0x3fc9999997b36c81,
                  0xbfc555555228b38f, 0x3fc249c02481059d, 0xbfc000b405a2836d});
  return t;
}

table pairs() {
  return {
      "internal_dlog1p_ha_data",
      "Words 2(R - 512) and the next one, R = 512..1024: -ln(R/1024) less 1023 times ln 2, whose\n"
      "words are 0x3fe62e42fefa0000 and 0x3d7cf79abc9e0000; exact to 1.4e-23.",
      64, 2,
      biased_pairs({64, 512, 1024, 1023, {0x3fe62e42fefa0000, 0x3d7cf79abc9e0000}, -36, -75}, 512,
                   natural_logarithm)};
}

const registration dlog1p("dlog1p", [] {
  return std::vector<table>{pairs(),
                            single_values("internal_dlog1p_la_data", "ln", natural_logarithm),
                            single_values("internal_dlog1p_ep_data", "ln", natural_logarithm),
                            breakpoints("ha"),
                            breakpoints("la"),
                            breakpoints("ep")};
});

}  // namespace
}  // namespace arbor::lumen::tables
