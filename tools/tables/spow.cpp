// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of the powers at float.

#include "log_rows.hpp"

namespace arbor::lumen::tables {
namespace {

table rows() {
  table t{"__spow_ha_log_tbl",
          "Words 2(R - 256) and the next one, R = 256..512: -118 - log2(R); the high word is a\n"
          "multiple of 2^-16, the sum exact to 2.3e-13.",
          32,
          2,
          {}};
  for (int r = 256; r <= 512; ++r) {
    const real logarithm = -log2(real(r)) - real(118);
    const real high = nearest_multiple(logarithm, -16);
    // The last row's exact high word leaves a zero of negative sign.
    const std::uint32_t low = r == 512 ? 0x80000000u : (logarithm - high).float_word();
    t.words.insert(t.words.end(), {high.float_word(), low});
  }
  return t;
}

/// round(grid·x) / grid.
real on_grid(const real& x, int grid_exponent) { return nearest_multiple(x, grid_exponent); }

table rare_rows() {
  table t{
      "__spow_ep_CoutTab",
      "Rare path of `ep`. Word i = 0..32: c1, 1/(1 + i/32) rounded to a multiple of 2^-10; word\n"
      "33 + 2i: -log2(c1), high word a multiple of 2^-15, and low word. Word 99 + i, i = 0..64:\n"
      "c2, C/(1 + i/1024) up to i = 24 and C/(1 - (64 - i)/2048) above, of 15 bits, with\n"
      "C = 1.44268798828125; word 164 + 2i: -log2(c2/C) in two words, of which the last is also\n"
      "the first of what follows. Word 293 + 2j, j = 0..31: low and high part of 2^(j/32). Word\n"
      "357 on the constants of the path: C; the coefficients of log2(1 + d/C) in d, the first\n"
      "less 1, up to the fourth; those of 2^f in f from the first to the fourth; the shifter\n"
      "3·2^17, 2^24, 2^±100, 256, 2^-30, 2^127, 2^-126, 0, ±1, 2, infinity and a NaN.",
      32,
      4,
      {}};
  std::vector<std::uint64_t>& w = t.words;
  std::vector<std::uint64_t> pairs;
  for (int i = 0; i <= 32; ++i) {
    const real c = on_grid(real::ratio(32, 32 + i), -10);
    const real logarithm = real(0) - log2(c);
    const real high = nearest_multiple(logarithm, -15);
    w.push_back(c.float_word());
    pairs.insert(pairs.end(), {high.float_word(), (logarithm - high).float_word()});
  }
  w.insert(w.end(), pairs.begin(), pairs.end());
  pairs.clear();
  const real scale = real::of_float(0x3fb8aa00);
  for (int i = 0; i <= 64; ++i) {
    const real m = i <= 24 ? real::ratio(1024 + i, 1024) : real::ratio(2048 - (64 - i), 2048);
    const real c = (scale / m).rounded_to(15);
    const real logarithm = real(0) - log2(c / scale);
    const real high(static_cast<double>(logarithm.to_float()));
    w.push_back(c.float_word());
    pairs.insert(pairs.end(), {high.float_word(), (logarithm - high).float_word()});
  }
  pairs.pop_back();
  w.insert(w.end(), pairs.begin(), pairs.end());
  for (int j = 0; j < 32; ++j) {
    const real root = exp2(real::ratio(j, 32));
    const real high(static_cast<double>(root.to_float()));
    w.insert(w.end(), {(root - high).float_word(), high.float_word()});
  }
  const real ln2 = log(real(2));
  const real log2_e = real(1) / ln2;
  const real c2 = scale * scale;
  for (const real& coefficient :
       {scale, log2_e / scale - real(1), -log2_e / (real(2) * c2), log2_e / (real(3) * c2 * scale),
        -log2_e / (real(4) * c2 * c2), ln2, ln2 * ln2 / real(2), ln2 * ln2 * ln2 / real(6),
        ln2 * ln2 * ln2 * ln2 / real(24)})
    w.push_back(coefficient.float_word());
  w.insert(w.end(),
           {0x48c00000, 0x4b800000, 0x71800000, 0x0d800000, 0x43800000, 0x30800000, 0x7f000000,
            0x00800000, 0x00000000, 0x3f800000, 0xbf800000, 0x40000000, 0x7f800000, 0xffc00000});
  return t;
}

const registration spow("spow", [] { return std::vector<table>{rows(), rare_rows()}; });

}  // namespace
}  // namespace arbor::lumen::tables
