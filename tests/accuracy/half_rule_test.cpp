// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Functors on halves that run a float body: each equals the float functor of `ep` between the two
/// conversions, at every half and at a grid of pairs.

#include <gtest/gtest.h>

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstdint>
#include <random>
#include <string>
#include <sycl/sycl.hpp>
#include <vector>

#include "functor.hpp"

namespace arbor::lumen::accuracy {

namespace {

std::vector<functor> cast_functors() {
  std::vector<functor> list;
  for (const functor& f : functors()) {
    if (f.name.ends_with("_fp32cast")) list.push_back(f);
  }
  return list;
}

/// The float functor of `ep` with the label; where there is none, the one of the label that takes
/// its place.
const functor* float_functor(const functor& f) {
  const std::string stem = std::string(f.function) + "_s_ep_";
  for (const std::string_view label :
       {f.label, std::string_view("gen"), std::string_view("fp64only")}) {
    if (const functor* found = find_functor(stem + std::string(label))) return found;
  }
  return nullptr;
}

using halves = std::vector<sycl::half>;

halves every_half() {
  halves x;
  for (std::uint32_t p = 0; p < 0x10000; ++p)
    x.push_back(std::bit_cast<sycl::half>(static_cast<std::uint16_t>(p)));
  return x;
}

/// 2000 halves of both signs: zeros, the ends of the denormals and of the normal numbers, infinity,
/// NaNs, small integers, halves of them, and random ones.
halves grid() {
  std::vector<std::uint16_t> patterns = {0x0000, 0x0001, 0x0002, 0x03ff, 0x0400, 0x0401, 0x7bfe,
                                         0x7bff, 0x7c00, 0x7e00, 0x7fff, 0x3bff, 0x3c00, 0x3c01};
  for (int k = 1; k <= 32; ++k)
    patterns.push_back(std::bit_cast<std::uint16_t>(sycl::half(static_cast<float>(k) / 2)));
  std::mt19937 engine(11);
  while (patterns.size() < 1000) patterns.push_back(static_cast<std::uint16_t>(engine() & 0x7fff));
  halves x;
  for (const std::uint16_t p : patterns) {
    for (const std::uint16_t sign : {0, 0x8000})
      x.push_back(std::bit_cast<sycl::half>(static_cast<std::uint16_t>(p | sign)));
  }
  return x;
}

std::uint16_t pattern(sycl::half x) { return std::bit_cast<std::uint16_t>(x); }
bool is_nan(std::uint16_t p) { return (p & 0x7fff) > 0x7c00; }

class HalfRule : public ::testing::TestWithParam<functor> {
 protected:
  /// Compares at the operands, one array each.
  void expect_same(const halves& a, const halves& b) {
    const functor& f = GetParam();
    const functor* const wide = float_functor(f);
    ASSERT_NE(wide, nullptr);
    const std::size_t n = a.size();
    halves y[2] = {halves(n), halves(n)};
    std::vector<std::uint32_t> status(n), wide_status(n);
    const void* in[] = {a.data(), b.data()};
    void* out[] = {y[0].data(), y[1].data()};
    f.run(in, out, status.data(), n);

    const std::vector<float> wide_a(a.begin(), a.end()), wide_b(b.begin(), b.end());
    std::vector<float> wide_y[2] = {std::vector<float>(n), std::vector<float>(n)};
    const void* wide_in[] = {wide_a.data(), wide_b.data()};
    void* wide_out[] = {wide_y[0].data(), wide_y[1].data()};
    wide->run(wide_in, wide_out, wide_status.data(), n);

    for (std::size_t i = 0; i < n; ++i) {
      ASSERT_EQ(status[i], wide_status[i]) << std::hex << pattern(a[i]) << " " << pattern(b[i]);
      for (std::size_t k = 0; k < f.outputs(); ++k) {
        const std::uint16_t expected = pattern(sycl::half(wide_y[k][i]));
        const std::uint16_t actual = pattern(y[k][i]);
        if (is_nan(expected) && is_nan(actual)) continue;
        ASSERT_EQ(actual, expected) << std::hex << pattern(a[i]) << " " << pattern(b[i]);
      }
    }
  }
};

TEST_P(HalfRule, IsTheFloatFunctorBetweenConversions) {
  if (GetParam().inputs() == 1) {
    expect_same(every_half(), every_half());
    return;
  }
  const halves values = grid();
  for (const sycl::half x : values) {
    expect_same(halves(values.size(), x), values);
    if (HasFatalFailure()) return;
  }
}

INSTANTIATE_TEST_SUITE_P(All, HalfRule, ::testing::ValuesIn(cast_functors()),
                         [](const auto& tested) { return std::string(tested.param.name); });

}  // namespace
}  // namespace arbor::lumen::accuracy
