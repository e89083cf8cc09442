// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Comparison of scalar functors by bit patterns, and sources of arguments.
#pragma once

#include <gtest/gtest.h>

#include <array>
#include <bit>
#include <complex>
#include <cstdint>
#include <cstdlib>
#include <iostream>
#include <random>
#include <sstream>
#include <string>
#include <vector>

namespace arbor::lumen::tests {

/// How an element is written as a pattern: an unsigned integer, for complex elements a pair of
/// them.
template <typename T>
struct element;
template <>
struct element<float> {
  using pattern = std::uint32_t;
  using part = std::uint32_t;
  static float value(pattern p) { return std::bit_cast<float>(p); }
  static std::array<part, 1> parts(float x) { return {std::bit_cast<part>(x)}; }
  static std::array<part, 1> parts(pattern p) { return {p}; }
};
template <>
struct element<double> {
  using pattern = std::uint64_t;
  using part = std::uint64_t;
  static double value(pattern p) { return std::bit_cast<double>(p); }
  static std::array<part, 1> parts(double x) { return {std::bit_cast<part>(x)}; }
  static std::array<part, 1> parts(pattern p) { return {p}; }
};
template <typename R>
struct element<std::complex<R>> {
  using part = typename element<R>::part;
  using pattern = std::array<part, 2>;
  static std::complex<R> value(pattern p) {
    return {std::bit_cast<R>(p[0]), std::bit_cast<R>(p[1])};
  }
  static std::array<part, 2> parts(std::complex<R> z) {
    return {std::bit_cast<part>(z.real()), std::bit_cast<part>(z.imag())};
  }
  static std::array<part, 2> parts(pattern p) { return p; }
};
template <typename T>
using pattern_of = typename element<T>::pattern;
template <typename T>
using part_of = typename element<T>::part;

/// The patterns that tests name.
template <typename U>
struct named;
template <>
struct named<std::uint32_t> {
  static constexpr std::uint32_t sign = 0x80000000, one = 0x3f800000, inf = 0x7f800000,
                                 nan = 0x7fc00000, signalling = 0x7f800001, largest = 0x7f7fffff,
                                 smallest_normal = 0x00800000, any_nan = 0x7fffffff,
                                 quiet_bit = 0x00400000;
};
template <>
struct named<std::uint64_t> {
  static constexpr std::uint64_t sign = 0x8000000000000000, one = 0x3ff0000000000000,
                                 inf = 0x7ff0000000000000, nan = 0x7ff8000000000000,
                                 signalling = 0x7ff0000000000001, largest = 0x7fefffffffffffff,
                                 smallest_normal = 0x0010000000000000, any_nan = 0x7fffffffffffffff,
                                 quiet_bit = 0x0008000000000000;
};

template <typename U>
bool is_quiet_nan(U pattern) {
  return (pattern & ~named<U>::sign) > named<U>::inf && (pattern & named<U>::quiet_bit) != 0;
}

/// `any_nan` as the expected pattern stands for any quiet NaN: where an operation makes or chooses
/// the NaN, its sign and payload are the machine's.
template <typename U>
bool matches(U expected, U actual) {
  return expected == named<U>::any_nan ? is_quiet_nan(actual) : expected == actual;
}
template <typename U, std::size_t N>
bool matches(const std::array<U, N>& expected, const std::array<U, N>& actual) {
  bool all = true;
  for (std::size_t i = 0; i < N; ++i) all = all && matches(expected[i], actual[i]);
  return all;
}

template <typename U, std::size_t N>
std::string hex(const std::array<U, N>& patterns) {
  std::ostringstream text;
  for (const U p : patterns) {
    text << (text.tellp() > 0 ? ", 0x" : "0x") << std::hex;
    text.width(2 * sizeof(U));
    text.fill('0');
    text << p;
    if constexpr (sizeof(U) == 4) text << " (" << std::bit_cast<float>(p) << ")";
    if constexpr (sizeof(U) == 8) text << " (" << std::bit_cast<double>(p) << ")";
  }
  return text.str();
}

/// A value that no test expects: an output that stays unwritten fails.
template <typename T>
T unwritten() {
  using U = part_of<T>;
  if constexpr (std::is_floating_point_v<T>) {
    return element<T>::value(U(0x5aa5a55a));
  } else {
    return element<T>::value({U(0x5aa5a55a), U(0x5aa5a55a)});
  }
}

/// The line of a test that a helper was called from.
struct location {
  const char* file;
  int line;
  static constexpr location current(const char* file = __builtin_FILE(),
                                    int line = __builtin_LINE()) {
    return {file, line};
  }
};

/// Says which functor a message is about.
template <typename F>
const char* functor_name() {
  return __PRETTY_FUNCTION__;
}

/// Compares one result; says all operands on failure. Returns whether it was as expected.
template <typename T, typename... Operands>
bool expect_result(const pattern_of<T>& expected, std::uint32_t expected_status, T actual,
                   std::uint32_t status, location where, const char* functor, const char* result,
                   const Operands&... operands) {
  const auto e = element<T>::parts(expected);
  const auto a = element<T>::parts(actual);
  if (matches(e, a) && status == expected_status) return true;
  std::ostringstream text;
  text << functor << "\n  operands";
  ((text << "  " << hex(element<Operands>::parts(operands))), ...);
  text << "\n  " << result << " expected " << hex(e) << " status " << expected_status << "\n  "
       << result << " is       " << hex(a) << " status " << status;
  ADD_FAILURE_AT(where.file, where.line) << text.str();
  return false;
}

template <typename F>
bool expect_v11(const pattern_of<typename F::input_type>& x,
                const pattern_of<typename F::output_type>& y, std::uint32_t status = 0,
                location where = location::current()) {
  const auto a = element<typename F::input_type>::value(x);
  auto result = unwritten<typename F::output_type>();
  const std::uint32_t s = F::call(&a, &result);
  return expect_result(y, status, result, s, where, functor_name<F>(), "result", a);
}

template <typename F>
bool expect_v21(const pattern_of<typename F::input_type>& x,
                const pattern_of<typename F::input_type>& y,
                const pattern_of<typename F::output_type>& r, std::uint32_t status = 0,
                location where = location::current()) {
  const auto a = element<typename F::input_type>::value(x);
  const auto b = element<typename F::input_type>::value(y);
  auto result = unwritten<typename F::output_type>();
  const std::uint32_t s = F::call(&a, &b, &result);
  return expect_result(r, status, result, s, where, functor_name<F>(), "result", a, b);
}

template <typename F>
bool expect_v12(const pattern_of<typename F::input_type>& x,
                const pattern_of<typename F::output_type>& y1,
                const pattern_of<typename F::output_type>& y2, std::uint32_t status = 0,
                location where = location::current()) {
  const auto a = element<typename F::input_type>::value(x);
  auto first = unwritten<typename F::output_type>();
  auto second = unwritten<typename F::output_type>();
  const std::uint32_t s = F::call(&a, &first, &second);
  const bool good =
      expect_result(y1, status, first, s, where, functor_name<F>(), "first result", a);
  return expect_result(y2, status, second, s, where, functor_name<F>(), "second result", a) && good;
}

/// The same for real operands given as numbers.
template <typename F>
bool expect_number(typename F::input_type x, typename F::output_type y, std::uint32_t status = 0,
                   location where = location::current()) {
  return expect_v11<F>(std::bit_cast<part_of<typename F::input_type>>(x),
                       std::bit_cast<part_of<typename F::output_type>>(y), status, where);
}
template <typename F>
bool expect_number(typename F::input_type x, typename F::input_type y, typename F::output_type r,
                   std::uint32_t status, location where = location::current()) {
  using T = typename F::input_type;
  return expect_v21<F>(std::bit_cast<part_of<T>>(x), std::bit_cast<part_of<T>>(y),
                       std::bit_cast<part_of<typename F::output_type>>(r), status, where);
}

/// Random patterns. The seed is LUMEN_TEST_SEED, or fixed; it is printed with a failure.
template <typename U>
class pattern_source {
 public:
  explicit pattern_source(std::uint64_t stream)
      : seed_(base_seed()),
        engine_(seed_ + stream),
        trace_(__FILE__, __LINE__, "LUMEN_TEST_SEED=" + std::to_string(seed_)) {}

  /// Any pattern at all, specials included.
  U any() { return static_cast<U>(engine_()); }

  /// Any pattern of a finite number.
  U finite() {
    for (;;) {
      const U p = any();
      if ((p & ~named<U>::sign) < named<U>::inf) return p;
    }
  }

  /// A number in [0, n).
  std::uint64_t below(std::uint64_t n) { return engine_() % n; }

  /// A finite pattern whose exponent differs from that of `p` by at most `distance`.
  U near(U p, int distance) {
    constexpr int fraction_bits = sizeof(U) == 4 ? 23 : 52;
    constexpr int top = sizeof(U) == 4 ? 254 : 2046;
    const int field = static_cast<int>((p & ~named<U>::sign) >> fraction_bits);
    const auto span = static_cast<std::uint64_t>(2 * distance + 1);
    int e = field + static_cast<int>(below(span)) - distance;
    e = e < 0 ? 0 : (e > top ? top : e);
    const U rest = any() & (named<U>::sign | ((U(1) << fraction_bits) - 1));
    return rest | (static_cast<U>(e) << fraction_bits);
  }

 private:
  static std::uint64_t base_seed() {
    const char* text = std::getenv("LUMEN_TEST_SEED");
    return text != nullptr ? std::strtoull(text, nullptr, 0) : 20240917;
  }
  std::uint64_t seed_;
  std::mt19937_64 engine_;
  ::testing::ScopedTrace trace_;
};

/// Patterns at which bodies change their course: zeros, denormals, powers of two, halves and their
/// neighbours, the largest numbers, infinities, NaNs; with both signs.
template <typename U>
std::vector<U> notable_patterns() {
  using n = named<U>;
  constexpr int fraction_bits = sizeof(U) == 4 ? 23 : 52;
  constexpr U unit = U(1) << fraction_bits;
  const U integer_from = n::one + fraction_bits * unit;  // 2^23 or 2^52
  std::vector<U> list = {0,
                         1,
                         2,
                         3,
                         unit - 1,
                         unit,
                         unit + 1,
                         2 * unit,
                         n::one - unit - 1,
                         n::one - unit,  // 1/2
                         n::one - unit + 1,
                         n::one - 1,
                         n::one,
                         n::one + 1,
                         n::one + unit / 2,  // 3/2
                         n::one + unit,
                         n::one + unit + unit / 4,      // 5/2
                         n::one + unit + unit / 2,      // 3
                         n::one + 2 * unit + unit / 4,  // 5
                         integer_from - unit - 1,
                         integer_from - unit,
                         integer_from - unit + 1,
                         integer_from - 1,
                         integer_from,
                         integer_from + 1,
                         integer_from + unit,
                         integer_from + unit + 1,
                         n::inf - unit - 1,
                         n::inf - unit,
                         n::largest - 1,
                         n::largest,
                         n::inf,
                         n::signalling,
                         n::nan,
                         n::nan + 5};
  const std::size_t positive = list.size();
  for (std::size_t i = 0; i < positive; ++i) list.push_back(list[i] | n::sign);
  return list;
}

}  // namespace arbor::lumen::tests
