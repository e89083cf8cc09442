// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include <numeric>

#include "call/queue_store.hpp"
#include "functors.hpp"
#include "gate.hpp"
#include "memory.hpp"
#include "queues.hpp"
#include "recorded_kernels.hpp"
#include "records.hpp"

namespace {

using namespace arbor::lumen::tests;
using arbor::lumen::vm::detail::queue_key;
using arbor::lumen::vm::detail::queue_store;

using buffer = sycl::buffer<float, 1>;
using status_buffer = sycl::buffer<enums::status, 1>;
using values = std::vector<float>;

/// A buffer of its own memory with some contents.
template <typename T>
sycl::buffer<T, 1> filled(const std::vector<T>& contents) {
  return sycl::buffer<T, 1>(contents.begin(), contents.end());
}

template <typename Functor, typename Shape = shape::v11, typename Record>
sycl::event run(const Record& record) {
  return norvane::launcher<Shape, Functor>(record, {1});
}

template <typename T>
struct twice : test_functor<T> {
  static std::uint32_t call(const T* a, T* y) {
    *y = 2 * *a;
    return 0;
  }
};
template <typename T>
struct one_more : test_functor<T> {
  static std::uint32_t call(const T* a, T* y) {
    *y = *a + 1;
    return 0;
  }
};

class Buffers : public ::testing::TestWithParam<const char*> {
 protected:
  sycl::queue queue_ = std::string(GetParam()) == "cpu" ? cpu_queue() : gpu_queue();
};
INSTANTIATE_TEST_SUITE_P(Queues, Buffers, ::testing::Values("cpu", "gpu"),
                         [](const auto& tested) { return std::string(tested.param); });

TEST_P(Buffers, WholeBuffersOfEveryShape) {
  buffer a = filled<float>({0, 1, 2, 3}), b = filled<float>({7, 8, 9, 10});
  buffer y = filled<float>({50, 51, 52, 53}), z = filled<float>({60, 61, 62, 63});
  run<tag_v11<float>>(buffer_call<shape::v11, float>(queue_, 3, {&a}, {&y}));
  EXPECT_EQ(contents_of(y), (values{1, 3, 5, 53}));
  run<tag_v12<float>, shape::v12>(buffer_call<shape::v12, float>(queue_, 4, {&a}, {&y, &z}));
  EXPECT_EQ(contents_of(y), (values{0, 3, 6, 9}));
  EXPECT_EQ(contents_of(z), (values{0, -1, -2, -3}));
  run<tag_v21<float>, shape::v21>(buffer_call<shape::v21, float>(queue_, 4, {&a, &b}, {&y}));
  EXPECT_EQ(contents_of(y), (values{7, 1008, 2009, 3010}));
  run<tag_v21c<float>, shape::v21c>(buffer_call<shape::v21c, float>(queue_, 2, {&a}, {&y}, {5.0f}));
  EXPECT_EQ(contents_of(y), (values{5, 1005, 2009, 3010}));
}

TEST_P(Buffers, WithoutACountTheShortestBufferDecides) {
  buffer a = filled<float>({0, 1, 2, 3, 4}), y = filled<float>({50, 51, 52});
  run<tag_v11<float>>(buffer_call<shape::v11, float>(queue_, 0, {&a}, {&y}));
  EXPECT_EQ(contents_of(y), (values{1, 3, 5}));
}

TEST_P(Buffers, ANegativeCountComputesNothing) {
  buffer a = filled<float>({0, 1}), y = filled<float>({50, 51});
  run<tag_v11<float>>(buffer_call<shape::v11, float>(queue_, -3, {&a}, {&y}));
  EXPECT_EQ(contents_of(y), (values{50, 51}));
}

TEST_P(Buffers, Slices) {
  buffer a = filled<float>({0, 1, 2, 3, 4, 5, 7, 8}), y = filled<float>(values(8, 50));
  run<tag_v11<float>>(
      buffer_strided_call<shape::v11, float>(queue_, {{&a, {1, 3, 2}}}, {{&y, {6, 3, -3}}}));
  EXPECT_EQ(contents_of(y), (values{11, 50, 50, 7, 50, 50, 3, 50}))
      << "elements that the slice leaves out keep their values";
}

TEST_P(Buffers, CyclicSlices) {
  buffer a = filled<float>({1, 2}), b = filled<float>({7, 8, 9});
  buffer y = filled<float>(values(12, 0));
  auto record = buffer_strided_call<shape::v21, float>(queue_, {{&a, {0, 2, 1}}, {&b, {0, 3, 1}}},
                                                       {{&y, {0, 12, 1}}});
  record.mode = mode_with(enums::slice_cyclic);
  run<tag_v21<float>, shape::v21>(record);
  EXPECT_EQ(contents_of(y),
            (values{1007, 1008, 1009, 2007, 2008, 2009, 1007, 1008, 1009, 2007, 2008, 2009}));
}

TEST_P(Buffers, InPlace) {
  buffer a = filled<float>({1, 2, 3});
  run<tag_v11<float>>(buffer_call<shape::v11, float>(queue_, 3, {&a}, {&a}));
  EXPECT_EQ(contents_of(a), (values{3, 5, 7}));
  run<tag_v21<float>, shape::v21>(buffer_call<shape::v21, float>(queue_, 2, {&a, &a}, {&a}));
  EXPECT_EQ(contents_of(a), (values{3003, 5005, 7}));
  run<tag_v11<float>>(
      buffer_strided_call<shape::v11, float>(queue_, {{&a, {0, 1, 1}}}, {{&a, {2, 1, 1}}}));
  EXPECT_EQ(contents_of(a), (values{3003, 5005, 6007}));
}

TEST_P(Buffers, ASubBufferIsAWindow) {
  buffer all = filled<float>(values(64, 1));
  buffer half(all, sycl::id<1>(32), sycl::range<1>(32));
  run<tag_v11<float>>(buffer_call<shape::v11, float>(queue_, 32, {&half}, {&half}));
  values expected(64, 1);
  std::fill(expected.begin() + 32, expected.end(), 3.0f);
  EXPECT_EQ(contents_of(all), expected);
}

TEST_P(Buffers, CallsAreOrderedWithoutEvents) {
  buffer a = filled<float>({1, 2, 3});
  buffer b{sycl::range<1>(3)}, c{sycl::range<1>(3)};
  gate before(queue_);
  // Something holds the first input up; the calls below have to queue up behind it.
  queue_.submit([&](sycl::handler& group) {
    group.depends_on(before.event());
    const sycl::accessor access(a, group, sycl::read_write);
    group.parallel_for(sycl::range<1>(3), [access](sycl::id<1> i) { access[i] += 10; });
  });
  sycl::event last;
  for (int i = 0; i < 10; ++i) {
    run<twice<float>>(buffer_call<shape::v11, float>(queue_, 3, {&a}, {&b}));
    run<tag_v21<float>, shape::v21>(buffer_call<shape::v21, float>(queue_, 3, {&b, &a}, {&c}));
    last = run<one_more<float>>(buffer_call<shape::v11, float>(queue_, 3, {&b}, {&a}));
  }
  EXPECT_FALSE(is_complete(last));
  before.open();
  // a becomes 2a + 1 in each round, from 10 more than it was.
  values expected{11, 12, 13};
  for (float& x : expected)
    for (int i = 0; i < 10; ++i) x = 2 * x + 1;
  EXPECT_EQ(contents_of(a), expected);
  for (std::size_t k = 0; k < 3; ++k) EXPECT_EQ(contents_of(b)[k], expected[k] - 1);
}

TEST_P(Buffers, CallsDoNotBlock) {
  buffer a = filled<float>({1, 2, 3}), y{sycl::range<1>(3)};
  gate before(queue_);
  queue_.submit([&](sycl::handler& group) {
    group.depends_on(before.event());
    const sycl::accessor access(a, group, sycl::write_only);
    group.single_task([access] { access[0] = 100; });
  });
  background call([&] {
    // The record and its handler are gone when the call returns, as in an exported function.
    return run<tag_v11<float>>(buffer_call<shape::v11, float>(queue_, 3, {&a}, {&y}));
  });
  EXPECT_TRUE(call.returns());
  before.open();
  call.get();
  EXPECT_EQ(contents_of(y), (values{201, 5, 7}));
}

TEST_P(Buffers, AGlobalReportBlocks) {
  buffer a = filled<float>({0, 2, 4}), y{sycl::range<1>(3)};
  auto record = buffer_call<shape::v11, float>(queue_, 3, {&a}, {&y});
  record.mode = mode_with(enums::global_status_report);
  auto& word = queue_store::instance().status_word(queue_key(&queue_));
  word = 0;
  gate before(queue_);
  queue_.submit([&](sycl::handler& group) {
    group.depends_on(before.event());
    const sycl::accessor access(a, group, sycl::read_write);
    group.single_task([access] { access[0] = 1; });
  });
  background call([&] { return run<echo_status<float>>(record); });
  EXPECT_TRUE(call.blocks());
  before.open();
  call.get();
  EXPECT_EQ(word.exchange(0), enums::errdom | enums::sing | enums::overflow);
}

TEST_P(Buffers, StatusOfElements) {
  buffer a = filled<float>({0, 1, 2, 8}), y{sycl::range<1>(4)};
  status_buffer status = filled(std::vector<enums::status>(4, enums::accuracy_warning));
  auto record = buffer_call<shape::v11, float>(queue_, 4, {&a}, {&y});
  record.handler = arbor::lumen::vm::error_handler<float>(status, 4, enums::sing, -2.0f);
  run<echo_status<float>>(record);
  EXPECT_EQ(contents_of(status), (std::vector<enums::status>{enums::accuracy_warning, enums::errdom,
                                                             enums::sing, enums::underflow}));
  EXPECT_EQ(contents_of(y), (values{0, 1, -2, 8}));
}

TEST_P(Buffers, StatusOfSlicesIsIndexedByTheOutput) {
  buffer a = filled<float>({1, 2, 4}), y = filled<float>(values(6, 0));
  status_buffer status = filled(std::vector<enums::status>(6));
  auto record =
      buffer_strided_call<shape::v11, float>(queue_, {{&a, {0, 3, 1}}}, {{&y, {5, 3, -2}}});
  record.handler = arbor::lumen::vm::error_handler<float>(status, 6);
  run<echo_status<float>>(record);
  EXPECT_EQ(contents_of(status),
            (std::vector<enums::status>{enums::success, enums::overflow, enums::success,
                                        enums::sing, enums::success, enums::errdom}));
}

TEST_P(Buffers, OneStatusOfManyCalls) {
  buffer a = filled<float>({0, 1, 8}), b = filled<float>({2, 0, 0}), y{sycl::range<1>(3)};
  status_buffer status = filled(std::vector<enums::status>(1));
  const arbor::lumen::vm::error_handler<float> handler(status, 1);
  auto first = buffer_call<shape::v11, float>(queue_, 3, {&a}, {&y});
  auto second = buffer_call<shape::v11, float>(queue_, 3, {&b}, {&y});
  first.handler = handler;
  second.handler = handler;
  run<echo_status<float>>(first);
  EXPECT_EQ(contents_of(status)[0], enums::errdom | enums::underflow);
  run<echo_status<float>>(second);
  EXPECT_EQ(contents_of(status)[0], enums::errdom | enums::underflow | enums::sing);
}

TEST_P(Buffers, AHandlerThatIsNotEnabledDoesNothing) {
  buffer a = filled<float>({1, 2}), y{sycl::range<1>(2)};
  status_buffer status = filled(std::vector<enums::status>(2, enums::accuracy_warning));
  auto record = buffer_call<shape::v11, float>(queue_, 2, {&a}, {&y});
  record.handler = arbor::lumen::vm::error_handler<float>(status, 2, enums::errdom, -1.0f);
  record.handler.enabled = false;
  run<echo_status<float>>(record);
  EXPECT_EQ(contents_of(y), (values{1, 2}));
  EXPECT_EQ(contents_of(status), std::vector<enums::status>(2, enums::accuracy_warning));
}

TEST_P(Buffers, TheStatusBufferIsTakenEvenIfNothingIsReported) {
  // Whoever holds it holds the call up.
  buffer a = filled<float>({1, 2}), y{sycl::range<1>(2)};
  auto record = buffer_call<shape::v11, float>(queue_, 2, {&a}, {&y});
  gate before(queue_);
  queue_.submit([&](sycl::handler& group) {
    group.depends_on(before.event());
    const sycl::accessor access(record.handler.status_buffer, group, sycl::read_write);
    group.single_task([access] { access[0] = enums::success; });
  });
  const sycl::event event = run<tag_v11<float>>(record);
  EXPECT_FALSE(is_complete(event));
  before.open();
  sycl::event(event).wait();
  EXPECT_EQ(contents_of(y), (values{3, 5}));
}

TEST_P(Buffers, AMissingOutputIsNamedAndNothingRuns) {
  buffer a = filled<float>({1, 2}), y = filled<float>({50, 51});
  const auto record = buffer_call<shape::v12, float>(queue_, 2, {&a}, {&y});
  EXPECT_EQ(message_of<std::logic_error>([&] { run<tag_v12<float>, shape::v12>(record); }),
            "ArborLumen::vm::detail::input::name: buffer: index of output is too large");
  EXPECT_EQ(contents_of(y), (values{50, 51}));
}

}  // namespace
