// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Functors of the powers that are one body under several names, or differ in the rare path alone.

#include <type_traits>

#include "bits.hpp"
#include "scalar/generated/pow.hpp"
#include "scalar/generated/powr.hpp"
#include "scalar/generated/powx.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

/// One body by construction: the functors derive from the same type.
template <typename F, typename G, typename Body>
constexpr bool share = std::is_base_of_v<Body, F>&& std::is_base_of_v<Body, G>;

using scalar::tier;
static_assert(share<scalar::pow_s_ha_nolut, scalar::pow_s_ha_fp64only, scalar::pow_s<tier::ha>>);
static_assert(share<scalar::powr_s_la_nolut, scalar::powr_s_la_gen, scalar::powr_s<tier::la>>);
static_assert(share<scalar::powx_s_la_nolut, scalar::powx_s_la_fp64only, scalar::powx_s<tier::la>>);
static_assert(share<scalar::powx_s_ep_nolut, scalar::powx_s_ep_fp64only, scalar::powx_s<tier::ep>>);
static_assert(share<scalar::pow_h_ha_gen_fp32cast, scalar::pow_h_ep_gen_fp32cast, scalar::pow_h>);

template <typename F, typename T>
std::uint32_t call(T x, T y, T* r) {
  if constexpr (requires { F::call(&x, &y, r); }) {
    return F::call(&x, &y, r);
  } else {
    return F::call(&x, y, r);
  }
}

/// The same result and status for any operands, for those with ordinary powers, and at notable
/// patterns.
template <typename F, typename G>
void expect_same(bool any_base = true) {
  using T = typename F::input_type;
  using U = part_of<T>;
  const auto expect = [any_base](U px, U py) {
    const T x = element<T>::value(any_base ? px : U(px & ~named<U>::sign));
    const T y = element<T>::value(py);
    T r = unwritten<T>(), s = T(0);
    const std::uint32_t first = call<F>(x, y, &r);
    const std::uint32_t second = call<G>(x, y, &s);
    expect_result(std::bit_cast<U>(s), second, r, first, location::current(), functor_name<F>(),
                  functor_name<G>(), x, y);
  };
  pattern_source<U> source(91);
  for (int i = 0; i < 20'000; ++i) {
    expect(source.any(), source.any());
    expect(source.near(named<U>::one, 6), source.near(named<U>::one, 6));
  }
  for (const U x : notable_patterns<U>()) {
    for (const U y : notable_patterns<U>()) expect(x, y);
  }
}

TEST(PowBodies, Coincide) {
  expect_same<scalar::pow_d_la_nolut, scalar::pow_d_ep_nolut>();
  expect_same<scalar::powr_d_la_nolut, scalar::powr_d_ep_nolut>();
  expect_same<scalar::powx_d_la_nolut, scalar::powx_d_ep_nolut>();
  expect_same<scalar::powr_d_la_gen, scalar::powr_d_ha_gen>();
  expect_same<scalar::powx_d_la_gen, scalar::powx_d_ha_gen>();
}

/// powx is pow with a constant exponent.
TEST(PowBodies, ConstantExponent) {
  expect_same<scalar::powx_s_ha_fp64only, scalar::pow_s_ha_fp64only>();
  expect_same<scalar::powx_s_la_fp64only, scalar::pow_s_la_nolut>();
  expect_same<scalar::powx_d_ha_gen, scalar::pow_d_ha_gen>();
  expect_same<scalar::powx_d_ep_gen, scalar::pow_d_ep_gen>();
  expect_same<scalar::powx_d_ha_nolut, scalar::pow_d_ha_nolut>();
}

/// powr differs from pow in special values only.
template <typename F, typename G>
void expect_same_ordinary_powers() {
  using T = typename F::input_type;
  using U = part_of<T>;
  using n = named<U>;
  pattern_source<U> source(92);
  for (int i = 0; i < 40'000; ++i) {
    const U px = i % 2 == 0 ? source.finite() & ~n::sign : source.near(n::one, 6) & ~n::sign;
    const U py = i % 4 < 2 ? source.finite() : source.near(n::one, 6);
    const T x = element<T>::value(px), y = element<T>::value(py);
    if (x == 0 || y == 0) continue;
    T r = unwritten<T>(), s = T(0);
    const std::uint32_t first = call<F>(x, y, &r);
    const std::uint32_t second = call<G>(x, y, &s);
    expect_result(std::bit_cast<U>(s), second, r, first, location::current(), functor_name<F>(),
                  functor_name<G>(), x, y);
  }
}

TEST(PowBodies, NonNegativeBases) {
  expect_same_ordinary_powers<scalar::powr_s_ha_fp64only, scalar::pow_s_ha_fp64only>();
  expect_same_ordinary_powers<scalar::powr_s_la_gen, scalar::pow_s_la_nolut>();
  expect_same_ordinary_powers<scalar::powr_s_ep_gen, scalar::pow_s_ep_gen>();
  expect_same_ordinary_powers<scalar::powr_s_ha_nolut, scalar::powx_s_ha_nolut>();
  expect_same_ordinary_powers<scalar::powr_d_ha_gen, scalar::pow_d_ha_gen>();
  expect_same_ordinary_powers<scalar::powr_d_ep_gen, scalar::pow_d_ep_gen>();
  expect_same_ordinary_powers<scalar::powr_d_ha_nolut, scalar::pow_d_ha_nolut>();
}

}  // namespace
