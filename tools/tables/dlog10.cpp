// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of log10 at double.

#include "log_rows.hpp"

namespace arbor::lumen::tables {
namespace {

table breakpoints(const std::string& tier) {
  table t{
      "__dlog10_" + tier + "_CoutTab",
      "Row i = 0..64, for the breakpoint 1 + i/64: its reciprocal, rounded to a multiple of\n"
      "1/128, times 0.43359375,\n"
      "and the two words of the reciprocal's -log10, exact to 1.2e-28. From word 195 the\n"
      "constants of the path: the two words of log10(2), the shifter to the index, the splitter,\n"
      "the bound of the neighbourhood of 1, the scale of denormals, 0, 1, the scale of\n"
      "reciprocals, and the polynomial from the lowest term up.",
      64, 3,
      breakpoint_rows(
          {64, 128, real::of_double(0x3fdbc00000000000), decimal_logarithm, {-37, -42, 1.2e-28}})};
  t.words.insert(t.words.end(),
                 {0x3fd34413509f8000, 0xbd380433b83b532a, 0x42d0000000000040, 0x4160000000000000,
                  0x3f78000000000000, 0x43b0000000000000, 0, 0x3ff0000000000000, 0x3fdbc00000000000,
                  0x3f5a7a6cbf2e4107, 0xbff27af2dc77b115, 0x3ffc6a02dc963a31, 0xc008930964d42479,
                  0x4016ab9f7b1efe5c, 0xc025c90e698cfb68, 0x40358992e1b1aa78, 0xc045b3214e75eea2});
  return t;
}

table pairs() {
  return {"internal_dlog10_ha_data",
          "R = 222..444; below 256 the row of R is at word 4(R - 222), from there at word\n"
          "136 + 2(R - 256): -log10(R/444) less 1023 times log10(2), whose words\n"
          "are 0x3fd34413509f0000 and 0x3d7e7fbcc47c0000; exact to 2.7e-23.",
          64, 2,
          biased_pairs({64, 222, 444, 1023, {0x3fd34413509f0000, 0x3d7e7fbcc47c0000}, -38, -74},
                       256, decimal_logarithm)};
}

const registration dlog10("dlog10", [] {
  return std::vector<table>{pairs(),
                            single_values("internal_dlog10_la_data", "log10", decimal_logarithm),
                            single_values("internal_dlog10_ep_data", "log10", decimal_logarithm),
                            breakpoints("ha"),
                            breakpoints("la"),
                            breakpoints("ep")};
});

}  // namespace
}  // namespace arbor::lumen::tables
