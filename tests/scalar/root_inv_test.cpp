// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/root/inv.hpp"

#include "quad.hpp"
#include "root_points.hpp"
#include "scalar/root/sqr.hpp"
#include "scalar/root/sqrt.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::inv_d;
using scalar::inv_s;
using scalar::sqr_d;
using scalar::sqr_s;
using scalar::sqrt_d;
using scalar::sqrt_s;
using scalar::tier;

constexpr point_of<std::uint64_t> inv_d_ha_points[] = {
    {0x3ff0000000000000, 0x3ff0000000000000}, {0x4000000000000000, 0x3fe0000000000000},
    {0xbff0000000000001, 0xbfeffffffffffffe}, {0x3fffffffffffffff, 0x3fe0000000000001},
    {0x0020000000000000, 0x7fc0000000000000}, {0x001fffffffffffff, 0x7fc0000000000001},
    {0x7fcfffffffffffff, 0x0010000000000001}, {0x7fd0000000000000, 0x0010000000000000},
    {0xffd0000000000001, 0x800fffffffffffff}, {0x0000000000000001, 0x7ff0000000000000},
    {0x0003ffffffffffff, 0x7ff0000000000000}, {0x0004000000000001, 0x7feffffffffffff8},
    {0x000fffffffffffff, 0x7fd0000000000001}, {0x7fefffffffffffff, 0x0004000000000000},
    {0x4008000000000000, 0x3fd5555555555555}, {0x7963a6f252e6b438, 0x067a0d9b299b0bad},
    {0x5361d2286513270e, 0x2c7cbaf29d05b1f3}, {0xe92f8412128b2f33, 0x96b03eeaa05f6a4b},
    {0xaedee4fc1818e811, 0xd1009292435b2296}, {0xf4812eca0ed90475, 0x8b5dcc1b322eb498},
    {0x04dca86c36f675cc, 0x7b01ddad75247547}, {0x3596aa4d6f03675a, 0x4a4696f38125c14f},
    {0x8bac7bec3d9c1724, 0xf431f996ca5e6886}, {0x87a0eedb6cad4a26, 0xf83e3c9bc7cf02db},
};
constexpr point_of<std::uint64_t> inv_d_la_points[] = {
    {0x3ff0000000000000, 0x3ff0000000000000}, {0x4000000000000000, 0x3fe0000000000000},
    {0xbff0000000000001, 0xbfeffffffffffffe}, {0x3fffffffffffffff, 0x3fe0000000000000},
    {0x0020000000000000, 0x7fc0000000000000}, {0x001fffffffffffff, 0x7fc0000000000001},
    {0x7fcfffffffffffff, 0x0010000000000000}, {0x7fd0000000000000, 0x0010000000000000},
    {0xffd0000000000001, 0x800fffffffffffff}, {0x0000000000000001, 0x7ff0000000000000},
    {0x0003ffffffffffff, 0x7ff0000000000000}, {0x0004000000000001, 0x7feffffffffffff8},
    {0x000fffffffffffff, 0x7fd0000000000001}, {0x7fefffffffffffff, 0x0004000000000000},
    {0x4008000000000000, 0x3fd5555555555555}, {0x8fe8be1190c192cf, 0xeff4b174045bb29b},
    {0xd0c8599c39263059, 0xaf1506d327ddfb07}, {0x795e86d4953f48f1, 0x0680c5afc027d7da},
    {0x4b03057a93bd04cf, 0x34daeac3b9717bd9}, {0x7d05ed660cb1e29c, 0x02d7598f951c55c0},
    {0xc750cb9f0becd7b0, 0xb88e7c0b2ae81c70}, {0x2521eacb2217bead, 0x5abc9371b995d672},
    {0x454531f624ede6a4, 0x3a98280d7f5037a3}, {0xa78c551c92276658, 0xd8521236462103cd},
};
constexpr point_of<std::uint64_t> inv_d_ep_points[] = {
    {0x3ff0000000000000, 0x3ff0000000000000}, {0x4000000000000000, 0x3fe0000000000000},
    {0xbff0000000000001, 0xbfeffffffffffffe}, {0x3fffffffffffffff, 0x3fe0000000000000},
    {0x0020000000000000, 0x7fc0000000000000}, {0x001fffffffffffff, 0x7fc0000000000001},
    {0x7fcfffffffffffff, 0x0010000000000000}, {0x7fd0000000000000, 0x0010000000000000},
    {0xffd0000000000001, 0x800fffffffffffff}, {0x0000000000000001, 0x7ff0000000000000},
    {0x0003ffffffffffff, 0x7ff0000000000000}, {0x0004000000000001, 0x7feffffffffffff8},
    {0x000fffffffffffff, 0x7fd0000000000001}, {0x7fefffffffffffff, 0x0004000000000000},
    {0x4008000000000000, 0x3fd5555555555555}, {0x575bdd4ad0eda82f, 0x28825feb5f9bce30},
    {0xca81dfc81a61dbe2, 0xb55ca50c988fd459}, {0x181c2862a38fd547, 0x67c22eeaa261fdf0},
    {0xc62c7d9418f135d2, 0xb9b1f88b600bd12a}, {0x484d38611012f037, 0x379185a8c52e81fd},
    {0x1a6cdaef9e7769b1, 0x6571be66e15db221}, {0x441f68b1ae2eb154, 0x3bc04d139a0c6b32},
    {0x2845f977c6f87718, 0x57974cbc78b6ff53}, {0x764353c395e761d1, 0x099a7dbc8e873979},
};

TEST(InvDouble, Points) {
  expect_points<inv_d<tier::ha>>(inv_d_ha_points);
  expect_points<inv_d<tier::la>>(inv_d_la_points);
  expect_points<inv_d<tier::ep>>(inv_d_ep_points);
}

TEST(InvDouble, Digest) {
  const std::uint64_t first = 0x0010123456789abc, stride = 0x7fefffffffffffff / 1500 - 12345;
  EXPECT_EQ((pattern_digest<inv_d<tier::ha>>(first, stride)), 0xc2c02c2759a87a13u);
  EXPECT_EQ((pattern_digest<inv_d<tier::la>>(first, stride)), 0xc2c02c2759a87a13u);
  EXPECT_EQ((pattern_digest<inv_d<tier::ep>>(first, stride)), 0x1164b7f8caef932eu);
}

template <typename Body>
class InvOfAnyTier : public ::testing::Test {};
using inv_bodies = ::testing::Types<inv_s, inv_d<tier::ha>, inv_d<tier::la>, inv_d<tier::ep>>;
TYPED_TEST_SUITE(InvOfAnyTier, inv_bodies);

TYPED_TEST(InvOfAnyTier, Specials) {
  expect_reciprocal_of_zeros_and_infinities<TypeParam>();
  expect_quiet_nans<TypeParam>();
}

TEST(InvFloat, IsTheDivisionAlsoOfDenormals) {
  for (const auto p : notable_patterns<std::uint32_t>()) {
    const auto x = std::bit_cast<float>(p);
    if (x == 0 || std::isnan(x)) continue;
    expect_v11<inv_s>(p, std::bit_cast<std::uint32_t>(static_cast<float>(1.0 / double{x})));
  }
}

TEST(InvDouble, MainPathBetweenTheExtremes) {
  expect_main_path_of_magnitudes<inv_d<tier::la>>(0x0020000000000000, 0x7fcfffffffffffff);
  expect_main_path_of_magnitudes<inv_d<tier::ep>>(0x0020000000000000, 0x7fcfffffffffffff);
}

template <typename F>
void expect_square(location where = location::current()) {
  using T = typename F::input_type;
  using U = part_of<T>;
  using n = named<U>;
  pattern_source<U> source(3);
  for (int i = 0; i < 5000; ++i) {
    const T x = element<T>::value(source.finite());
    expect_number<F>(x, x * x, none, where);
  }
  for (const U sign : {U(0), n::sign}) {
    expect_v11<F>(sign, 0, none, where);
    expect_v11<F>(n::inf | sign, n::inf, none, where);
    expect_v11<F>(n::largest | sign, n::inf, none, where);
    expect_v11<F>(1 | sign, 0, none, where);
  }
  expect_quiet_nans<F>(where);
}

TEST(Sqr, IsTheRoundedSquareWithoutStatus) {
  expect_square<sqr_s>();
  expect_square<sqr_d>();
}

/// The nearest number to the root is the one whose neighbours' midpoints enclose it.
template <typename F>
void expect_root(location where = location::current()) {
  using T = typename F::input_type;
  using U = part_of<T>;
  using n = named<U>;
  pattern_source<U> source(4);
  for (int i = 0; i < 5000; ++i) {
    const U p = source.finite() & ~n::sign;
    const T x = element<T>::value(p);
    T y = unwritten<T>();
    EXPECT_EQ(F::call(&x, &y), 0u);
    if (!(root_ulps(y, static_cast<quad>(x)) <= 0.5))
      ADD_FAILURE_AT(where.file, where.line) << functor_name<F>() << hex(element<T>::parts(x));
  }
  expect_v11<F>(0, 0, none, where);
  expect_v11<F>(n::sign, n::sign, none, where);
  expect_v11<F>(n::inf, n::inf, none, where);
  expect_number<F>(T(2.25), T(1.5), none, where);
  for (const U x : negative_patterns<U>()) expect_v11<F>(x, n::any_nan, domain, where);
  for (const U x : {n::nan, n::signalling, n::any_nan}) {
    expect_v11<F>(x, n::any_nan, none, where);
    expect_v11<F>(x | n::sign, n::any_nan, domain, where);
  }
}

TEST(Sqrt, IsCorrectlyRoundedAndFlagsEverySignBitButThatOfZero) {
  expect_root<sqrt_s>();
  expect_root<sqrt_d>();
}

}  // namespace
