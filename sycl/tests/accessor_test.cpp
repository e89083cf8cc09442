// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <memory>
#include <numeric>
#include <type_traits>
#include <vector>

#include <gtest/gtest.h>
#include <sycl/sycl.hpp>

namespace {

using sycl::access_mode;
using sycl::accessor;
using sycl::buffer;
using sycl::host_accessor;
using sycl::id;
using sycl::range;
using sycl::target;

using writable = accessor<int, 1, access_mode::read_write>;
using readable = accessor<const int, 1, access_mode::read>;
static_assert(std::is_same_v<writable::value_type, int>);
static_assert(std::is_same_v<readable::value_type, const int>);
static_assert(std::is_same_v<accessor<int, 1, access_mode::read>::value_type, const int>);
static_assert(std::is_same_v<writable::reference, int&>);
static_assert(std::is_same_v<writable::const_reference, const int&>);
static_assert(std::is_same_v<accessor<const int>, readable>);
static_assert(std::is_trivially_copyable_v<writable>);
static_assert(std::is_convertible_v<writable, readable>);
static_assert(!std::is_convertible_v<readable, writable>);
static_assert(std::is_default_constructible_v<writable>);
static_assert(sycl::is_property_of_v<sycl::property::no_init, writable>);
static_assert(!sycl::is_property_of_v<sycl::property::queue::in_order, writable>);

TEST(Accessor, TagsDeduceModeAndTarget) {
  buffer<int> buf(range<1>(4));
  sycl::queue().submit([&](sycl::handler& cgh) {
    const accessor a(buf, cgh);
    const accessor b(buf, cgh, sycl::read_only);
    const accessor c(buf, cgh, sycl::write_only, sycl::no_init);
    const accessor d(buf, cgh, sycl::read_only_host_task);
    const accessor e(buf, cgh, range<1>(2), id<1>(1), sycl::read_write);
    const auto f = buf.get_access<access_mode::write>(cgh);
    const auto g = buf.get_access(cgh, sycl::read_only);
    static_assert(std::is_same_v<std::remove_const_t<decltype(a)>, writable>);
    static_assert(std::is_same_v<std::remove_const_t<decltype(b)>, readable>);
    static_assert(
        std::is_same_v<std::remove_const_t<decltype(c)>, accessor<int, 1, access_mode::write>>);
    static_assert(std::is_same_v<std::remove_const_t<decltype(d)>,
                                 accessor<const int, 1, access_mode::read, target::host_task>>);
    static_assert(std::is_same_v<std::remove_const_t<decltype(e)>, writable>);
    static_assert(
        std::is_same_v<std::remove_const_t<decltype(f)>, accessor<int, 1, access_mode::write>>);
    static_assert(std::is_same_v<std::remove_const_t<decltype(g)>, readable>);
    EXPECT_EQ(e.size(), 2U);
    EXPECT_FALSE(a.is_placeholder());
  });
  const accessor p(buf, sycl::write_only);
  static_assert(
      std::is_same_v<
          std::remove_const_t<decltype(p)>,
          accessor<int, 1, access_mode::write, target::device, sycl::access::placeholder::true_t>>);
  EXPECT_TRUE(p.is_placeholder());
}

TEST(Accessor, PlaceholdersAreBoundByRequire) {
  buffer<int> buf(range<1>(4));
  const accessor p(buf, sycl::read_write);
  sycl::queue q;
  for (int i = 0; i < 3; ++i) {
    q.submit([&](sycl::handler& cgh) {
      cgh.require(p);
      cgh.parallel_for(4, [=](id<1> k) { p[k] = i == 0 ? 1 : p[k] * 2; });
    });
  }
  EXPECT_EQ(host_accessor(buf)[3], 4);
}

TEST(Accessor, KnowsItsRange) {
  buffer<int, 2> buf(range<2>(4, 5));
  const host_accessor whole(buf);
  EXPECT_EQ(whole.size(), 20U);
  EXPECT_EQ(whole.byte_size(), 80U);
  EXPECT_GE(whole.max_size(), 20U);
  EXPECT_FALSE(whole.empty());
  EXPECT_EQ(whole.get_range(), range<2>(4, 5));
  EXPECT_EQ(whole.get_offset(), id<2>(0, 0));
  const sycl::accessor<int> none;
  EXPECT_TRUE(none.empty());
  EXPECT_EQ(none.size(), 0U);
  EXPECT_TRUE(none.begin() == none.end());
}

TEST(Accessor, SubscriptsCountFromTheOffset) {
  buffer<int, 3> buf(range<3>(3, 4, 5));
  {
    const host_accessor all(buf);
    std::iota(all.begin(), all.end(), 0);
  }
  const host_accessor box(buf, range<3>(2, 2, 3), id<3>(1, 2, 1), sycl::read_only);
  EXPECT_EQ(box.size(), 12U);
  EXPECT_EQ(box.get_offset(), id<3>(1, 2, 1));
  EXPECT_EQ((box[id<3>(0, 0, 0)]), 1 * 20 + 2 * 5 + 1);
  EXPECT_EQ((box[id<3>(1, 1, 2)]), 2 * 20 + 3 * 5 + 3);
  EXPECT_EQ(box[1][1][2], 2 * 20 + 3 * 5 + 3);
  const std::vector<int> expected{31, 32, 33, 36, 37, 38, 51, 52, 53, 56, 57, 58};
  EXPECT_EQ(std::vector<int>(box.begin(), box.end()), expected);
  EXPECT_EQ(std::vector<int>(box.rbegin(), box.rend()),
            std::vector<int>(expected.rbegin(), expected.rend()));
  EXPECT_EQ(box.cend() - box.cbegin(), 12);
  EXPECT_EQ(box.begin()[7], 52);
}

TEST(Accessor, RangedAccessorsWriteOnlyTheirRange) {
  std::vector<int> v(20);
  {
    buffer<int> buf(v);
    sycl::queue().submit([&](sycl::handler& cgh) {
      const accessor acc(buf, cgh, range<1>(5), id<1>(10), sycl::write_only);
      cgh.parallel_for(acc.get_range(), [=](id<1> i) { acc[i] = 1; });
    });
  }
  for (std::size_t i = 0; i < v.size(); ++i) EXPECT_EQ(v[i], i >= 10 && i < 15 ? 1 : 0);
}

TEST(Accessor, OfNoDimensionsIsTheFirstElement) {
  buffer<int> buf(range<1>(3));
  sycl::queue().submit([&](sycl::handler& cgh) {
    const accessor<int, 0, access_mode::write> acc(buf, cgh);
    EXPECT_EQ(acc.size(), 1U);
    cgh.single_task([=] { acc = 7; });
  });
  const host_accessor<int, 0, access_mode::read> first(buf);
  EXPECT_EQ(first, 7);
}

TEST(Accessor, RangesBeyondTheBufferAreInvalid) {
  buffer<int> buf(range<1>(8));
  const auto expect_invalid = [](auto&& make) {
    try {
      make();
      FAIL() << "accepted";
    } catch (const sycl::exception& e) {
      EXPECT_EQ(e.code(), sycl::errc::invalid) << e.what();
    }
  };
  expect_invalid([&] { host_accessor(buf, range<1>(9)); });
  expect_invalid([&] { host_accessor(buf, range<1>(1), id<1>(8)); });
  expect_invalid([&] { host_accessor(buf, range<1>(~std::size_t{0}), id<1>(2)); });
  EXPECT_NO_THROW(host_accessor(buf, range<1>(0), id<1>(8)));
}

TEST(Accessor, CannotBeBothReadOnlyAndUninitialised) {
  buffer<int> buf(range<1>(8));
  try {
    const host_accessor acc(buf, sycl::read_only, sycl::no_init);
    FAIL() << "accepted";
  } catch (const sycl::exception& e) {
    EXPECT_EQ(e.code(), sycl::errc::invalid);
    EXPECT_STREQ(e.what(), "accessor cannot be both read_only and no_init");
  }
}

TEST(Accessor, ComparesAndHashesByIdentity) {
  buffer<int> buf(range<1>(8));
  const accessor a(buf, sycl::read_only);
  const accessor b(buf, sycl::read_only);
  const accessor c = a;  // NOLINT: the copy is the point
  EXPECT_TRUE(a == c);
  EXPECT_FALSE(a == b);
  const std::hash<std::remove_const_t<decltype(a)>> hash;
  EXPECT_EQ(hash(a), hash(c));
  EXPECT_NE(hash(a), hash(b));
}

TEST(Accessor, ExplicitCopiesGoThroughAccessors) {
  sycl::queue q;
  buffer<int, 2> source(range<2>(4, 4));
  buffer<int, 2> target_buffer(range<2>(4, 4));
  {
    const host_accessor all(source);
    std::iota(all.begin(), all.end(), 0);
  }
  std::vector<int> out(4);
  q.submit([&](sycl::handler& cgh) {
     const accessor box(source, cgh, range<2>(2, 2), id<2>(1, 1), sycl::read_only);
     cgh.copy(box, out.data());
   }).wait();
  EXPECT_EQ(out, (std::vector<int>{5, 6, 9, 10}));
  const std::shared_ptr<int> shared(new int[4]{1, 2, 3, 4}, std::default_delete<int[]>());
  q.submit([&](sycl::handler& cgh) {
    const accessor box(target_buffer, cgh, range<2>(2, 2), id<2>(2, 2), sycl::write_only);
    cgh.copy(shared, box);
  });
  q.submit([&](sycl::handler& cgh) {
    const accessor row(source, cgh, range<2>(1, 4), sycl::read_only);
    const accessor to(target_buffer, cgh, range<2>(1, 4), sycl::write_only);
    cgh.copy(row, to);
  });
  q.fill(accessor(target_buffer, range<2>(1, 4), id<2>(1, 0), sycl::write_only), 9);
  q.update_host(accessor(target_buffer, sycl::read_only)).wait();
  const host_accessor result(target_buffer);
  EXPECT_EQ(result[0][3], 3);
  EXPECT_EQ(result[1][2], 9);
  EXPECT_EQ(result[2][2], 1);
  EXPECT_EQ(result[3][3], 4);
}

}  // namespace
