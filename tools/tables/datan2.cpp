// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables of the angles of points, atan2 and atan2pi at double, and of atanpi.

#include "real.hpp"
#include "table.hpp"

namespace arbor::lumen::tables {
namespace {

void add_words(table& t, const real& x) {
  const double_words words = split(x);
  t.words.insert(t.words.end(), {words.high, words.low});
}

/// The angle whose tangent is j/64, over `unit`.
table ratios(const std::string& name, const real& unit, const std::string& angle) {
  table t{name, "Row j = 0..64, for the ratio j/64: " + angle + " in two words.", 64, 2, {}};
  for (int j = 0; j <= 64; ++j) add_words(t, atan(real::ratio(j, 64)) / unit);
  return t;
}

/// B + s atan k for the three k of each octant, over `unit`.
table octants(const std::string& name, const real& unit, const std::string& angle) {
  table t{name,
          "Row 3i + j, two words of " + angle +
              ": octant i of the point, by the sign of the abscissa\n"
              "and whether the ordinate is larger, and tangent k = j/2: atan k, pi/2 - atan k,\n"
              "pi - atan k, pi/2 + atan k for i = 0..3.",
          64,
          2,
          {}};
  const real half = real::pi() / real(2);
  for (int i = 0; i < 4; ++i) {
    const real base = i == 0 ? real(0) : (i == 2 ? real::pi() : half);
    for (int j = 0; j < 3; ++j) {
      const real angle_of_k = atan(real::ratio(j, 2));
      add_words(t, (i == 0 || i == 3 ? base + angle_of_k : base - angle_of_k) / unit);
    }
  }
  return t;
}

table segments() {
  table t{"internal_datanpi_ha_data",
          "Row i, for an angle with tangent a: k, the mask of a and of 1 in (a - k)/(ka + 1), and\n"
          "atan(k)/pi in two words. Row 0, the largest a: -1/a, and 1/2.",
          64,
          4,
          {}};
  t.words = {real(1).double_word(), 0, real(0.5).double_word(), 0};
  for (const double k : {1.5, 1.0, 0.5, 0.0}) {
    t.words.insert(t.words.end(), {real(k).double_word(), ~std::uint64_t{0}});
    add_words(t, atan(real(k)) / real::pi());
  }
  return t;
}

const registration datan2("datan2", [] {
  return std::vector<table>{ratios("__datan2_la_CoutTab", real(1), "the angle"),
                            ratios("__datan2pi_la_CoutTab", real::pi(), "the angle over pi"),
                            octants("internal_datan2_ha_data", real(1), "an angle"),
                            octants("internal_datan2pi_ha_data", real::pi(), "an angle over pi"),
                            segments()};
});

}  // namespace
}  // namespace arbor::lumen::tables
