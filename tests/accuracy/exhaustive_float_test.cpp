// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Every float through every float functor of one operand, against the C library's double function:
/// its error, below 2 ulp of double, is 2^-28 ulp of float.

#include <gtest/gtest.h>

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <iostream>
#include <limits>
#include <sstream>
#include <string>
#include <vector>

#include "functor.hpp"
#include "limits.hpp"
#include "number_format.hpp"
#include "reference.hpp"

namespace arbor::lumen::accuracy {
namespace {

/// The error of a float in ulp of `exact`; the conventions are those of `ulp_error`.
double float_error(float result, double exact) {
  constexpr double infinity = std::numeric_limits<double>::infinity();
  if (std::isnan(result) || std::isnan(exact))
    return std::isnan(result) && std::isnan(exact) ? 0 : infinity;
  constexpr double behind = 0x1p128, to_round = 0x1.ffffffp127;
  const bool overflows = std::fabs(exact) >= to_round;
  if (std::isinf(result) && overflows && (result < 0) == (exact < 0)) return 0;
  const double r = std::isinf(result) ? std::copysign(behind, result) : double(result);
  const double e = overflows ? std::copysign(behind, exact) : exact;
  const auto field = static_cast<int>((std::bit_cast<std::uint64_t>(e) >> 52) & 0x7ff) - 1023;
  const int exponent = std::clamp(field, -126, 127);
  const double scale =
      std::bit_cast<double>(static_cast<std::uint64_t>(1023 + 23 - exponent) << 52);
  return (r - e) * scale;
}

/// A functor with its results of one block of arguments.
struct competitor {
  functor f;
  std::vector<float> results;
  double largest_of_block = 0;
  std::uint32_t worst_of_block = 0;
  double largest = 0;
  std::uint32_t worst = 0;

  void measure(const std::vector<double>& exact, std::uint32_t first) {
    largest_of_block = 0;
    for (std::size_t i = 0; i < results.size(); ++i) {
      const double error = std::fabs(float_error(results[i], exact[i]));
      if (error > largest_of_block) {
        largest_of_block = error;
        worst_of_block = first + static_cast<std::uint32_t>(i);
      }
    }
  }
  bool same_results(const competitor& other) const {
    return std::memcmp(results.data(), other.results.data(), results.size() * sizeof(float)) == 0;
  }
};

std::vector<std::string> functions() {
  std::vector<std::string> list;
  for (const functor& f : functors()) {
    const reference* r = find_reference(f.function);
    if (f.type == 's' && f.shape == "v11" && r != nullptr && r->c_double != nullptr &&
        (list.empty() || list.back() != f.function))
      list.emplace_back(f.function);
  }
  return list;
}

class EveryFloat : public ::testing::TestWithParam<std::string> {};

TEST_P(EveryFloat, IsWithinTheLimitOfTheTier) {
  constexpr std::size_t block = 8192;
  std::vector<competitor> competitors;
  for (const functor& f : functors()) {
    if (f.function == GetParam() && f.type == 's')
      competitors.push_back({f, std::vector<float>(block)});
  }
  const reference& r = *find_reference(GetParam());
  std::vector<float> x(block);
  std::vector<double> exact(block);
  std::vector<std::uint32_t> status(block);
  for (std::uint64_t first = 0; first < (std::uint64_t{1} << 32); first += block) {
    for (std::size_t i = 0; i < block; ++i) {
      x[i] = std::bit_cast<float>(static_cast<std::uint32_t>(first + i));
      exact[i] = r.c_double(static_cast<double>(x[i]));
    }
    for (competitor& c : competitors) {
      const void* in[] = {x.data()};
      void* out[] = {c.results.data()};
      c.f.run(in, out, status.data(), block);
      // Tiers that are one body have the same errors.
      const competitor* same = competitors.data();
      while (same != &c && !same->same_results(c)) ++same;
      if (same == &c) {
        c.measure(exact, static_cast<std::uint32_t>(first));
      } else {
        c.largest_of_block = same->largest_of_block;
        c.worst_of_block = same->worst_of_block;
      }
      if (c.largest_of_block > c.largest) {
        c.largest = c.largest_of_block;
        c.worst = c.worst_of_block;
      }
    }
  }
  for (const competitor& c : competitors) {
    std::ostringstream text;
    text << c.f.name << ": " << c.largest << " ulp at 0x" << std::hex << c.worst;
    std::cout << text.str() << std::endl;
    EXPECT_LE(c.largest, limit_of(c.f)) << text.str();
  }
}

INSTANTIATE_TEST_SUITE_P(All, EveryFloat, ::testing::ValuesIn(functions()),
                         [](const auto& tested) { return tested.param; });

}  // namespace
}  // namespace arbor::lumen::accuracy
