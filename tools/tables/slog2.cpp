// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of log2 at float.

#include "log_rows.hpp"

namespace arbor::lumen::tables {
namespace {

table breakpoints(const std::string& tier) {
  table t{
      "__slog2_" + tier + "_CoutTab",
      "Row i = 0..64, for the breakpoint 1 + i/64: its reciprocal, rounded to a multiple of\n"
      "1/2048, times 369.330078125 and rounded, ties up,\n"
      "and the two words of the reciprocal's -log2, exact to 3.4e-13. From word 195 the\n"
      "constants of the path: the two words of log2(2), the shifter to the index, the splitter,\n"
      "the bound of the neighbourhood of 1, the scale of denormals, 0, 1, the scale of\n"
      "reciprocals, and the polynomial from the lowest term up.",
      32, 3,
      breakpoint_rows(
          {32, 2048, real::of_float(0x43b8aa40), binary_logarithm, {-14, -16, 3.4e-13}})};
  t.words.insert(t.words.end(), {0x3f800000, 0, 0x48000040, 0x46000000, 0x3bc00000, 0x4d000000, 0,
                                 0x3f800000, 0x43b8aa40, 0xbf7f0000, 0xb6b1720f, 0x3223fe93,
                                 0xadaa8223, 0x293d1988, 0xa4da74dc, 0x2081cd9d, 0x9c1d865e});
  return t;
}

const registration slog2("slog2", [] {
  return std::vector<table>{breakpoints("la"), breakpoints("ep")};
});

}  // namespace
}  // namespace arbor::lumen::tables
