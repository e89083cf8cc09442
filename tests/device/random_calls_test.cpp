// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include "call/queue_store.hpp"
#include "pointer_arena.hpp"
#include "queues.hpp"
#include "recorded_kernels.hpp"

namespace {

using namespace arbor::lumen::tests;
using arbor::lumen::vm::detail::queue_store;

/// Launches a record, waits, and says what came of it.
template <typename Shape, typename Record>
outcome launched(const Record& record) {
  auto& word = queue_store::instance().status_word(record.queue.key());
  word = 0;
  outcome result;
  try {
    norvane::launcher<Shape, tag<Shape, float>>(record, {1}).wait();
  } catch (const std::exception& thrown) {
    result.error = thrown.what();
  }
  result.queue_status = word.exchange(0);
  return result;
}

template <typename Shape>
class RandomCalls : public ::testing::Test {
 protected:
  void SetUp() override {
    seed_ = std::random_device{}();
    RecordProperty("seed", std::to_string(seed_));
    std::cout << "seed " << seed_ << '\n';
  }
  std::uint32_t seed_ = 0;
};

using shapes = ::testing::Types<shape::v11, shape::v12, shape::v21, shape::v21c>;
TYPED_TEST_SUITE(RandomCalls, shapes);

TYPED_TEST(RandomCalls, OnPointers) {
  random_calls calls(this->seed_);
  std::vector<std::unique_ptr<pointer_arena>> arenas;
  for (const sycl::queue& queue : all_queues())
    arenas.push_back(std::make_unique<pointer_arena>(queue));
  for (int i = 0; i < 30'000 / calls_divisor; ++i) {
    pointer_arena& arena = *arenas[static_cast<std::size_t>(i) % arenas.size()];
    random_call call = calls.next<TypeParam>();
    expect_as_the_loop<TypeParam>(call, true, arena, [&](const random_call& given) {
      return given.sliced ? launched<TypeParam>(arena.strided<TypeParam>(given))
                          : launched<TypeParam>(arena.linear<TypeParam>(given));
    });
    if (this->HasFatalFailure()) return;
  }
}

TYPED_TEST(RandomCalls, OnBuffers) {
  using T = float;
  random_calls calls(this->seed_);
  std::vector<sycl::queue> queues = all_queues();
  for (int i = 0; i < 6'000 / calls_divisor; ++i) {
    sycl::queue& queue = queues[static_cast<std::size_t>(i) % queues.size()];
    random_call call = calls.next<TypeParam>();
    if (!call.sliced && call.n == 0) continue;  // means all of a buffer
    random_call expected = call;
    const outcome wanted = carry_out<TypeParam>(expected, true);

    std::vector<sycl::buffer<T, 1>> memory;
    for (auto& zone : call.contents) memory.emplace_back(zone.begin(), zone.end());
    sycl::buffer<enums::status, 1> status(call.status.begin(), call.status.end());
    const auto finish = [&](auto record) {
      record.mode = call.mode;
      record.handler = call.handler;
      record.handler.status_buffer = status;
      return launched<TypeParam>(record);
    };
    outcome got;
    if (call.sliced) {
      auto record = buffer_strided_call<TypeParam, T>(queue, {}, {}, call.constants);
      for (const operand& a : call.in) {
        record.in_buffers.push_back(&memory[static_cast<std::size_t>(a.zone)]);
        record.in_slices.push_back(a.where);
      }
      for (const operand& y : call.out) {
        record.out_buffers.push_back(&memory[static_cast<std::size_t>(y.zone)]);
        record.out_slices.push_back(y.where);
      }
      got = finish(record);
    } else {
      auto record = buffer_call<TypeParam, T>(queue, call.n, {}, {}, call.constants);
      for (const operand& a : call.in)
        record.in_buffers.push_back(&memory[static_cast<std::size_t>(a.zone)]);
      for (const operand& y : call.out)
        record.out_buffers.push_back(&memory[static_cast<std::size_t>(y.zone)]);
      got = finish(record);
    }
    ASSERT_EQ(got.error, wanted.error) << describe(call);
    ASSERT_EQ(got.queue_status, wanted.queue_status) << describe(call);
    for (std::size_t z = 0; z < zones; ++z)
      ASSERT_TRUE(same(contents_of(memory[z]), expected.contents[z]))
          << "zone " << z << ": " << describe(call);
    ASSERT_EQ(contents_of(status), expected.status) << describe(call);
  }
}

}  // namespace
