// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of the sine, the cosine and their reductions at double, which the tangent shares.

#include "turns.hpp"

#include "real.hpp"
#include "table.hpp"

namespace arbor::lumen::tables {
namespace {

table reduction_rows() {
  table t{
      "internal_dsin_la_reduction_data",
      "Row e, for the biased exponent e of a double: floor(2^192 frac(2^(e - 1075)/(2 pi))), the\n"
      "first word the most significant one.",
      64,
      3,
      {}};
  const binary_digits turns = binary_digits::over_pi(0.5);
  for (int e = 0; e < 2048; ++e) {
    for (int word = 0; word < 3; ++word)
      t.words.push_back(turns.word(e - 1075 + 1 + 64 * word, 64));
  }
  return t;
}

table inverse_turn_words() {
  table t{"__dsin_ha_InvPi_tbl",
          "Two words 0, then the first 42 words of the binary fraction of 1/(2 pi).",
          32,
          8,
          {0, 0}};
  const binary_digits turns = binary_digits::over_pi(0.5);
  for (int word = 0; word < 42; ++word) t.words.push_back(turns.word(1 + 32 * word, 32));
  return t;
}

/// cos x = head + rest with a power of two as the head, sin x = high + low with a low part of 24
/// bits.
struct sine_and_cosine {
  std::uint64_t head, rest, high, low;

  /// At a multiple of 2 pi/steps; the multiples of a quarter turn are exact.
  static sine_and_cosine at(int step, int steps, mpfr_rnd_t low_rounding) {
    const real x = real::ratio(2 * step, steps) * real::pi();
    const bool integer = 4 * step % steps == 0;
    const int quadrant = 4 * step / steps;
    const real exact_cosines[] = {1.0, 0.0, -1.0, 0.0}, exact_sines[] = {0.0, 1.0, 0.0, -1.0};
    const real cosine = integer ? exact_cosines[quadrant] : cos(x);
    const real sine = integer ? exact_sines[quadrant] : sin(x);
    const real head = nearest_power_of_two(cosine);
    const real high(sine.to_double());
    return {head.double_word(), (cosine - head).double_word(), high.double_word(),
            (sine - high).rounded_to(24, low_rounding).double_word()};
  }
};

table rows_of_512() {
  table t{
      "internal_dsin_la_data_ha",
      "Row j = 0..511, t = 2 pi j/512: (D, H, S, T) with H + D = cos t to 2^-55, H the nearest\n"
      "power of two or 0, and S + T = sin t to 2^-77, T truncated to 24 bits. The cosine of t is\n"
      "the sine 128 rows on.",
      64,
      4,
      {}};
  for (int j = 0; j < 512; ++j) {
    const auto a = sine_and_cosine::at(j, 512, MPFR_RNDZ);
    t.words.insert(t.words.end(), {a.rest, a.head, a.high, a.low});
  }
  return t;
}

table rows_of_64() {
  table t{"__dsin_ep_CoutTab",
          "Row j = 0..63, t = 2 pi j/64: cos t less its head, sin t in two words, the second one\n"
          "rounded to 24 bits, and the head, the nearest power of two or 0.",
          64,
          4,
          {}};
  for (int j = 0; j < 64; ++j) {
    const auto a = sine_and_cosine::at(j, 64, MPFR_RNDN);
    t.words.insert(t.words.end(), {a.rest, a.high, a.low, a.head});
  }
  return t;
}

table slices() {
  table t{
      "__dsin_ep_ReductionTab",
      "By which an integer part is made even: 0, -1; the sign of an argument: 1, -1; splitters\n"
      "3·2^25 and 2^27, pi/4 in two words, 4/pi, 2^12; pi/4 in five words for arguments below\n"
      "2^30 and in four for those below 2^23. From word 20 the binary expansion of 4/pi, of\n"
      "weight 2^200: 25 bits to a word, the lowest bit of the first one at 2^-24. Word 19 is the\n"
      "slice above the first.",
      64,
      4,
      {0x0000000000000000, 0xbff0000000000000, 0x3ff0000000000000, 0xbff0000000000000,
       0x4198000000000000, 0x41a0000000000000, 0x3fe921fb40000000, 0x3e64442d18469899,
       0x3ff45f306dc9c883, 0x40b0000000000000, 0x3fe921fa00000000, 0x3ea5444300000000,
       0xbd373dca00000000, 0xbbf3b39a00000000, 0x3a845c06e0e68948, 0x3fe921fb54000000,
       0x3e010b4612000000, 0xbc2676733c000000, 0x3a61701b839a2520, 0x0000000000000000}};
  const binary_digits octants = binary_digits::over_pi(4.0);
  for (int i = 0; i < 50; ++i) {
    const auto digits = static_cast<double>(octants.word(25 * i, 25));
    t.words.push_back((real(digits) * exp2(real(200 - 24 - 25 * i))).double_word());
  }
  return t;
}

const registration dsin("dsin", [] {
  return std::vector<table>{reduction_rows(), inverse_turn_words(), rows_of_512(), rows_of_64(),
                            slices()};
});

}  // namespace
}  // namespace arbor::lumen::tables
