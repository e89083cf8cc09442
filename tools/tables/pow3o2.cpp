// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of pow3o2.

#include "table.hpp"
#include "thirty_seconds.hpp"

namespace arbor::lumen::tables {
namespace {

void append_rows(std::vector<std::uint64_t>& words, int word_bits) {
  append_reciprocals(words, -1, word_bits);
  for (int k = 0; k < 3; ++k) {
    for (int i = 0; i < 32; ++i) append_pair(words, power_of_row(k, i, 3, 2), word_bits);
  }
}

const char* const rows =
    "-1/c, i = 0..31, for the middle c of the i-th of 32 intervals of [1, 2), and from word %\n"
    "(2^k c)^(3/2), k = 0..2, in two words at 2(32k + i); exponents are even or odd, so k = 2 is\n"
    "not read. At the end the scale of results that may be denormal, 2^60, what it leaves in the\n"
    "result, 2^-90, and -0.";

std::string with_word(const std::string& text, const std::string& word) {
  std::string result = text;
  result.replace(result.find('%'), 1, word);
  return result;
}

table rows_s() {
  table t{"_arrsPow3o2SHATab",
          "Words 0 to 4: the polynomial of (1 + g)^(3/2) - 1 from g^5 to g^1. From word 5\n" +
              with_word(rows, "37"),
          32,
          4,
          {0xbc400465, 0x3cc00366, 0xbd800000, 0x3ec00000, 0x3fc00000}};
  append_rows(t.words, 32);
  t.words.insert(t.words.end(), {0x5d800000, 0x12800000, 0x80000000});
  return t;
}

table rows_d() {
  table t{"_arrsPow3o2HATab",
          "Words 0 to 7: the series of (1 + g)^(3/2) from g^8 to g^1. From word 8\n" +
              with_word(rows, "40"),
          64,
          4,
          {}};
  for (const real& c : binomial_series(3, 2, 8)) t.words.push_back(c.double_word());
  append_rows(t.words, 64);
  t.words.insert(t.words.end(), {0x43b0000000000000, 0x3a50000000000000, 0x8000000000000000});
  return t;
}

const registration pow3o2("pow3o2", [] { return std::vector<table>{rows_s(), rows_d()}; });

}  // namespace
}  // namespace arbor::lumen::tables
