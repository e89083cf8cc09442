// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "host/executor.hpp"

#include <gtest/gtest.h>

#include <complex>
#include <stdexcept>

#include "call/queue_store.hpp"
#include "device/functors.hpp"
#include "device/gate.hpp"
#include "device/launch.hpp"
#include "device/memory.hpp"
#include "device/queues.hpp"
#include "device/records.hpp"
#include "host/loop.hpp"
#include "recorded_entries.hpp"

namespace {

using namespace arbor::lumen::tests;
using arbor::lumen::vm::detail::queue_store;
using counts = std::vector<std::int64_t>;
using values = std::vector<float>;

template <typename Shape>
std::string refusal_of(const input::vxx& record) {
  recorded_entries<Shape, float>::reset();
  const std::string text =
      message_of<std::runtime_error>([&] { recorded_entries<Shape, float>::execute(record); });
  EXPECT_TRUE((recorded_entries<Shape, float>::calls.empty()));
  return text;
}

template <typename Shape>
class HostExecutor : public ::testing::Test {};
using shapes = ::testing::Types<shape::v11, shape::v12, shape::v21, shape::v21c>;
TYPED_TEST_SUITE(HostExecutor, shapes);

TYPED_TEST(HostExecutor, ARecordOfAnotherKindIsRefused) {
  sycl::queue queue = gpu_queue();
  const std::string text = std::string("vm::detail::cpu::norvane::") + TypeParam::name +
                           " function was called with incorrect argument types";
  using other = std::conditional_t<std::is_same_v<TypeParam, shape::v11>, shape::v21, shape::v11>;
  const auto expect_refused = [&]<typename Shape, typename T, typename U>(Shape, T, U) {
    EXPECT_EQ(refusal_of<TypeParam>(record_on<input::usm::linear<Shape, T, U>>(queue)), text);
    EXPECT_EQ(refusal_of<TypeParam>(record_on<input::usm::strided<Shape, T, U>>(queue)), text);
    EXPECT_EQ(refusal_of<TypeParam>(record_on<input::buffer::linear<Shape, T, U>>(queue)), text);
    EXPECT_EQ(refusal_of<TypeParam>(record_on<input::buffer::strided<Shape, T, U>>(queue)), text);
  };
  expect_refused(other{}, 0.0f, 0.0f);
  expect_refused(TypeParam{}, 0.0, 0.0);
  expect_refused(TypeParam{}, std::complex<float>(), 0.0f);
}

TYPED_TEST(HostExecutor, EachFormCallsItsEntry) {
  sycl::queue queue = gpu_queue();
  using entries = recorded_entries<TypeParam, float>;
  float memory[3] = {};
  sycl::buffer<float, 1> buffer{sycl::range<1>(3)};
  for (const bool buffers : {false, true}) {
    for (const bool slices : {false, true}) {
      const auto execute = [&](auto record) {
        for (int k = 0; k < TypeParam::inputs; ++k) {
          record.in_pointers.push_back(memory);
          record.in_buffers.push_back(&buffer);
          if (slices) record.in_slices.push_back({0, 3, 1});
        }
        for (int c = 0; c < TypeParam::constants; ++c) record.constants.push_back(4.0f);
        for (int j = 0; j < TypeParam::outputs; ++j) {
          record.out_pointers.push_back(memory);
          record.out_buffers.push_back(&buffer);
          if (slices) record.out_slices.push_back({0, 3, 1});
        }
        entries::reset();
        return entries::execute(record);
      };
      sycl::event event;
      if (buffers && slices)
        event = execute(record_on<input::buffer::strided<TypeParam, float, float>>(queue));
      else if (buffers)
        event = execute(record_on<input::buffer::linear<TypeParam, float, float>>(queue, 3));
      else if (slices)
        event = execute(record_on<input::usm::strided<TypeParam, float, float>>(queue));
      else
        event = execute(record_on<input::usm::linear<TypeParam, float, float>>(queue, 3));
      EXPECT_EQ(event, queue_store::instance().default_event());
      EXPECT_TRUE(is_complete(event));
      EXPECT_EQ(entries::counts(), slices ? (counts{3, 0}) : counts{3});
      EXPECT_EQ(entries::calls[0].linear, !slices);
      for (const float c : entries::calls[0].args.constants) EXPECT_EQ(c, 4.0f);
    }
  }
}

/// Runs of strided calls with one input, on shared memory.
class HostRuns : public ::testing::Test {
 public:
  using entries = recorded_entries<shape::v11, float>;
  HostRuns() { entries::reset(); }

 protected:
  sycl::queue queue_ = gpu_queue();
  array<float> a_{queue_, memory::shared, 64, 0.0f};
  array<float> y_{queue_, memory::shared, 64, 0.0f};

  counts runs_of(slice in, slice out, std::uint32_t mode) {
    auto record = strided_call<shape::v11, float>(queue_, {{a_, in}}, {{y_, out}});
    record.mode = mode_with(mode);
    entries::reset();
    entries::execute(record);
    return entries::counts();
  }
};

TEST_F(HostRuns, AShortInputIsReadAgainUntilTheOutputIsFull) {
  EXPECT_EQ(runs_of({0, 3, 1}, {0, 7, 1}, enums::slice_cyclic), (counts{3, 3, 1}));
  EXPECT_EQ(runs_of({0, 3, 1}, {0, 6, 1}, enums::slice_cyclic), (counts{3, 3, 0}));
  EXPECT_EQ(runs_of({0, 3, 1}, {0, 3, 1}, enums::slice_cyclic), (counts{3, 0}));
  EXPECT_EQ(runs_of({0, 3, 1}, {0, 2, 1}, enums::slice_cyclic), (counts{2}));
  EXPECT_EQ(runs_of({0, 1, 1}, {0, 2, 1}, enums::slice_cyclic), (counts{1, 1, 0}));
}

TEST_F(HostRuns, OtherPoliciesMakeOneRunAndAnEmptyOne) {
  EXPECT_EQ(runs_of({0, 4, 1}, {0, 4, 1}, enums::slice_normal), (counts{4, 0}));
  EXPECT_EQ(runs_of({0, 3, 1}, {0, 5, 1}, enums::slice_minimum), (counts{3, 0}));
  EXPECT_EQ(runs_of({0, 5, 1}, {0, 3, 1}, enums::slice_minimum), (counts{3}));
  EXPECT_EQ(runs_of({0, 5, 1}, {0, 3, 1}, enums::slice_normal | enums::badarg_quiet), (counts{0}));
  EXPECT_EQ(runs_of({0, 0, 1}, {0, 3, 1}, enums::slice_cyclic | enums::badarg_quiet), (counts{0}));
}

TEST_F(HostRuns, PointersAndIncrementsOfEachRun) {
  runs_of({10, 3, -2}, {5, 7, 3}, enums::slice_cyclic);
  ASSERT_EQ(entries::calls.size(), 3u);
  for (std::size_t i = 0; i < 3; ++i) {
    const auto& [linear, n, args, inc, mode] = entries::calls[i];
    EXPECT_EQ(args.in[0], a_.data() + 10) << "from the input's start";
    EXPECT_EQ(inc.in[0], -2);
    EXPECT_EQ(args.out[0], y_.data() + 5 + 9 * i);
    EXPECT_EQ(inc.out[0], 3);
  }
}

TEST_F(HostRuns, RejectionsAreThoseOfTheDevice) {
  const auto rejection = [&](slice in, slice out, std::uint32_t mode) {
    return message_of<arbor::lumen::invalid_argument>([&] { runs_of(in, out, mode); });
  };
  EXPECT_EQ(rejection({0, 3, 1}, {0, 5, 1}, 0),
            "arbor::lumen::VM::name: invalid argument: different slice sizes in slice_normal mode");
  EXPECT_EQ(rejection({0, 3, 1}, {0, 0, 1}, enums::slice_cyclic),
            "arbor::lumen::VM::name: invalid argument: slice(s) is/are empty");
  EXPECT_TRUE(entries::calls.empty());
}

TEST(HostCyclic, TwoInputsGoThroughAllPairs) {
  sycl::queue queue = cpu_queue();
  values a{1, 2}, b{7, 8, 9}, y(13, 0);
  auto record = strided_call<shape::v21, float>(
      queue, {{a.data(), {0, 2, 1}}, {b.data(), {2, 3, -1}}}, {{y.data(), {0, 13, 1}}});
  record.mode = mode_with(enums::slice_cyclic);
  cpu::loop_launcher<shape::v21, tag_v21<float>>(record, {1});
  EXPECT_EQ(y,
            (values{1009, 1008, 1007, 2009, 2008, 2007, 1009, 1008, 1007, 2009, 2008, 2007, 1009}));
  values from_kernel(13, 0);
  record.out_pointers[0] = from_kernel.data();
  arbor::lumen::vm::detail::gpu::norvane::launcher<shape::v21, tag_v21<float>>(record, {1}).wait();
  EXPECT_EQ(y, from_kernel);
}

TEST(HostCounts, LengthsAndNegativeCounts) {
  sycl::queue queue = cpu_queue();
  using entries = recorded_entries<shape::v11, float>;
  float memory[5] = {};
  entries::reset();
  entries::execute(linear_call<shape::v11, float>(queue, -5, {memory}, {memory}));
  auto spans = linear_call<shape::v11, float>(queue, 0, {memory}, {memory});
  spans.in_lengths = {5};
  spans.out_lengths = {4};
  entries::execute(spans);
  EXPECT_EQ(entries::counts(), (counts{0, 4}));
}

TEST(HostDependencies, AreWaitedForAndThrown) {
  sycl::queue queue(gpu_queue().get_device(),
                    [](sycl::exception_list errors) { std::rethrow_exception(*errors.begin()); });
  using entries = recorded_entries<shape::v11, float>;
  array<float> a(queue, memory::shared, {1, 2});
  auto linear = linear_call<shape::v11, float>(queue, 2, {a}, {a});
  auto strided = strided_call<shape::v11, float>(queue, {{a, {0, 2, 1}}}, {{a, {0, 2, 1}}});
  for (input::vxx* const record :
       {static_cast<input::vxx*>(&linear), static_cast<input::vxx*>(&strided)}) {
    entries::reset();
    {
      gate first(queue), second(queue);
      record->depends = {first.event(), second.event()};
      background call([&] { return entries::execute(*record); });
      first.open();
      EXPECT_TRUE(call.blocks());
      EXPECT_TRUE(entries::calls.empty());
      second.open();
      call.get();
      EXPECT_FALSE(entries::calls.empty());
    }
    entries::reset();
    record->depends = {queue.submit([](sycl::handler& group) {
      group.host_task([] { throw std::domain_error("a failing task"); });
    })};
    EXPECT_THROW(entries::execute(*record), std::domain_error);
    EXPECT_TRUE(entries::calls.empty());
  }
}

TEST(HostMode, StatusHasNoEffect) {
  sycl::queue queue = cpu_queue();
  values a{1, 2}, y{0, 0};
  enums::status status[2] = {enums::accuracy_warning, enums::accuracy_warning};
  auto record = linear_call<shape::v11, float>(queue, 2, {a.data()}, {y.data()});
  record.mode = mode_with(enums::global_status_report);
  record.handler = arbor::lumen::vm::error_handler<float>(status, 2, enums::errdom, -1.0f);
  auto& word = queue_store::instance().status_word(arbor::lumen::vm::detail::queue_key(&queue));
  word = 0;
  cpu::loop_launcher<shape::v11, echo_status<float>>(record, {1});
  EXPECT_EQ(y, (values{1, 2}));
  EXPECT_EQ(status[0], enums::accuracy_warning);
  EXPECT_EQ(word, 0u);
}

}  // namespace
