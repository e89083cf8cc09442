// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The vectorised loop of every functor has the bits of its call.

#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <random>
#include <string>
#include <vector>

#include "functor.hpp"

namespace arbor::lumen::accuracy {
namespace {

std::vector<functor> functors_with_loop() {
  std::vector<functor> list;
  for (const functor& f : functors()) {
    if (f.run_loop != nullptr) list.push_back(f);
  }
  return list;
}

/// Bytes of a number, of both numbers of a complex one.
std::size_t part_size(const functor& f) {
  return f.type == 'h' ? 2 : (f.type == 's' || f.type == 'c' ? 4 : 8);
}
std::size_t element_size(const functor& f) { return part_size(f) * (f.is_real() ? 1 : 2); }

/// Any patterns, every third number of ordinary size, every seventh special.
std::vector<unsigned char> operands(const functor& f, std::size_t n, std::uint64_t seed) {
  std::mt19937_64 engine(seed);
  std::vector<unsigned char> bytes(n * element_size(f));
  for (std::size_t at = 0; at < bytes.size(); at += part_size(f)) {
    const std::uint64_t drawn = engine();
    if (part_size(f) == 2) {
      const auto pattern = static_cast<std::uint16_t>(drawn);
      std::memcpy(&bytes[at], &pattern, 2);
    } else if (part_size(f) == 4) {
      static constexpr std::uint32_t specials[] = {0, 1, 0x7f800000, 0x7fc00000, 0x007fffff};
      auto pattern = static_cast<std::uint32_t>(drawn);
      if (drawn % 3 == 0) pattern = (pattern & 0x80ffffff) | 0x3f000000;
      if (drawn % 7 == 0) pattern = specials[(drawn >> 40) % 5] | (pattern & 0x80000000);
      std::memcpy(&bytes[at], &pattern, 4);
    } else {
      static constexpr std::uint64_t specials[] = {0, 1, 0x7ff0000000000000, 0x7ff8000000000000,
                                                   0x000fffffffffffff};
      std::uint64_t pattern = drawn;
      if (drawn % 3 == 0) pattern = (pattern & 0x801fffffffffffff) | 0x3fe0000000000000;
      if (drawn % 7 == 0) pattern = specials[(drawn >> 40) % 5] | (pattern & 0x8000000000000000);
      std::memcpy(&bytes[at], &pattern, 8);
    }
  }
  return bytes;
}

bool is_nan(const functor& f, const unsigned char* number) {
  if (part_size(f) == 2) {
    std::uint16_t pattern;
    std::memcpy(&pattern, number, 2);
    return (pattern & 0x7fff) > 0x7c00;
  }
  if (part_size(f) == 4) {
    float x;
    std::memcpy(&x, number, 4);
    return x != x;
  }
  double x;
  std::memcpy(&x, number, 8);
  return x != x;
}

class BlockLoop : public ::testing::TestWithParam<functor> {
 protected:
  /// A NaN of an invalid operation or out of two NaNs has the sign and payload that the machine's
  /// instruction gives, which may differ with the order of its operands.
  void expect_same(const std::vector<unsigned char>& expected,
                   const std::vector<unsigned char>& actual) {
    const functor& f = GetParam();
    for (std::size_t at = 0; at + part_size(f) <= actual.size(); at += part_size(f)) {
      if (std::memcmp(&expected[at], &actual[at], part_size(f)) == 0) continue;
      ASSERT_TRUE(is_nan(f, &expected[at]) && is_nan(f, &actual[at])) << "at byte " << at;
    }
  }
};

TEST_P(BlockLoop, HasTheBitsOfTheCall) {
  const functor& f = GetParam();
  for (const std::size_t n : {1, 3, 64, 127, 128, 129, 1000, 20000}) {
    const auto a = operands(f, n, n), b = operands(f, n, n + 1);
    const std::size_t bytes = n * element_size(f);
    std::vector<unsigned char> y(bytes), z(bytes), loop_y(bytes), loop_z(bytes);
    std::vector<std::uint32_t> status(n);
    const void* in[] = {a.data(), b.data()};
    void* out[] = {y.data(), z.data()};
    f.run(in, out, status.data(), n);
    void* loop_out[] = {loop_y.data(), loop_z.data()};
    f.run_loop(in, loop_out, n);
    ASSERT_NO_FATAL_FAILURE(expect_same(y, loop_y)) << n;
    ASSERT_NO_FATAL_FAILURE(expect_same(z, loop_z)) << n;
    if (!f.is_real()) continue;  // results may have another size than operands
    // In place.
    std::vector<unsigned char> x = a;
    const void* place_in[] = {x.data(), b.data()};
    void* place_out[] = {x.data(), loop_z.data()};
    f.run_loop(place_in, place_out, n);
    ASSERT_NO_FATAL_FAILURE(expect_same(y, x)) << n << ", in place";
  }
}

INSTANTIATE_TEST_SUITE_P(All, BlockLoop, ::testing::ValuesIn(functors_with_loop()),
                         [](const auto& tested) { return std::string(tested.param.name); });

}  // namespace
}  // namespace arbor::lumen::accuracy
