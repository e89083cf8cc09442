// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Fixed points and digests of the roots, quotients and their powers. As those of the exponentials
/// they are the bodies' steps carried out in exact rational arithmetic with one rounding per
/// operation.
#pragma once

#include <cmath>
#include <limits>

#include "log_cases.hpp"

namespace arbor::lumen::tests {

template <typename U>
struct pair_point {
  U a;
  U b;
  U y;
};

template <typename F, typename U, std::size_t N>
void expect_pairs(const pair_point<U> (&points)[N], location where = location::current()) {
  for (const auto& p : points) expect_v21<F>(p.a, p.b, p.y, none, where);
}

/// FNV-1a over the 1500 result patterns that `pattern` gives for k = 0, 1, …
template <typename Results>
std::uint64_t digest_of(Results pattern) {
  std::uint64_t hash = 0xcbf29ce484222325;
  for (std::uint64_t k = 0; k < 1500; ++k) hash = (hash ^ pattern(k)) * 0x100000001b3;
  return hash;
}

/// Of the patterns first + k·stride. It holds the last bits of constants that points do not show.
template <typename F>
std::uint64_t pattern_digest(part_of<typename F::input_type> first,
                             part_of<typename F::input_type> stride) {
  using T = typename F::input_type;
  using U = part_of<T>;
  return digest_of([=](std::uint64_t k) {
    const T x = element<T>::value(static_cast<U>(first + k * stride));
    T y = unwritten<T>();
    F::call(&x, &y);
    return std::bit_cast<U>(y);
  });
}

/// Over all positive numbers, the first one denormal.
template <typename F>
std::uint64_t positive_digest() {
  if constexpr (sizeof(typename F::input_type) == 4) {
    return pattern_digest<F>(0x00000fff, 0x7f7fffff / 1500 - 3);
  } else {
    return pattern_digest<F>(0x0000123456789abc, 0x7fefffffffffffff / 1500 - 12345);
  }
}

/// Zeros have a pole of their sign, infinities a zero of their sign.
template <typename F>
void expect_reciprocal_of_zeros_and_infinities(location where = location::current()) {
  using n = named<part_of<typename F::input_type>>;
  expect_v11<F>(0, n::inf, pole, where);
  expect_v11<F>(n::sign, n::inf | n::sign, pole, where);
  expect_v11<F>(n::inf, 0, none, where);
  expect_v11<F>(n::inf | n::sign, n::sign, none, where);
}

/// The main path's value stands for the numbers whose magnitude is from `lowest` to `highest`.
template <typename F>
void expect_main_path_of_magnitudes(part_of<typename F::input_type> lowest,
                                    part_of<typename F::input_type> highest,
                                    location where = location::current()) {
  using T = typename F::input_type;
  using U = part_of<T>;
  using n = named<U>;
  const auto expect = [where](U p, bool stands) {
    for (const U pattern : {p, U(p | n::sign)}) {
      const T x = element<T>::value(pattern);
      if ((F::main(x).rare == 0) != stands)
        ADD_FAILURE_AT(where.file, where.line) << functor_name<F>() << " main path at " << x;
    }
  };
  for (const U p : {lowest, n::one, highest}) expect(p, true);
  for (const U p : {U(0), U(1), U(lowest - 1), U(highest + 1), n::inf, n::nan}) expect(p, false);
}

/// x = 2^(k·step) gives 2^(k·result_step), exactly and with status 0, at every normal x whose
/// result is normal too.
template <typename F>
void expect_exact_powers(int step, int result_step, location where = location::current()) {
  using T = typename F::input_type;
  using limits = std::numeric_limits<T>;
  const auto normal = [](int e) {
    return e >= limits::min_exponent - 1 && e < limits::max_exponent;
  };
  for (int k = -2000; k <= 2000; ++k) {
    if (normal(k * step) && normal(k * result_step))
      expect_number<F>(std::ldexp(T(1), k * step), std::ldexp(T(1), k * result_step), 0, where);
  }
}

/// Results are even, or odd, in the sign bit.
template <typename F>
void expect_symmetry(bool odd, location where = location::current()) {
  using T = typename F::input_type;
  using U = part_of<T>;
  pattern_source<U> source(11);
  for (int i = 0; i < 2000; ++i) {
    const U p = source.finite() & ~named<U>::sign;
    const T x = element<T>::value(p);
    T y = unwritten<T>();
    const std::uint32_t status = F::call(&x, &y);
    expect_v11<F>(p | named<U>::sign, std::bit_cast<U>(y) | (odd ? named<U>::sign : U(0)), status,
                  where);
  }
}

}  // namespace arbor::lumen::tests
