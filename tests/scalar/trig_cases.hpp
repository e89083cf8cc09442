// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// What the tests of the trigonometric functions share.
#pragma once

#include "exp_points.hpp"
#include "trig_hard_arguments.hpp"
#include "trig_reference.hpp"

namespace arbor::lumen::tests {

inline constexpr std::uint32_t domain = 1;

/// An argument with its sine and cosine.
template <typename U>
struct pair_of {
  U x;
  U sine;
  U cosine;
};

template <typename F, typename U, std::size_t N>
void expect_pairs(const pair_of<U> (&points)[N], location where = location::current()) {
  for (const auto& p : points) expect_v12<F>(p.x, p.sine, p.cosine, none, where);
}

/// Every result of a functor of one or of two results.
template <typename F, typename U>
void expect_every_result(U x, U y, std::uint32_t status, location where = location::current()) {
  if constexpr (requires(typename F::input_type * r) { F::call(r, r, r); }) {
    expect_v12<F>(x, y, y, status, where);
  } else {
    expect_v11<F>(x, y, status, where);
  }
}

/// The main path serves magnitudes up to `highest`, and neither infinities nor NaNs.
template <typename F, typename U>
void expect_main_path_up_to(U highest, location where = location::current()) {
  using n = named<U>;
  for (const U sign : {U(0), n::sign}) {
    const auto expect = [&](U p, bool stands) {
      const auto x = element<typename F::input_type>::value(p | sign);
      if ((F::main(x).rare == 0) != stands)
        ADD_FAILURE_AT(where.file, where.line) << functor_name<F>() << " main path at " << x;
    };
    expect(0, true);
    expect(1, true);
    expect(n::one, true);
    expect(highest, true);
    expect(highest + 1, false);
    expect(n::largest, false);
    expect(n::inf, false);
    expect(n::nan, false);
    expect(n::any_nan, false);
  }
}

/// Infinities give a NaN of any kind and code 1; NaNs a quiet one.
template <typename F>
void expect_any_nan_of_infinity(location where = location::current()) {
  using U = part_of<typename F::input_type>;
  using n = named<U>;
  for (const U sign : {U(0), n::sign}) {
    expect_every_result<F, U>(n::inf | sign, n::any_nan, domain, where);
    for (const U p : {n::nan, n::signalling, n::any_nan})
      expect_every_result<F, U>(p | sign, n::any_nan, none, where);
  }
}

/// Infinities and NaNs give their own pattern made quiet; infinities have code 1.
template <typename F>
void expect_own_pattern_of_infinity(location where = location::current()) {
  using U = part_of<typename F::input_type>;
  using n = named<U>;
  for (const U sign : {U(0), n::sign}) {
    expect_every_result<F, U>(n::inf | sign, n::nan | sign, domain, where);
    for (const U p : {n::nan, n::signalling, U(n::nan + 5)})
      expect_every_result<F, U>(p | sign, p | sign | n::quiet_bit, none, where);
  }
}

/// Infinities give the negative NaN and code 1; NaNs are quietened and lose their sign.
template <typename F>
void expect_negative_nan_of_infinity(location where = location::current()) {
  using U = part_of<typename F::input_type>;
  using n = named<U>;
  for (const U sign : {U(0), n::sign}) {
    expect_every_result<F, U>(n::inf | sign, n::nan | n::sign, domain, where);
    for (const U p : {n::nan, n::signalling, U(n::nan + 5)})
      expect_every_result<F, U>(p | sign, p | n::quiet_bit, none, where);
  }
}

/// Zeros and denormals are their own sine and tangent.
template <typename F>
void expect_odd_zero(location where = location::current()) {
  using U = part_of<typename F::input_type>;
  using n = named<U>;
  for (const U sign : {U(0), n::sign}) {
    for (const U p : {U(0), U(1), U(n::smallest_normal - 1), n::smallest_normal})
      expect_v11<F>(p | sign, p | sign, none, where);
  }
}

}  // namespace arbor::lumen::tests
