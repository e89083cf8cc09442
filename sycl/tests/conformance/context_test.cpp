// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <type_traits>
#include <vector>

#include "support.hpp"

namespace {

using conformance::throws;
using sycl::context;
using sycl::device;
using sycl::errc;
using sycl::property_list;
namespace info = sycl::info;

static_assert(conformance::has_reference_semantics<context>);
static_assert(std::is_default_constructible_v<context>);
static_assert(std::is_constructible_v<context, property_list>);
static_assert(std::is_constructible_v<context, sycl::async_handler, property_list>);
static_assert(std::is_constructible_v<context, device, property_list>);
static_assert(std::is_constructible_v<context, device, sycl::async_handler, property_list>);
static_assert(std::is_constructible_v<context, std::vector<device>, property_list>);
static_assert(
    std::is_constructible_v<context, std::vector<device>, sycl::async_handler, property_list>);
static_assert(!std::is_convertible_v<device, context>);
static_assert(!std::is_convertible_v<property_list, context>);
static_assert(!std::is_convertible_v<std::vector<device>, context>);
static_assert(!std::is_convertible_v<sycl::async_handler, context>);
static_assert(noexcept(std::declval<const context&>().get_backend()));
static_assert(
    noexcept(std::declval<const context&>().has_property<sycl::property::queue::in_order>()));

TEST(ConformanceContext, ReferenceSemantics) {
  conformance::expect_reference_semantics(context(), context());
  const device dev;
  conformance::expect_reference_semantics(context(dev), context(dev));
}

TEST(ConformanceContext, DefaultHasTheDefaultDevice) {
  const context ctx;
  EXPECT_EQ(ctx.get_devices(), std::vector<device>{device()});
  EXPECT_EQ(ctx.get_platform(), device().get_platform());
}

TEST(ConformanceContext, KnowsItsDevices) {
  for (const sycl::platform& p : sycl::platform::get_platforms()) {
    const std::vector<device> devices = p.get_devices();
    const context ctx(devices);
    EXPECT_EQ(ctx.get_devices(), devices);
    EXPECT_EQ(ctx.get_platform(), p);
    EXPECT_EQ(ctx.get_backend(), p.get_backend());
    EXPECT_EQ(ctx.get_info<info::context::devices>(), devices);
    EXPECT_EQ(ctx.get_info<info::context::platform>(), p);
    for (const device& dev : devices) {
      EXPECT_EQ(context(dev).get_devices(), std::vector<device>{dev});
    }
  }
}

TEST(ConformanceContext, DevicesOfOnePlatformOnly) {
  const std::vector<sycl::platform> platforms = sycl::platform::get_platforms();
  for (std::size_t i = 1; i < platforms.size(); ++i) {
    const std::vector<device> mixed = {platforms[0].get_devices().front(),
                                       platforms[i].get_devices().front()};
    EXPECT_TRUE(throws(errc::invalid, [&] { context{mixed}; }));
  }
}

TEST(ConformanceContext, MissingPropertyIsInvalid) {
  const context ctx;
  EXPECT_FALSE(ctx.has_property<sycl::property::queue::in_order>());
  EXPECT_TRUE(throws(errc::invalid, [&] { ctx.get_property<sycl::property::queue::in_order>(); }));
}

TEST(ConformanceContext, AtomicCapabilities) {
  const context ctx;
  const auto orders = ctx.get_info<info::context::atomic_memory_order_capabilities>();
  EXPECT_NE(std::find(orders.begin(), orders.end(), sycl::memory_order::relaxed), orders.end());
  const auto fences = ctx.get_info<info::context::atomic_fence_order_capabilities>();
  EXPECT_NE(std::find(fences.begin(), fences.end(), sycl::memory_order::acq_rel), fences.end());
  const auto scopes = ctx.get_info<info::context::atomic_memory_scope_capabilities>();
  EXPECT_NE(std::find(scopes.begin(), scopes.end(), sycl::memory_scope::work_group), scopes.end());
}

TEST(ConformanceContext, HandlerServesQueuesWithoutOne) {
  std::size_t of_context = 0;
  std::size_t of_queue = 0;
  const context ctx(device(), [&](sycl::exception_list errors) { of_context += errors.size(); });
  const auto fail = [](sycl::handler& cgh) {
    cgh.host_task([] { throw sycl::exception(errc::runtime, "failed"); });
  };
  sycl::queue plain(ctx, ctx.get_devices().front());
  plain.submit(fail);
  plain.wait_and_throw();
  EXPECT_EQ(of_context, 1U);
  sycl::queue with_own(ctx, ctx.get_devices().front(),
                       [&](sycl::exception_list errors) { of_queue += errors.size(); });
  with_own.submit(fail);
  with_own.wait_and_throw();
  EXPECT_EQ(of_context, 1U);
  EXPECT_EQ(of_queue, 1U);
}

}  // namespace
