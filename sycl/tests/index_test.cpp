// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>
#include <sycl/bit_cast.hpp>
#include <sycl/id.hpp>
#include <sycl/item.hpp>
#include <sycl/range.hpp>
#include <sycl/span.hpp>
#include <type_traits>
#include <vector>

namespace {

using sycl::id;
using sycl::item;
using sycl::range;
using sycl::detail::make_item;

template <typename T>
constexpr bool by_value = std::is_trivially_copyable_v<T>&& std::is_trivially_destructible_v<T>&&
    std::is_nothrow_copy_constructible_v<T>&& std::is_nothrow_copy_assignable_v<T>&&
        std::is_standard_layout_v<T>;

static_assert(by_value<range<1>> && by_value<range<2>> && by_value<range<3>>);
static_assert(by_value<id<1>> && by_value<id<2>> && by_value<id<3>>);
static_assert(by_value<item<1, false>> && by_value<item<2, true>> && by_value<item<3>>);
static_assert(!std::is_default_constructible_v<item<1>>);
static_assert(sizeof(item<1, false>) == 2 * sizeof(std::size_t));
static_assert(range<3>::dimensions == 3 && id<2>::dimensions == 2 && item<1>::dimensions == 1);

static_assert(std::is_same_v<decltype(range(1, 2, 3)), range<3>>);
static_assert(std::is_same_v<decltype(range(std::size_t{4})), range<1>>);
static_assert(std::is_same_v<decltype(range(1, 2)), range<2>>);
static_assert(std::is_same_v<decltype(id(1, 2)), id<2>>);
static_assert(std::is_same_v<decltype(id(7)), id<1>>);
static_assert(std::is_same_v<decltype(id(range(7, 8))), id<2>>);
static_assert(std::is_same_v<decltype(id(make_item(range<3>(1, 1, 1), id<3>()))), id<3>>);
static_assert(std::is_same_v<decltype(range{1, 2}), range<2>>);

static_assert(std::is_convertible_v<std::size_t, range<1>>);
static_assert(std::is_convertible_v<int, id<1>>);
static_assert(!std::is_constructible_v<range<2>, std::size_t>);
static_assert(!std::is_constructible_v<range<1>, std::size_t, std::size_t>);
static_assert(!std::is_constructible_v<id<3>, std::size_t, std::size_t>);
static_assert(std::is_convertible_v<id<1>, std::size_t>);
static_assert(!std::is_convertible_v<id<2>, std::size_t>);
static_assert(!std::is_convertible_v<range<1>, std::size_t>);
static_assert(std::is_convertible_v<item<1, false>, std::size_t>);
static_assert(!std::is_convertible_v<item<2>, std::size_t>);
static_assert(std::is_convertible_v<range<2>, id<2>>);
static_assert(!std::is_convertible_v<range<2>, id<3>>);
static_assert(std::is_convertible_v<item<2, false>, id<2>>);
static_assert(std::is_convertible_v<item<2, true>, id<2>>);
static_assert(std::is_convertible_v<item<2, false>, item<2, true>>);
static_assert(!std::is_convertible_v<item<2, true>, item<2, false>>);

template <typename Item>
concept has_offset = requires(Item i) {
  i.get_offset();
};
static_assert(has_offset<item<2, true>> && !has_offset<item<2, false>>);

static_assert(noexcept(range<1>(1) + range<1>(2)) && noexcept(id<1>(1) == 1));

// Everything about ranges and ids can be computed at compile time.
static_assert(range<3>(2, 3, 4).size() == 24);
static_assert(range<1>(5).size() == 5);
static_assert(range<2>().size() == 0);
static_assert((range(6, 4) / 2 + range(1, 1)) == range(4, 3));
static_assert(make_item(range(4, 5), id(2, 3)).get_linear_id() == 13);

TEST(Range, AccessAndAssignment) {
  range<3> r(2, 3, 4);
  EXPECT_EQ(r.get(0), 2U);
  EXPECT_EQ(r.get(2), 4U);
  r[1] = 9;
  EXPECT_EQ(r[1], 9U);
  EXPECT_EQ(r.size(), 72U);
  const range<3> copy = r;
  EXPECT_TRUE(copy == r);
  EXPECT_FALSE(copy != r);
  r[2] = 5;
  EXPECT_TRUE(copy != r);
}

/// All binary operators on one pair, the values of each dimension against the integers'.
template <typename Vector>
void expect_operators(const Vector& a, const Vector& b) {
#define EXPECT_ELEMENTS(op)                                         \
  do {                                                              \
    const Vector vv = a op b;                                       \
    const Vector vs = a op 3;                                       \
    const Vector sv = std::size_t{3} op b;                          \
    for (int d = 0; d < Vector::dimensions; ++d) {                  \
      EXPECT_EQ(vv[d], std::size_t(a[d] op b[d])) << #op;           \
      EXPECT_EQ(vs[d], std::size_t(a[d] op std::size_t{3})) << #op; \
      EXPECT_EQ(sv[d], std::size_t(std::size_t{3} op b[d])) << #op; \
    }                                                               \
  } while (false)
  EXPECT_ELEMENTS(+);
  EXPECT_ELEMENTS(-);
  EXPECT_ELEMENTS(*);
  EXPECT_ELEMENTS(/);
  EXPECT_ELEMENTS(%);
  EXPECT_ELEMENTS(<<);
  EXPECT_ELEMENTS(>>);
  EXPECT_ELEMENTS(&);
  EXPECT_ELEMENTS(|);
  EXPECT_ELEMENTS(^);
  EXPECT_ELEMENTS(&&);
  EXPECT_ELEMENTS(||);
  EXPECT_ELEMENTS(<);
  EXPECT_ELEMENTS(>);
  EXPECT_ELEMENTS(<=);
  EXPECT_ELEMENTS(>=);
#undef EXPECT_ELEMENTS

  Vector x = a;
  EXPECT_EQ(&(x += b), &x);
  EXPECT_EQ(x, a + b);
  EXPECT_EQ(x -= 1, a + b - 1);
  x = a;
  EXPECT_EQ(x *= 2, a * 2);
  EXPECT_EQ(x /= b, a * 2 / b);
  x = a;
  EXPECT_EQ(x %= b, a % b);
  x = a;
  EXPECT_EQ(x <<= b, a << b);
  EXPECT_EQ(x >>= 1, (a << b) >> 1);
  x = a;
  EXPECT_EQ(x &= 6, a & 6);
  EXPECT_EQ(x |= b, (a & 6) | b);
  x = a;
  EXPECT_EQ(x ^= b, a ^ b);

  x = a;
  EXPECT_EQ(++x, a + 1);
  EXPECT_EQ(x++, a + 1);
  EXPECT_EQ(x, a + 2);
  EXPECT_EQ(--x, a + 1);
  EXPECT_EQ(x--, a + 1);
  EXPECT_EQ(x, a);
  EXPECT_EQ(+x, a);
  for (int d = 0; d < Vector::dimensions; ++d) EXPECT_EQ((-x)[d], std::size_t{0} - a[d]);
}

TEST(Range, Operators) {
  expect_operators(range<1>(17), range<1>(3));
  expect_operators(range<2>(17, 0), range<2>(5, 1));
  expect_operators(range<3>(3, 12, 1000), range<3>(3, 7, 2));
}

TEST(Id, Operators) {
  expect_operators(id<1>(17), id<1>(3));
  expect_operators(id<2>(17, 0), id<2>(5, 1));
  expect_operators(id<3>(3, 12, 1000), id<3>(3, 7, 2));
}

TEST(Id, DefaultIsTheOrigin) {
  EXPECT_EQ(id<1>()[0], 0U);
  EXPECT_EQ(id<3>(), id<3>(0, 0, 0));
}

TEST(Id, OneDimensionalActsAsAnIndex) {
  const std::vector<int> values = {10, 11, 12, 13};
  const int* pointer = values.data();
  const id<1> i = 2;
  const std::size_t n = i;
  EXPECT_EQ(n, 2U);
  EXPECT_EQ(values[i], 12);
  EXPECT_EQ(pointer[i], 12);
  EXPECT_EQ(values[i + 1], 13);
  EXPECT_EQ(pointer[i - 1U], 11);
  EXPECT_TRUE(i == 2);
  EXPECT_TRUE(2U == i);
  EXPECT_TRUE(i != std::size_t{3});
  EXPECT_TRUE(i < 3 ? true : false);
  EXPECT_FALSE(i >= std::size_t{3} ? true : false);
  const int picked = i > 1 ? pointer[i] : 0;
  EXPECT_EQ(picked, 12);
}

TEST(Id, FromRangeAndItem) {
  EXPECT_EQ(id<2>(range<2>(3, 4)), id<2>(3, 4));
  const id<3> from_item = make_item(range<3>(4, 4, 4), id<3>(1, 2, 3));
  EXPECT_EQ(from_item, id<3>(1, 2, 3));
  const id<1> from_one = make_item(range<1>(9), id<1>(4));
  EXPECT_EQ(from_one[0], 4U);
}

TEST(Item, WithoutOffset) {
  const auto i = make_item(range<3>(4, 5, 6), id<3>(1, 2, 3));
  static_assert(std::is_same_v<decltype(i), const item<3, false>>);
  EXPECT_EQ(i.get_id(), id<3>(1, 2, 3));
  EXPECT_EQ(i.get_id(1), 2U);
  EXPECT_EQ(i[2], 3U);
  EXPECT_EQ(i.get_range(), range<3>(4, 5, 6));
  EXPECT_EQ(i.get_range(0), 4U);
  EXPECT_EQ(i.get_linear_id(), 3U + 6U * (2U + 5U * 1U));
  EXPECT_TRUE(i == i);
  EXPECT_TRUE(i != make_item(range<3>(4, 5, 6), id<3>(1, 2, 4)));
  EXPECT_TRUE(i != make_item(range<3>(4, 5, 7), id<3>(1, 2, 3)));
}

TEST(Item, LinearIdsEnumerateTheRange) {
  const range<2> extents(3, 7);
  const id<2> offset(10, 20);
  std::size_t expected = 0;
  for (std::size_t y = 0; y < 3; ++y) {
    for (std::size_t x = 0; x < 7; ++x, ++expected) {
      EXPECT_EQ(make_item(extents, id<2>(y, x)).get_linear_id(), expected);
      EXPECT_EQ(make_item(extents, offset + id<2>(y, x), offset).get_linear_id(), expected);
    }
  }
  EXPECT_EQ(expected, extents.size());
}

TEST(Item, WithOffset) {
  const auto i = make_item(range<1>(8), id<1>(12), id<1>(10));
  static_assert(std::is_same_v<decltype(i), const item<1, true>>);
  EXPECT_EQ(i.get_offset(), id<1>(10));
  EXPECT_EQ(i.get_id(0), 12U);
  EXPECT_EQ(i.get_linear_id(), 2U);
  const std::size_t n = i;
  EXPECT_EQ(n, 12U);
  EXPECT_TRUE(i != make_item(range<1>(8), id<1>(12), id<1>(9)));
}

TEST(Item, GainsAZeroOffset) {
  const item<2, true> i = make_item(range<2>(2, 3), id<2>(1, 2));
  EXPECT_EQ(i.get_offset(), id<2>(0, 0));
  EXPECT_EQ(i.get_linear_id(), 5U);
}

TEST(Item, OneDimensionalActsAsAnIndex) {
  const int values[] = {10, 11, 12};
  const auto i = make_item(range<1>(3), id<1>(1));
  EXPECT_EQ(values[i], 11);
  EXPECT_EQ(values[i + 1], 12);
  EXPECT_TRUE(i == 1U);
  EXPECT_TRUE(i < 2);
}

static_assert(sycl::bit_cast<std::uint32_t>(1.0F) == 0x3F800000U);
static_assert(sycl::bit_cast<double>(std::uint64_t{0x4000000000000000}) == 2.0);

template <typename To, typename From>
concept castable = requires(From f) {
  sycl::bit_cast<To>(f);
};
static_assert(castable<int, float> && !castable<int, double> && !castable<std::vector<int>, id<3>>);

static_assert(std::is_same_v<sycl::span<int>, std::span<int>>);
static_assert(sycl::dynamic_extent == std::dynamic_extent);

TEST(Span, IsAView) {
  std::vector<int> v = {1, 2, 3};
  sycl::span<int> s(v);
  s[1] = 7;
  EXPECT_EQ(v[1], 7);
  EXPECT_EQ(s.size(), 3U);
}

}  // namespace
