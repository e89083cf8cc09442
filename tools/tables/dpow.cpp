// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of the powers at double.

#include "log_rows.hpp"

namespace arbor::lumen::tables {
namespace {

/// -log2(c/scale) + offset, the high word a multiple of 2^unit.
void push_log2(std::vector<std::uint64_t>& list, const real& c, const real& scale, int offset,
               int unit) {
  const real logarithm = real(offset) - log2(c / scale);
  const real high = nearest_multiple(logarithm, unit);
  list.insert(list.end(), {high.double_word(), (logarithm - high).double_word()});
}

table rows_la() {
  table t{
      "internal_dpow_la_data",
      "Words 2(R - 512) and the next one, R = 512..1024: -1023 - log2(R/1024), the high word a\n"
      "multiple of 2^-42, the sum exact to 6.4e-30. Word 1026 + i: 2^(i/256), i = 0..255, to the\n"
      "nearest.",
      64,
      2,
      {}};
  for (int r = 512; r <= 1024; ++r) push_log2(t.words, real::ratio(r, 1024), real(1), -1023, -42);
  for (int i = 0; i < 256; ++i) t.words.push_back(exp2(real::ratio(i, 256)).double_word());
  return t;
}

/// C = 1.442694902420044, 1/ln 2 to 23 bits.
const std::uint64_t short_log2_e = 0x3ff7154740000000;

table rows_ha() {
  table t{
      "internal_dpow_ha_data",
      "Word j = 0..1024: C/(1 + j/1024) to 26 bits, C = 1.442694902420044. Word 1026 + 2j and\n"
      "the next one: -log2 of it over C, less 1 for j >= 512; the high word a multiple of 2^-42,\n"
      "the sum exact to 6.4e-30. Word 3076 + 2i and the next one: high and low part of\n"
      "2^(i/128), i = 0..127, exact to 1.3e-32.",
      64,
      4,
      {}};
  const real scale = real::of_double(short_log2_e);
  std::vector<std::uint64_t> pairs;
  for (int j = 0; j <= 1024; ++j) {
    const real c = (scale * real::ratio(1024, 1024 + j)).rounded_to(26);
    t.words.push_back(c.double_word());
    push_log2(pairs, c, scale, j >= 512 ? -1 : 0, -42);
  }
  t.words.push_back(0);  // pairs stand at even words
  t.words.insert(t.words.end(), pairs.begin(), pairs.end());
  for (int i = 0; i < 128; ++i) {
    const double_words root = split(exp2(real::ratio(i, 128)));
    t.words.insert(t.words.end(), {root.high, root.low});
  }
  return t;
}

table rows_ep() {
  table t = single_values("internal_dpow_ep_data", "ln", natural_logarithm);
  t.comment += "\nWord 513 + i: 2^(i/2048), i = 0..2047, to the nearest.";
  for (int i = 0; i < 2048; ++i) t.words.push_back(exp2(real::ratio(i, 2048)).double_word());
  return t;
}

/// A stage of the rare path: its factors c and their pairs -log2(c/scale).
void push_stage(std::vector<std::uint64_t>& list, const std::vector<real>& factors,
                const real& scale) {
  std::vector<std::uint64_t> pairs;
  for (const real& c : factors) {
    list.push_back(c.double_word());
    push_log2(pairs, c, scale, 0, -40);
  }
  list.insert(list.end(), pairs.begin(), pairs.end());
}

table rare_rows() {
  table t{
      "__dpow_ha_CoutTab",
      "Rare path. Three stages of factors, followed by the pairs of their -log2, high words\n"
      "multiples of 2^-40, sums exact to 2.6e-29:\n"
      "- word i = 0..32: 1/(1 + i/32) to a multiple of 2^-15; pairs from word 33;\n"
      "- word 99 + i: 1/(1 + i/512) up to i = 12, 1/(1 - (32 - i)/1024) above, to a multiple of\n"
      "  2^-20; pairs from word 132;\n"
      "- word 198 + i, i = 0..128: C/(1 + i/32768) up to i = 48, C/(1 - (128 - i)/65536) above,\n"
      "  to 26 bits, C = 1.442694902420044; pairs, of the quotient by C, from word 327. The\n"
      "  last word of the last pair, a zero, is also the first of what follows.\n"
      "Word 584 + 2j and the next one: low and high part of 2^(j/128), j = 0..127. From word 840\n"
      "on the constants of the path.",
      64,
      4,
      {}};
  std::vector<real> first, second, third;
  const real scale = real::of_double(short_log2_e);
  for (int i = 0; i <= 32; ++i) first.push_back(nearest_multiple(real::ratio(32, 32 + i), -15));
  for (int i = 0; i <= 32; ++i)
    second.push_back(nearest_multiple(
        i <= 12 ? real::ratio(512, 512 + i) : real::ratio(1024, 1024 - (32 - i)), -20));
  for (int i = 0; i <= 128; ++i)
    third.push_back(
        (scale * (i <= 48 ? real::ratio(32768, 32768 + i) : real::ratio(65536, 65536 - (128 - i))))
            .rounded_to(26));
  push_stage(t.words, first, real(1));
  push_stage(t.words, second, real(1));
  push_stage(t.words, third, scale);
  t.words.pop_back();
  for (int j = 0; j < 128; ++j) {
    const double_words root = split(exp2(real::ratio(j, 128)));
    t.words.insert(t.words.end(), {root.low, root.high});
  }
  t.words.insert(t.words.end(),
                 {0x3c62eb74966579e7, 0x3e79c3a6966457e8, 0xbfd62e4346694107, 0x3fc47fd462b6dee1,
                  0xbfb550472a9012d8, 0x3fe62e42fefa39ef, 0x3fcebfbdff82c58f, 0x3fac6b08d704a0c0,
                  0x3f83b2ab6fba4e77, 0x3f55d87fe78a6731, 0x7fe0000000000000, 0x0010000000000000,
                  0x0000000000000000, 0x3ff0000000000000, 0xbff0000000000000, 0x42c8000000000000,
                  0x3ff7154740000000, 0x41a0000002000000, 0x4c70000000000000, 0x3370000000000000});
  return t;
}

const registration dpow("dpow", [] {
  return std::vector<table>{rows_la(), rows_ha(), rows_ep(), rare_rows()};
});

}  // namespace
}  // namespace arbor::lumen::tables
