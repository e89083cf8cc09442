// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <iterator>
#include <memory>
#include <numeric>
#include <type_traits>
#include <vector>

#include "support.hpp"

namespace {

using conformance::is_complete;
using conformance::throws;
using sycl::access_mode;
using sycl::buffer;
using sycl::errc;
using sycl::host_accessor;
using sycl::id;
using sycl::range;

static_assert(conformance::has_reference_semantics<host_accessor<int, 1>>);
static_assert(std::is_default_constructible_v<host_accessor<int, 1>>);
static_assert(std::is_same_v<host_accessor<int>, host_accessor<int, 1, access_mode::read_write>>);
static_assert(
    std::is_same_v<host_accessor<const int>, host_accessor<const int, 1, access_mode::read>>);
static_assert(sycl::is_property_of_v<sycl::property::no_init, host_accessor<int>>);

using reader = host_accessor<int, 1, access_mode::read>;
using const_reader = host_accessor<const int, 1, access_mode::read>;
static_assert(std::is_same_v<reader::value_type, const int>);
static_assert(std::is_same_v<host_accessor<int>::value_type, int>);
static_assert(std::is_same_v<host_accessor<int>::reference, int&>);
static_assert(std::is_same_v<host_accessor<int>::const_reference, const int&>);
static_assert(std::is_convertible_v<host_accessor<int>, const_reader>);
static_assert(std::is_convertible_v<reader, const_reader>);
static_assert(!std::is_convertible_v<const_reader, host_accessor<int>>);
static_assert(std::random_access_iterator<host_accessor<int>::iterator>);
static_assert(std::random_access_iterator<host_accessor<int, 2>::iterator>);

template <int Dimensions, typename... Args>
using deduced =
    decltype(host_accessor(std::declval<buffer<int, Dimensions>&>(), std::declval<Args>()...));
using ro = decltype(sycl::read_only);
using wo = decltype(sycl::write_only);
static_assert(std::is_same_v<deduced<1>, host_accessor<int, 1, access_mode::read_write>>);
static_assert(std::is_same_v<deduced<2, wo>, host_accessor<int, 2, access_mode::write>>);
static_assert(std::is_same_v<deduced<2, ro>::value_type, const int>);
static_assert(std::is_same_v<deduced<1, range<1>, wo>, host_accessor<int, 1, access_mode::write>>);
static_assert(std::is_same_v<deduced<1, range<1>, id<1>, wo, sycl::property_list>,
                             host_accessor<int, 1, access_mode::write>>);

TEST(ConformanceHostAccessor, ReferenceSemantics) {
  buffer<int> one(range<1>(4));
  buffer<int> two(range<1>(4));
  const host_accessor<int> a(one);
  const host_accessor<int> b(two);
  conformance::expect_reference_semantics<host_accessor<int>>(a, b);
}

TEST(ConformanceHostAccessor, DefaultIsEmpty) {
  const host_accessor<int, 3> acc;
  EXPECT_TRUE(acc.empty());
  EXPECT_EQ(acc.size(), 0U);
  EXPECT_EQ(acc.get_range(), range<3>(0, 0, 0));
  EXPECT_TRUE(acc.begin() == acc.end());
}

TEST(ConformanceHostAccessor, WaitsForTheCommandsBefore) {
  sycl::queue q;
  buffer<int> buf(range<1>(1));
  {
    const host_accessor acc(buf, sycl::write_only);
    acc[0] = 0;
  }
  sycl::event last;
  for (int i = 0; i < 100; ++i) {
    last = q.submit([&](sycl::handler& cgh) {
      const sycl::accessor acc(buf, cgh, sycl::read_write);
      cgh.single_task([=] { acc[0] += 1; });
    });
  }
  const host_accessor acc(buf, sycl::read_only);
  EXPECT_EQ(acc[0], 100);
}

TEST(ConformanceHostAccessor, HoldsBackTheCommandsAfter) {
  sycl::queue q;
  buffer<int> buf(range<1>(1));
  sycl::event e;
  {
    auto acc = std::make_unique<host_accessor<int>>(buf);
    const host_accessor<int> copy = *acc;
    e = q.submit([&](sycl::handler& cgh) {
      const sycl::accessor out(buf, cgh, sycl::read_write);
      cgh.single_task([=] { out[0] *= 2; });
    });
    acc.reset();
    EXPECT_FALSE(is_complete(e)) << "a copy still has access";
    copy[0] = 21;
  }
  e.wait();
  const host_accessor acc(buf, sycl::read_only);
  EXPECT_EQ(acc[0], 42);
}

TEST(ConformanceHostAccessor, ReadersShareTheBuffer) {
  sycl::queue q;
  buffer<int> buf(range<1>(1));
  {
    const host_accessor acc(buf, sycl::write_only);
    acc[0] = 3;
  }
  const host_accessor reading(buf, sycl::read_only);
  const host_accessor also_reading(buf, sycl::read_only);
  buffer<int> out(range<1>(1));
  q.submit([&](sycl::handler& cgh) {
     const sycl::accessor in(buf, cgh, sycl::read_only);
     const sycl::accessor to(out, cgh, sycl::write_only);
     cgh.single_task([=] { to[0] = in[0]; });
   }).wait();
  const host_accessor result(out, sycl::read_only);
  EXPECT_EQ(result[0], also_reading[0]);
}

TEST(ConformanceHostAccessor, Ranges) {
  std::vector<int> data(24);
  std::iota(data.begin(), data.end(), 0);
  buffer<int, 2> buf(data.data(), range<2>(4, 6));
  const host_accessor part(buf, range<2>(2, 3), id<2>(1, 2), sycl::read_only);
  EXPECT_EQ(part.get_offset(), id<2>(1, 2));
  EXPECT_EQ(part.get_range(), range<2>(2, 3));
  EXPECT_EQ((part[id<2>(0, 0)]), 8);
  EXPECT_EQ(part[1][2], 16);
  EXPECT_EQ(std::vector<int>(part.begin(), part.end()), (std::vector<int>{8, 9, 10, 14, 15, 16}));
  EXPECT_EQ(std::vector<int>(part.rbegin(), part.rend()), (std::vector<int>{16, 15, 14, 10, 9, 8}));
  EXPECT_TRUE(throws(errc::invalid, [&] { host_accessor(buf, range<2>(5, 6)); }));
  EXPECT_TRUE(throws(errc::invalid, [&] { host_accessor(buf, range<2>(2, 2), id<2>(3, 0)); }));
}

TEST(ConformanceHostAccessor, NoInitExcludesReadOnly) {
  buffer<int> buf(range<1>(4));
  EXPECT_TRUE(throws(errc::invalid, [&] { host_accessor(buf, sycl::read_only, {sycl::no_init}); }));
  EXPECT_NO_THROW(host_accessor(buf, sycl::write_only, {sycl::no_init}));
}

TEST(ConformanceHostAccessor, OfNoDimensions) {
  buffer<int> buf(range<1>(3));
  {
    const host_accessor<int, 0> acc(buf);
    acc = 4;
    const int& element = acc;
    EXPECT_EQ(element, 4);
  }
  EXPECT_EQ(host_accessor(buf, sycl::read_only)[0], 4);
}

TEST(ConformanceHostAccessor, MemberOfBuffer) {
  buffer<int> buf(range<1>(3));
  {
    auto acc = buf.get_host_access(sycl::write_only);
    static_assert(std::is_same_v<decltype(acc), host_accessor<int, 1, access_mode::write>>);
    for (int& x : acc) x = 6;
  }
  auto acc = buf.get_host_access();
  static_assert(std::is_same_v<decltype(acc), host_accessor<int, 1, access_mode::read_write>>);
  EXPECT_EQ(acc[2], 6);
}

}  // namespace
