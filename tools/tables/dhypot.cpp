// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The table of hypot at double.

#include "real.hpp"
#include "table.hpp"

namespace arbor::lumen::tables {
namespace {

/// The multiple of 1/512 nearest to x, 0 < x < 1.
real nearest_multiple(const real& x) {
  int n = 512;
  while (x < real::ratio(2 * n - 1, 1024)) --n;
  return real::ratio(n, 512);
}

table roots() {
  table t{
      "_arrdHypotHATab",
      "Words 2i and 2i + 1, i = 0..255: T = 1 - j/512, nearest to 1/sqrt(s) for the middle s of\n"
      "the i-th interval, and T^2. Rows 0 to 127 are for 128 intervals of [1, 2), the others\n"
      "for 128 of [2, 4). From word 512 the constants 1/2, 1, 2, 2^27 + 1 and 2^-998, the\n"
      "last one the bound of arguments that are scaled up before. One table for all tiers.",
      64,
      4,
      {}};
  for (int i = 0; i < 256; ++i) {
    const real s = real::ratio(257 + 2 * (i & 127), 256) * real(i < 128 ? 1 : 2);
    const real row = nearest_multiple(real(1) / sqrt(s));
    t.words.insert(t.words.end(), {row.double_word(), (row * row).double_word()});
  }
  t.words.insert(t.words.end(), {0x3fe0000000000000, 0x3ff0000000000000, 0x4000000000000000,
                                 0x41a0000002000000, 0x0190000000000000});
  return t;
}

const registration dhypot("dhypot", [] { return std::vector<table>{roots()}; });

}  // namespace
}  // namespace arbor::lumen::tables
