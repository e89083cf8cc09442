// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <array>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <tuple>
#include <type_traits>
#include <utility>
#include <variant>
#include <vector>

#include "support.hpp"

namespace {

using conformance::throws;
using sycl::errc;
using sycl::property_list;
namespace property = sycl::property;

static_assert(SYCL_LANGUAGE_VERSION >= 202000L);

static_assert(std::is_default_constructible_v<property_list>);
static_assert(std::is_constructible_v<property_list, property::queue::in_order>);
static_assert(std::is_constructible_v<property_list, property::queue::in_order,
                                      property::queue::enable_profiling>);
static_assert(!std::is_constructible_v<property_list, int>);
static_assert(sycl::is_property_v<property::queue::in_order>);
static_assert(sycl::is_property_v<property::queue::enable_profiling>);
static_assert(sycl::is_property_v<property::buffer::use_host_ptr>);
static_assert(sycl::is_property_v<property::buffer::use_mutex>);
static_assert(sycl::is_property_v<property::buffer::context_bound>);
static_assert(sycl::is_property_v<property::no_init>);
static_assert(std::is_same_v<std::remove_cv_t<decltype(sycl::no_init)>, property::no_init>);
static_assert(!sycl::is_property_v<int> && !sycl::is_property<std::string>::value);
static_assert(!sycl::is_property_of_v<int, sycl::queue>);

TEST(ConformanceProperty, ListsKeepTheirProperties) {
  const property_list empty;
  const property_list one{property::queue::in_order()};
  const sycl::queue without(empty);
  const sycl::queue with(one);
  EXPECT_FALSE(without.has_property<property::queue::in_order>());
  EXPECT_TRUE(with.has_property<property::queue::in_order>());
}

using sycl::is_device_copyable_v;

struct trivial {
  int a;
  double b;
};
struct owning {
  std::string text;
};
static_assert(is_device_copyable_v<int> && is_device_copyable_v<trivial>);
static_assert(!is_device_copyable_v<owning> && !is_device_copyable_v<std::vector<int>>);
TEST(ConformanceDeviceCopyable, LibraryTypesOfDeviceCopyableParts) {
  EXPECT_TRUE((is_device_copyable_v<std::array<int, 3>>));
  EXPECT_TRUE((is_device_copyable_v<std::array<int, 0>>));
  EXPECT_TRUE((is_device_copyable_v<std::optional<int>>));
  EXPECT_TRUE((is_device_copyable_v<std::pair<int, float>>));
  EXPECT_TRUE((is_device_copyable_v<std::tuple<>>));
  EXPECT_TRUE((is_device_copyable_v<std::tuple<int, float, trivial>>));
  EXPECT_TRUE((is_device_copyable_v<std::variant<int, float>>));
  EXPECT_TRUE((is_device_copyable_v<std::span<int>>));
  EXPECT_TRUE((is_device_copyable_v<std::string_view>));
  EXPECT_TRUE((is_device_copyable_v<int[4]>));
  EXPECT_TRUE((is_device_copyable_v<const std::pair<int, float>>));
}
static_assert(!is_device_copyable_v<std::pair<int, std::string>>);
static_assert(!is_device_copyable_v<std::tuple<int, std::string>>);
static_assert(is_device_copyable_v<sycl::id<3>> && is_device_copyable_v<sycl::range<2>> &&
              is_device_copyable_v<sycl::item<1>> && is_device_copyable_v<sycl::half>);
static_assert(is_device_copyable_v<sycl::accessor<int, 1>>);
static_assert(is_device_copyable_v<sycl::accessor<int, 2, sycl::access_mode::write>>);

struct declared {
  declared(const declared& other) : value(other.value) {}
  int value;
};

}  // namespace

// A program may declare a type of its own.
template <>
struct sycl::is_device_copyable<declared> : std::true_type {};
static_assert(sycl::is_device_copyable_v<declared>);
