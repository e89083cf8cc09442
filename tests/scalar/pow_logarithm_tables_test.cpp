// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The tables of the powers: known rows to the bit, and every row against its rule.

#include <cmath>
#include <iterator>

#include "bits.hpp"
#include "quad.hpp"
#include "scalar/pow/fixed_point_power.hpp"
#include "scalar/pow/nolut_polynomial.hpp"
#include "scalar/tables/dpow.hpp"
#include "scalar/tables/spow.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

quad value_of(std::uint32_t pattern) { return std::bit_cast<float>(pattern); }
quad value_of(std::uint64_t pattern) { return std::bit_cast<double>(pattern); }

/// ln x for 1/4 < x < 4, to about 110 bits: by the series of 2·artanh((x - 1)/(x + 1)).
quad natural(quad x) {
  const quad z = (x - 1) / (x + 1);
  quad term = 2 * z, sum = 0;
  for (int k = 1; k < 300; k += 2, term *= z * z) sum += term / k;
  return sum;
}
quad binary(quad x) { return natural(x) / natural(2); }

/// 2^f for 0 <= f < 1, by the series of e^(f ln 2).
quad power_of_two(quad f) {
  const quad z = f * natural(2);
  quad term = 1, sum = 1;
  for (int k = 1; k < 60; ++k) {
    term *= z / k;
    sum += term;
  }
  return sum;
}

double size(quad x) { return std::fabs(static_cast<double>(x)); }

bool is_multiple(quad x, int exponent) {
  const double scaled = std::ldexp(static_cast<double>(x), -exponent);
  return scaled == std::floor(scaled);
}

/// high + low = -log2(c) + offset.
template <typename U>
void expect_log2(U high, U low, quad c, int offset, int unit, double error) {
  EXPECT_LT(size(value_of(high) + value_of(low) + binary(c) - offset), error + 0x1p-104)
      << static_cast<double>(c);
  EXPECT_TRUE(is_multiple(value_of(high), unit)) << static_cast<double>(c);
}

/// high + low = 2^f.
template <typename U>
void expect_root(U high, U low, quad f, double error) {
  EXPECT_LT(size(value_of(high) + value_of(low) - power_of_two(f)), error + 0x1p-108);
}

TEST(PowTables, FloatRows) {
  using scalar::__spow_ha_log_tbl;
  ASSERT_EQ(std::size(__spow_ha_log_tbl), 514u);
  const std::uint32_t known[][3] = {
      {0, 0xc2fc0000, 0x00000000}, {1, 0xc2fc02e2, 0x36c77251}, {256, 0xc2fe0000, 0x80000000}};
  for (const auto& row : known) {
    EXPECT_EQ(__spow_ha_log_tbl[2 * row[0]], row[1]);
    EXPECT_EQ(__spow_ha_log_tbl[2 * row[0] + 1], row[2]);
  }
  for (int j = 0; j <= 256; ++j)
    expect_log2(__spow_ha_log_tbl[2 * j], __spow_ha_log_tbl[2 * j + 1], quad(256 + j) / 256, -126,
                -16, 2.3e-13);
}

TEST(PowTables, IntegerRows) {
  for (int i = 0; i <= 16; ++i) {
    const double factor = scalar::__spow_ha___rcp_tbl[i] + 1;
    EXPECT_NEAR(factor * (16 + i), 4096, 20) << i;
    const double units = static_cast<double>(scalar::__spow_ha___log2_tbl[i]);
    EXPECT_NEAR(units, -std::log2(factor / 256) * 0x1p55, 20) << i;
  }
  EXPECT_EQ(scalar::__spow_ha___log2_tbl[0], 0u);
  EXPECT_EQ(scalar::__spow_ha___log2_tbl[1], 0x000b2671360338acu);
  EXPECT_EQ(scalar::__spow_ha___log2_tbl[16], 0x0080000000000000u);
}

TEST(PowTables, FloatRareRows) {
  const auto* w = scalar::__spow_ep_CoutTab;
  ASSERT_EQ(std::size(scalar::__spow_ep_CoutTab), 380u);
  const quad scale = value_of(w[357]);
  for (int i = 0; i <= 32; ++i) {
    EXPECT_EQ(static_cast<double>(value_of(w[i])), std::round(1024 * 32.0 / (32 + i)) / 1024);
    expect_log2(w[33 + 2 * i], w[34 + 2 * i], value_of(w[i]), 0, -15, 0x1p-40);
  }
  for (int i = 0; i <= 64; ++i) {
    const double m = i <= 24 ? 1 + i / 1024.0 : 1 - (64 - i) / 2048.0;
    EXPECT_NEAR(static_cast<double>(value_of(w[99 + i]) * m / scale), 1, 0x1p-15) << i;
    expect_log2(w[164 + 2 * i], w[165 + 2 * i], value_of(w[99 + i]) / scale, 0, -60, 0x1p-52);
  }
  // No logarithm next to 1 but that of the rest.
  EXPECT_EQ(w[99], w[357]);
  EXPECT_EQ(w[163], w[357]);
  for (const int word : {164, 165, 292, 293}) EXPECT_EQ(w[word], 0u);
  for (int j = 0; j < 32; ++j) expect_root(w[294 + 2 * j], w[293 + 2 * j], quad(j) / 32, 0x1p-48);
}

TEST(PowTables, DoubleRowsLa) {
  const auto* w = scalar::internal_dpow_la_data;
  ASSERT_EQ(std::size(scalar::internal_dpow_la_data), 1282u);
  for (int r = 512; r <= 1024; ++r)
    expect_log2(w[2 * (r - 512)], w[2 * (r - 512) + 1], quad(r) / 1024, -1023, -43, 3.2e-30);
  EXPECT_EQ(w[0], 0xc08ff00000000000);
  EXPECT_EQ(w[1], 0u);
  EXPECT_EQ(w[1024], 0xc08ff80000000000);
  EXPECT_EQ(w[1025], 0u);
  for (int i = 0; i < 256; ++i) expect_root(w[0x402 + i], std::uint64_t{0}, quad(i) / 256, 0x1p-53);
}

TEST(PowTables, DoubleRowsHa) {
  const auto* w = scalar::internal_dpow_ha_data;
  ASSERT_EQ(std::size(scalar::internal_dpow_ha_data), 3332u);
  const quad scale = value_of(std::uint64_t{0x3ff7154740000000});
  EXPECT_EQ(w[0], 0x3ff7154740000000);
  EXPECT_EQ(w[1024], 0x3fe7154740000000);
  for (const int j : {0, 1024}) {
    EXPECT_EQ(w[1026 + 2 * j], 0u);
    EXPECT_EQ(w[1027 + 2 * j], 0u);
  }
  for (int j = 0; j <= 1024; ++j) {
    EXPECT_EQ(w[j] & 0x7ffffff, 0u) << j;
    EXPECT_NEAR(static_cast<double>(value_of(w[j]) * (1024 + j) / 1024 / scale), 1, 0x1p-26) << j;
    expect_log2(w[1026 + 2 * j], w[1027 + 2 * j], value_of(w[j]) / scale, j >= 512 ? -1 : 0, -42,
                6.4e-30);
  }
  // At byte 0x6020.
  for (int i = 0; i < 128; ++i)
    expect_root(w[0x6020 / 8 + 2 * i], w[0x6020 / 8 + 2 * i + 1], quad(i) / 128, 2.6e-32);
}

TEST(PowTables, DoubleRowsEp) {
  const auto* w = scalar::internal_dpow_ep_data;
  ASSERT_EQ(std::size(scalar::internal_dpow_ep_data), 2561u);
  for (int r = 512; r <= 1024; ++r) {
    const quad exact = -natural(quad(r) / (r <= 724 ? 512 : 1024));
    EXPECT_EQ(std::bit_cast<double>(w[r - 512]), static_cast<double>(exact)) << r;
  }
  for (int i = 0; i < 2048; ++i) expect_root(w[513 + i], std::uint64_t{0}, quad(i) / 2048, 0x1p-53);
}

TEST(PowTables, DoubleRareRows) {
  const auto* w = scalar::__dpow_ha_CoutTab;
  ASSERT_EQ(std::size(scalar::__dpow_ha_CoutTab), 860u);
  EXPECT_EQ(w[0], 0x3ff0000000000000);
  EXPECT_EQ(w[1], 0x3fef07c000000000);
  EXPECT_EQ(w[2], 0x3fee1e0000000000);
  EXPECT_EQ(w[32], 0x3fe0000000000000);
  for (int i = 0; i <= 32; ++i) {
    EXPECT_EQ(static_cast<double>(value_of(w[i])), std::round(0x1p15 * 32 / (32 + i)) * 0x1p-15);
    expect_log2(w[0x21 + 2 * i], w[0x22 + 2 * i], value_of(w[i]), 0, -40, 2.6e-29);
    const double m = i <= 12 ? 1 + i / 512.0 : 1 - (32 - i) / 1024.0;
    EXPECT_EQ(static_cast<double>(value_of(w[0x63 + i])), std::round(0x1p20 / m) * 0x1p-20);
    expect_log2(w[0x84 + 2 * i], w[0x85 + 2 * i], value_of(w[0x63 + i]), 0, -40, 2.6e-29);
  }
  const quad scale = value_of(w[856]);
  EXPECT_EQ(w[0xc6], w[856]);
  EXPECT_EQ(w[0xc6 + 128], w[856]);
  for (int i = 0; i <= 128; ++i) {
    const double m = i <= 48 ? 1 + i / 32768.0 : 1 - (128 - i) / 65536.0;
    EXPECT_NEAR(static_cast<double>(value_of(w[0xc6 + i]) * m / scale), 1, 0x1p-26) << i;
    expect_log2(w[0x147 + 2 * i], w[0x148 + 2 * i], value_of(w[0xc6 + i]) / scale, 0, -40, 2.6e-29);
  }
  for (const int word : {0x147, 0x148, 583, 584}) EXPECT_EQ(w[word], 0u);
  for (int j = 0; j < 128; ++j) expect_root(w[585 + 2 * j], w[584 + 2 * j], quad(j) / 128, 2.6e-32);
  const std::uint64_t constants[] = {
      0x3c62eb74966579e7, 0x3e79c3a6966457e8, 0xbfd62e4346694107, 0x3fc47fd462b6dee1,
      0xbfb550472a9012d8, 0x3fe62e42fefa39ef, 0x3fcebfbdff82c58f, 0x3fac6b08d704a0c0,
      0x3f83b2ab6fba4e77, 0x3f55d87fe78a6731, 0x7fe0000000000000, 0x0010000000000000,
      0x0000000000000000, 0x3ff0000000000000, 0xbff0000000000000, 0x42c8000000000000,
      0x3ff7154740000000, 0x41a0000002000000, 0x4c70000000000000, 0x3370000000000000};
  EXPECT_TRUE(std::equal(std::begin(constants), std::end(constants), w + 840));
}

/// ln(1 + t) by the fitted polynomial of `ha`.
TEST(PowTables, FittedPolynomial) {
  for (int k = -1000; k <= 1000; ++k) {
    if (k == 0) continue;
    const quad t = quad(k) / 9000;
    quad p = 0;
    for (const std::uint64_t c : scalar::nolut_power_polynomial) p = p * t + value_of(c);
    const quad two_thirds = value_of(std::uint64_t{0x3fe5555555555555});
    const quad ln = t - t * t / 2 + t * t * t / 2 * (two_thirds + p);
    EXPECT_LT(size((ln - natural(1 + t)) / t), 1.5e-21) << k;
  }
}

}  // namespace
