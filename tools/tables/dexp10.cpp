// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of exp10 at double.

#include "real.hpp"
#include "table.hpp"

namespace arbor::lumen::tables {
namespace {

table roots_la() {
  table t{"internal_dexp10_la_data",
          "Word i is 2^(i/128), i = 0..127, to the nearest; relative error below 9.5e-17.",
          64,
          2,
          {}};
  for (int i = 0; i < 128; ++i) t.words.push_back(exp2(real::ratio(i, 128)).double_word());
  return t;
}

table roots_ha() {
  table t{"internal_dexp10_ha_data",
          "Words 2i and 2i + 1 are the high and the low part of 2^(i/128), i = 0..127; the sum is\n"
          "exact to 5.7e-33 relative.",
          64,
          2,
          {}};
  for (int i = 0; i < 128; ++i) {
    const double_words root = split(exp2(real::ratio(i, 128)));
    t.words.insert(t.words.end(), {root.high, root.low});
  }
  return t;
}

table roots_of_rare_path(const std::string& tier) {
  table t{"__dexp10_" + tier + "__zordExp10Tab",
          "Words 2i and 2i + 1 are high and low in 2^(i/64) = high·(1 + low), i = 0..63, exact to\n"
          "5.4e-33 relative. From word 128 the constants of the rare path: 64 log2 10 and the\n"
          "shifter, the polynomial from its lowest term up, the bounds of +infinity, of normal\n"
          "results and of +0, log10(2)/64 in two words, numbers next to the largest and smallest\n"
          "normal ones, 0, 1, 2, 2^-60 and the splitter 3·2^31.",
          64,
          2,
          {}};
  for (int i = 0; i < 64; ++i) {
    const double_words root = relative_split(exp2(real::ratio(i, 64)));
    t.words.insert(t.words.end(), {root.high, root.low});
  }
  t.words.insert(t.words.end(),
                 {0x406a934f0979a371, 0x4338000000000000, 0x40026bb1bbb55515, 0x40053524c73cd20a,
                  0x4000470591e2bc10, 0x3ff2bd77b840f0bf, 0x3fe1427c87c70a85, 0x40734413509f79fe,
                  0xc0733a7146f72a41, 0xc07439b746e36b52, 0x3f734413509f0000, 0x3d1e7fbcc47c4acd,
                  0x0010000000000001, 0x7fefffffffffffff, 0x0000000000000000, 0x3ff0000000000000,
                  0x4000000000000000, 0x3c30000000000000, 0x41f8000000000000});
  return t;
}

const registration dexp10("dexp10", [] {
  return std::vector<table>{roots_la(), roots_ha(), roots_of_rare_path("ha"),
                            roots_of_rare_path("la"), roots_of_rare_path("ep")};
});

}  // namespace
}  // namespace arbor::lumen::tables
