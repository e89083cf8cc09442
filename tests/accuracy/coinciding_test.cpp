// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Functors whose arithmetic is the same under two labels are one body by construction: the base of
/// both is one type, so that no bit of them can differ.

#include <gtest/gtest.h>

#include <type_traits>

#include "scalar/block_loop.hpp"
#include "scalar/generated/all.hpp"

namespace {

namespace scalar = arbor::lumen::vm::detail::gpu::norvane::scalar;

template <typename A, typename B>
constexpr bool share_body =
    !std::is_void_v<scalar::block_loop_of<A>> &&
    std::is_same_v<scalar::block_loop_of<A>, scalar::block_loop_of<B>>;

#define EXPECT_SHARED(a, b) EXPECT_TRUE((share_body<scalar::a, scalar::b>)) << #a " and " #b
#define EXPECT_APART(a, b) EXPECT_FALSE((share_body<scalar::a, scalar::b>)) << #a " and " #b

TEST(CoincidingBodies, WithoutDoubleWhereNoneIsNeeded) {
  EXPECT_SHARED(ln_s_ha_nofp64, ln_s_ha_gen);
  EXPECT_SHARED(ln_s_la_nofp64, ln_s_la_gen);
  EXPECT_SHARED(ln_s_ep_nofp64, ln_s_ep_gen);
  EXPECT_SHARED(log2_s_la_nofp64, log2_s_la_gen);
  EXPECT_SHARED(log2_s_ep_nofp64, log2_s_ep_gen);
  EXPECT_SHARED(log10_s_la_nofp64, log10_s_la_gen);
  EXPECT_SHARED(log10_s_ep_nofp64, log10_s_ep_gen);
  EXPECT_SHARED(expm1_s_ha_nofp64, expm1_s_ha_gen);
  EXPECT_SHARED(expm1_s_la_nofp64, expm1_s_la_gen);
  EXPECT_SHARED(expm1_s_ep_nofp64, expm1_s_ep_gen);
  EXPECT_SHARED(div_s_la_nofp64, div_s_la_gen);
  EXPECT_SHARED(div_s_ep_nofp64, div_s_ep_gen);
}

TEST(CoincidingBodies, WithoutTablesWhereThereAreNone) {
  EXPECT_SHARED(ln_d_la_nolut, ln_d_la_gen);
  EXPECT_SHARED(ln_d_ep_nolut, ln_d_ep_gen);
  EXPECT_SHARED(exp_d_la_nolut, exp_d_la_gen);
  EXPECT_SHARED(powr_s_la_nolut, powr_s_la_gen);
}

TEST(CoincidingBodies, PowersOfFloats) {
  EXPECT_SHARED(pow_s_ha_nolut, pow_s_ha_fp64only);
  EXPECT_SHARED(powx_s_la_nolut, powx_s_la_fp64only);
  EXPECT_SHARED(powx_s_ep_nolut, powx_s_ep_fp64only);
}

TEST(CoincidingBodies, TiersOfThePowerWithoutTable) {
  EXPECT_SHARED(pow_d_la_nolut, pow_d_ep_nolut);
  EXPECT_SHARED(powr_d_la_nolut, powr_d_ep_nolut);
  EXPECT_SHARED(powx_d_la_nolut, powx_d_ep_nolut);
}

TEST(CoincidingBodies, OthersAreBodiesOfTheirOwn) {
  EXPECT_APART(log2_s_ha_fp64only, log2_s_la_gen);
  EXPECT_APART(log2_d_la_nolut, log2_d_la_gen);
  EXPECT_APART(pow_d_la_nolut, pow_d_la_gen);
  EXPECT_APART(pow_d_ha_nolut, pow_d_la_nolut);
  EXPECT_APART(powr_s_ha_nolut, powr_s_ha_fp64only);
}

}  // namespace
