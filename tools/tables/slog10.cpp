// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of log10 at float.

#include "log_rows.hpp"

namespace arbor::lumen::tables {
namespace {

table breakpoints(const std::string& tier) {
  table t{
      "__slog10_" + tier + "_CoutTab",
      "Row i = 0..64, for the breakpoint 1 + i/64: its reciprocal, rounded to a multiple of\n"
      "1/128, times 111.1796875,\n"
      "and the two words of the reciprocal's -log10, exact to 3.4e-13. From word 195 the\n"
      "constants of the path: the two words of log10(2), the shifter to the index, the splitter,\n"
      "the bound of the neighbourhood of 1, the scale of denormals, 0, 1, the scale of\n"
      "reciprocals, and the polynomial from the lowest term up.",
      32, 3,
      breakpoint_rows(
          {32, 128, real::of_float(0x42de5c00), decimal_logarithm, {-14, -18, 3.4e-13}})};
  t.words.insert(t.words.end(),
                 {0x3e9a0000, 0x39826a14, 0x48000040, 0x46000000, 0x3bc00000, 0x53800000, 0,
                  0x3f800000, 0x42de5c00, 0xbf7f0000, 0xb7935d5a, 0x33e23666, 0xb04353b9,
                  0x2cb3e701, 0xa92c998b, 0x25aa5bfd, 0xa22b5dae});
  return t;
}

const registration slog10("slog10", [] {
  return std::vector<table>{breakpoints("la"), breakpoints("ep")};
});

}  // namespace
}  // namespace arbor::lumen::tables
