// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <iterator>
#include <numeric>
#include <type_traits>
#include <vector>

#include "support.hpp"

namespace {

using conformance::throws;
using sycl::access_mode;
using sycl::accessor;
using sycl::buffer;
using sycl::errc;
using sycl::handler;
using sycl::id;
using sycl::range;
using sycl::target;
namespace access = sycl::access;

static_assert(conformance::has_reference_semantics<accessor<int, 1>>);
static_assert(conformance::has_reference_semantics<accessor<const int, 3, access_mode::read>>);
static_assert(std::is_default_constructible_v<accessor<int, 2>>);
static_assert(
    std::is_same_v<accessor<int>, accessor<int, 1, access_mode::read_write, target::device>>);
static_assert(
    std::is_same_v<accessor<const int>, accessor<const int, 1, access_mode::read, target::device>>);
static_assert(sycl::is_property_of_v<sycl::property::no_init, accessor<int>>);
static_assert(!sycl::is_property_of_v<sycl::property::queue::in_order, accessor<int>>);

using writer = accessor<int, 1, access_mode::write>;
using reader = accessor<int, 1, access_mode::read>;
using const_reader = accessor<const int, 1, access_mode::read>;
static_assert(std::is_same_v<writer::value_type, int>);
static_assert(std::is_same_v<reader::value_type, const int>);
static_assert(std::is_same_v<const_reader::value_type, const int>);
static_assert(std::is_same_v<writer::reference, int&>);
static_assert(std::is_same_v<reader::reference, const int&>);
static_assert(std::is_same_v<writer::const_reference, const int&>);
static_assert(std::is_same_v<writer::size_type, std::size_t>);
static_assert(std::is_signed_v<writer::difference_type>);
static_assert(std::random_access_iterator<writer::iterator>);
static_assert(std::random_access_iterator<writer::const_iterator>);
static_assert(std::random_access_iterator<accessor<int, 3>::iterator>);
static_assert(std::is_same_v<std::iter_reference_t<reader::iterator>, const int&>);
static_assert(std::is_same_v<std::iter_reference_t<writer::const_iterator>, const int&>);
static_assert(std::is_same_v<writer::reverse_iterator, std::reverse_iterator<writer::iterator>>);
static_assert(writer::dimensions == 1 && accessor<int, 3>::dimensions == 3);

// Read-only accessors are made of read-write ones and of each other.
static_assert(std::is_convertible_v<accessor<int>, const_reader>);
static_assert(std::is_convertible_v<accessor<int>, reader>);
static_assert(std::is_convertible_v<reader, const_reader>);
static_assert(std::is_convertible_v<const_reader, reader>);
static_assert(!std::is_convertible_v<const_reader, accessor<int>>);
static_assert(!std::is_convertible_v<writer, const_reader>);

static_assert(noexcept(std::declval<const writer&>().size()));
static_assert(noexcept(std::declval<const writer&>().byte_size()));
static_assert(noexcept(std::declval<const writer&>().max_size()));
static_assert(noexcept(std::declval<const writer&>().empty()));
static_assert(noexcept(std::declval<const writer&>().begin()));
static_assert(noexcept(std::declval<const writer&>().crend()));

/// The type that the deduction guides find for the arguments after the buffer.
template <int Dimensions, typename... Args>
using deduced =
    decltype(accessor(std::declval<buffer<int, Dimensions>&>(), std::declval<Args>()...));
constexpr auto yes = access::placeholder::true_t;
constexpr auto no = access::placeholder::false_t;
template <typename Actual, access_mode Mode, target Target>
constexpr bool is_deduced =
    std::is_same_v<typename Actual::value_type,
                   std::conditional_t<Mode == access_mode::read, const int, int>> &&
    (std::is_same_v<Actual,
                    accessor<typename Actual::value_type, Actual::dimensions, Mode, Target, yes>> ||
     std::is_same_v<Actual,
                    accessor<typename Actual::value_type, Actual::dimensions, Mode, Target, no>>);
using ro = decltype(sycl::read_only);
using wo = decltype(sycl::write_only);
using rw = decltype(sycl::read_write);
using ro_host = decltype(sycl::read_only_host_task);
using wo_host = decltype(sycl::write_only_host_task);
static_assert(is_deduced<deduced<1>, access_mode::read_write, target::device>);
static_assert(is_deduced<deduced<1, handler&>, access_mode::read_write, target::device>);
static_assert(is_deduced<deduced<2, handler&, ro>, access_mode::read, target::device>);
static_assert(is_deduced<deduced<1, handler&, wo>, access_mode::write, target::device>);
static_assert(is_deduced<deduced<3, handler&, rw>, access_mode::read_write, target::device>);
static_assert(is_deduced<deduced<1, handler&, ro_host>, access_mode::read, target::host_task>);
static_assert(is_deduced<deduced<1, handler&, wo_host>, access_mode::write, target::host_task>);
static_assert(is_deduced<deduced<1, ro>, access_mode::read, target::device>);
static_assert(
    is_deduced<deduced<1, handler&, wo, sycl::property_list>, access_mode::write, target::device>);
static_assert(is_deduced<deduced<1, handler&, range<1>, ro>, access_mode::read, target::device>);
static_assert(is_deduced<deduced<2, handler&, range<2>, id<2>, wo, sycl::property_list>,
                         access_mode::write, target::device>);

buffer<int> make_buffer(std::size_t count) {
  std::vector<int> values(count);
  std::iota(values.begin(), values.end(), 0);
  return buffer<int>(values.begin(), values.end());
}

std::vector<int> contents(buffer<int>& buf) {
  const sycl::host_accessor acc(buf, sycl::read_only);
  return std::vector<int>(acc.begin(), acc.end());
}

TEST(ConformanceAccessor, ReferenceSemantics) {
  buffer<int> buf(range<1>(4));
  const accessor<int> a(buf);
  const accessor<int> b(buf);
  conformance::expect_reference_semantics<accessor<int>>(a, b);
}

TEST(ConformanceAccessor, DefaultIsEmpty) {
  const accessor<int, 2> acc;
  EXPECT_TRUE(acc.empty());
  EXPECT_EQ(acc.size(), 0U);
  EXPECT_EQ(acc.byte_size(), 0U);
  EXPECT_EQ(acc.get_range(), range<2>(0, 0));
  EXPECT_EQ(acc.get_offset(), id<2>(0, 0));
  EXPECT_TRUE(acc.begin() == acc.end());
}

TEST(ConformanceAccessor, Sizes) {
  buffer<int, 2> buf(range<2>(4, 6));
  sycl::queue q;
  q.submit([&](handler& cgh) {
    const accessor whole(buf, cgh, sycl::read_only);
    EXPECT_EQ(whole.size(), 24U);
    EXPECT_EQ(whole.byte_size(), 24 * sizeof(int));
    EXPECT_GE(whole.max_size(), whole.size());
    EXPECT_FALSE(whole.empty());
    EXPECT_EQ(whole.get_range(), range<2>(4, 6));
    EXPECT_EQ(whole.get_offset(), id<2>(0, 0));
    EXPECT_FALSE(whole.is_placeholder());
    const accessor part(buf, cgh, range<2>(2, 3), id<2>(1, 2), sycl::read_only);
    EXPECT_EQ(part.size(), 6U);
    EXPECT_EQ(part.get_range(), range<2>(2, 3));
    EXPECT_EQ(part.get_offset(), id<2>(1, 2));
    EXPECT_EQ(part.end() - part.begin(), 6);
  });
  const accessor later(buf, sycl::read_only);
  EXPECT_TRUE(later.is_placeholder());
}

TEST(ConformanceAccessor, RangedAccessorsCountFromTheirOffset) {
  buffer<int> buf = make_buffer(10);
  sycl::queue q;
  q.submit([&](handler& cgh) {
    const accessor acc(buf, cgh, range<1>(3), id<1>(5), sycl::read_write);
    cgh.parallel_for(range<1>(3), [=](id<1> i) { acc[i] = -static_cast<int>(i[0]) - 1; });
  });
  EXPECT_EQ(contents(buf), (std::vector<int>{0, 1, 2, 3, 4, -1, -2, -3, 8, 9}));
}

TEST(ConformanceAccessor, RangesMustLieInTheBuffer) {
  buffer<int> buf(range<1>(10));
  buffer<int, 2> plane(range<2>(4, 6));
  sycl::queue q;
  q.submit([&](handler& cgh) {
    EXPECT_TRUE(throws(errc::invalid, [&] { accessor(buf, cgh, range<1>(11), sycl::read_only); }));
    EXPECT_TRUE(
        throws(errc::invalid, [&] { accessor(buf, cgh, range<1>(5), id<1>(6), sycl::read_only); }));
    EXPECT_TRUE(throws(errc::invalid, [&] {
      accessor(plane, cgh, range<2>(1, 5), id<2>(0, 2), sycl::read_only);
    }));
    EXPECT_NO_THROW(accessor(buf, cgh, range<1>(5), id<1>(5), sycl::read_only));
  });
}

TEST(ConformanceAccessor, NoInitExcludesReadOnly) {
  buffer<int> buf(range<1>(10));
  sycl::queue q;
  q.submit([&](handler& cgh) {
    EXPECT_TRUE(
        throws(errc::invalid, [&] { accessor(buf, cgh, sycl::read_only, {sycl::no_init}); }));
    EXPECT_NO_THROW(accessor(buf, cgh, sycl::write_only, {sycl::no_init}));
    EXPECT_NO_THROW(accessor(buf, cgh, sycl::read_write, sycl::no_init));
  });
}

TEST(ConformanceAccessor, WriteOnlyKeepsWhatIsNotWritten) {
  buffer<int> buf = make_buffer(6);
  sycl::queue q;
  q.submit([&](handler& cgh) {
    const accessor acc(buf, cgh, sycl::write_only);
    cgh.single_task([=] { acc[2] = 20; });
  });
  EXPECT_EQ(contents(buf), (std::vector<int>{0, 1, 20, 3, 4, 5}));
}

TEST(ConformanceAccessor, PlaceholdersServeAfterRequire) {
  buffer<int> buf = make_buffer(4);
  const accessor acc(buf, sycl::read_write);
  EXPECT_TRUE(acc.is_placeholder());
  sycl::queue q;
  for (int round = 0; round < 10; ++round) {
    q.submit([&](handler& cgh) {
      cgh.require(acc);
      cgh.parallel_for(range<1>(4), [=](id<1> i) { acc[i] += 1; });
    });
  }
  EXPECT_EQ(contents(buf), (std::vector<int>{10, 11, 12, 13}));
}

TEST(ConformanceAccessor, MembersOfBuffersMakeAccessors) {
  buffer<int> buf = make_buffer(4);
  sycl::queue q;
  q.submit([&](handler& cgh) {
    auto acc = buf.get_access<access_mode::read_write>(cgh);
    static_assert(std::is_same_v<decltype(acc), accessor<int, 1, access_mode::read_write>>);
    cgh.parallel_for(range<1>(4), [=](id<1> i) { acc[i] *= 2; });
  });
  q.submit([&](handler& cgh) {
    auto acc = buf.get_access(cgh, sycl::read_write);
    cgh.single_task([=] { acc[0] = 9; });
  });
  q.submit([&](handler& cgh) {
    auto acc = buf.get_access<access_mode::write>(cgh, range<1>(1), id<1>(3));
    cgh.single_task([=] { acc[0] = 8; });
  });
  EXPECT_EQ(contents(buf), (std::vector<int>{9, 2, 4, 8}));
}

TEST(ConformanceAccessor, IteratesOverItsRange) {
  std::vector<int> data(24);
  std::iota(data.begin(), data.end(), 0);
  buffer<int, 2> buf(data.data(), range<2>(4, 6));
  buffer<int> sums(range<1>(4));
  sycl::queue q;
  q.submit([&](handler& cgh) {
    const accessor part(buf, cgh, range<2>(2, 3), id<2>(1, 2), sycl::read_only);
    const accessor out(sums, cgh, sycl::write_only, {sycl::no_init});
    cgh.single_task([=] {
      int forward = 0;
      int weight = 1;
      for (const int x : part) forward += x * weight++;
      int backward = 0;
      for (auto it = part.rbegin(); it != part.rend(); ++it) backward += *it * --weight;
      out[0] = forward;
      out[1] = backward;
      out[2] = *part.cbegin();
      out[3] = *part.crbegin();
    });
  });
  // Rows 1 and 2, columns 2 to 4.
  const int expected = 8 * 1 + 9 * 2 + 10 * 3 + 14 * 4 + 15 * 5 + 16 * 6;
  EXPECT_EQ(contents(sums), (std::vector<int>{expected, expected, 8, 16}));
}

TEST(ConformanceAccessor, SubscriptsInSeveralDimensions) {
  std::vector<int> data(24);
  std::iota(data.begin(), data.end(), 0);
  buffer<int, 3> buf(data.data(), range<3>(2, 3, 4));
  buffer<int> out(range<1>(4));
  sycl::queue q;
  q.submit([&](handler& cgh) {
    const accessor in(buf, cgh, sycl::read_only);
    const accessor part(buf, cgh, range<3>(1, 2, 2), id<3>(1, 1, 2), sycl::read_only);
    const accessor result(out, cgh, sycl::write_only);
    cgh.single_task([=] {
      result[0] = in[id<3>(1, 2, 3)];
      result[1] = in[1][2][3];
      result[2] = part[id<3>(0, 1, 1)];
      result[3] = part[0][1][1];
    });
  });
  EXPECT_EQ(contents(out), (std::vector<int>{23, 23, 23, 23}));
}

TEST(ConformanceAccessor, OfNoDimensionsIsTheFirstElement) {
  buffer<int> buf = make_buffer(3);
  sycl::queue q;
  q.submit([&](handler& cgh) {
    const accessor<int, 0> acc(buf, cgh);
    EXPECT_EQ(acc.size(), 1U);
    cgh.single_task([=] {
      int& element = acc;
      element += 5;
    });
  });
  q.submit([&](handler& cgh) {
    const accessor<int, 0, access_mode::read_write> acc(buf, cgh);
    cgh.single_task([=] { acc = acc + 10; });
  });
  EXPECT_EQ(contents(buf), (std::vector<int>{15, 1, 2}));
}

TEST(ConformanceAccessor, ServesHostTasks) {
  buffer<int> buf = make_buffer(3);
  sycl::queue q;
  q.submit([&](handler& cgh) {
    const accessor acc(buf, cgh, sycl::read_write_host_task);
    static_assert(std::is_same_v<std::remove_const_t<decltype(acc)>,
                                 accessor<int, 1, access_mode::read_write, target::host_task>>);
    cgh.host_task([=] { acc[1] = 7; });
  });
  EXPECT_EQ(contents(buf), (std::vector<int>{0, 7, 2}));
}

TEST(ConformanceAccessor, Swap) {
  buffer<int> one(range<1>(1));
  buffer<int> two(range<1>(2));
  accessor<int> a(one);
  accessor<int> b(two);
  const accessor<int> old = a;
  a.swap(b);
  EXPECT_EQ(a.size(), 2U);
  EXPECT_TRUE(b == old);
}

TEST(ConformanceAccessor, OrdersCommands) {
  // Each command depends on the one before through one of two buffers.
  buffer<int> a = make_buffer(1);
  buffer<int> b = make_buffer(1);
  sycl::queue first;
  sycl::queue second;
  for (int i = 0; i < 200; ++i) {
    sycl::queue& q = i % 2 == 0 ? first : second;
    q.submit([&](handler& cgh) {
      const accessor in(i % 2 == 0 ? a : b, cgh, sycl::read_only);
      const accessor out(i % 2 == 0 ? b : a, cgh, sycl::write_only);
      cgh.single_task([=] { out[0] = in[0] + 1; });
    });
  }
  EXPECT_EQ(contents(a), std::vector<int>{200});
  EXPECT_EQ(contents(b), std::vector<int>{199});
}

}  // namespace
