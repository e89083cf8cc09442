// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include "device/functors.hpp"
#include "device/gate.hpp"
#include "device/queues.hpp"
#include "device/records.hpp"
#include "host/loop.hpp"
#include "recorded_entries.hpp"

namespace {

using namespace arbor::lumen::tests;
using buffer = sycl::buffer<float, 1>;
using values = std::vector<float>;

buffer filled(const values& contents) { return buffer(contents.begin(), contents.end()); }

template <typename Functor, typename Shape, typename Record>
void run(const Record& record) {
  cpu::loop_launcher<Shape, Functor>(record, {1});
}

class HostBuffers : public ::testing::TestWithParam<const char*> {
 protected:
  sycl::queue queue_ = std::string(GetParam()) == "cpu" ? cpu_queue() : gpu_queue();
};
INSTANTIATE_TEST_SUITE_P(Queues, HostBuffers, ::testing::Values("cpu", "gpu"),
                         [](const auto& tested) { return std::string(tested.param); });

TEST_P(HostBuffers, EveryShape) {
  buffer a = filled({0, 1, 2}), b = filled({7, 8, 9}), y = filled({50, 51, 52}),
         z = filled({60, 61, 62});
  run<tag_v11<float>, shape::v11>(buffer_call<shape::v11, float>(queue_, 2, {&a}, {&y}));
  EXPECT_EQ(contents_of(y), (values{1, 3, 52}));
  run<tag_v12<float>, shape::v12>(buffer_call<shape::v12, float>(queue_, 3, {&a}, {&y, &z}));
  EXPECT_EQ(contents_of(y), (values{0, 3, 6}));
  EXPECT_EQ(contents_of(z), (values{0, -1, -2}));
  run<tag_v21<float>, shape::v21>(buffer_call<shape::v21, float>(queue_, 3, {&a, &b}, {&y}));
  EXPECT_EQ(contents_of(y), (values{7, 1008, 2009}));
  run<tag_v21c<float>, shape::v21c>(buffer_call<shape::v21c, float>(queue_, 3, {&a}, {&y}, {5.0f}));
  EXPECT_EQ(contents_of(y), (values{5, 1005, 2005}));
}

TEST_P(HostBuffers, OneBufferForInputAndOutput) {
  buffer a = filled({1, 2, 3}), b = filled({4, 5, 7});
  run<tag_v11<float>, shape::v11>(buffer_call<shape::v11, float>(queue_, 3, {&a}, {&a}));
  EXPECT_EQ(contents_of(a), (values{3, 5, 7}));
  run<tag_v21<float>, shape::v21>(buffer_call<shape::v21, float>(queue_, 3, {&a, &b}, {&b}));
  EXPECT_EQ(contents_of(b), (values{3004, 5005, 7007}));
  run<tag_v21<float>, shape::v21>(buffer_call<shape::v21, float>(queue_, 1, {&a, &a}, {&a}));
  EXPECT_EQ(contents_of(a), (values{3003, 5, 7}));
  run<tag_v11<float>, shape::v11>(
      buffer_strided_call<shape::v11, float>(queue_, {{&a, {1, 2, 1}}}, {{&a, {1, 2, 1}}}));
  EXPECT_EQ(contents_of(a), (values{3003, 11, 15}));
}

TEST_P(HostBuffers, OneBufferForInputAndOutputHasOnePointer) {
  using entries = recorded_entries<shape::v21, float>;
  entries::reset();
  buffer a = filled({1, 2}), b = filled({3, 4});
  buffer alias = b;
  entries::execute(buffer_call<shape::v21, float>(queue_, 2, {&a, &b}, {&alias}));
  EXPECT_EQ(entries::calls[0].args.in[1], entries::calls[0].args.out[0]);
  EXPECT_NE(entries::calls[0].args.in[0], entries::calls[0].args.out[0]);
}

TEST_P(HostBuffers, OneBufferForBothOutputs) {
  buffer a = filled({1, 2}), y = filled({0, 0, 0, 0});
  run<tag_v12<float>, shape::v12>(buffer_strided_call<shape::v12, float>(
      queue_, {{&a, {0, 2, 1}}}, {{&y, {0, 2, 1}}, {&y, {2, 2, 1}}}));
  EXPECT_EQ(contents_of(y), (values{3, 6, -1, -2}));
}

TEST_P(HostBuffers, OneBufferForBothInputs) {
  buffer a = filled({1, 2, 3}), y = filled({0, 0, 0});
  run<tag_v21<float>, shape::v21>(buffer_call<shape::v21, float>(queue_, 3, {&a, &a}, {&y}));
  EXPECT_EQ(contents_of(y), (values{1001, 2002, 3003}));
}

TEST_P(HostBuffers, PendingWorkIsWaitedFor) {
  buffer a = filled({1, 2, 4}), y = filled({0, 0, 0});
  gate before(queue_);
  queue_.submit([&](sycl::handler& group) {
    group.depends_on(before.event());
    const sycl::accessor access(a, group, sycl::read_write);
    group.parallel_for(sycl::range<1>(3), [access](sycl::id<1> i) { access[i] += 10; });
  });
  background call([&] {
    return cpu::loop_launcher<shape::v11, tag_v11<float>>(
        buffer_call<shape::v11, float>(queue_, 3, {&a}, {&y}), {1});
  });
  EXPECT_TRUE(call.blocks());
  before.open();
  call.get();
  // The host's access has ended; commands may follow.
  queue_.submit([&](sycl::handler& group) {
    const sycl::accessor access(y, group, sycl::read_write);
    group.parallel_for(sycl::range<1>(3), [access](sycl::id<1> i) { access[i] += 100; });
  });
  EXPECT_EQ(contents_of(y), (values{123, 125, 129}));
}

TEST_P(HostBuffers, SlicesAndCycles) {
  buffer a = filled({1, 2, 3, 4, 5}), y = filled(values(7, 0));
  auto record =
      buffer_strided_call<shape::v11, float>(queue_, {{&a, {4, 3, -2}}}, {{&y, {0, 7, 1}}});
  record.mode = mode_with(enums::slice_cyclic);
  run<tag_v11<float>, shape::v11>(record);
  EXPECT_EQ(contents_of(y), (values{11, 7, 3, 11, 7, 3, 11}));
}

TEST_P(HostBuffers, AMissingBufferIsNamed) {
  buffer a = filled({1, 2});
  const std::string prefix = "ArborLumen::vm::detail::input::name: ";
  EXPECT_EQ(message_of<std::logic_error>([&] {
              run<tag_v11<float>, shape::v11>(buffer_call<shape::v11, float>(queue_, 2, {&a}, {}));
            }),
            prefix + "buffer: index of output is too large");
  EXPECT_EQ(message_of<std::logic_error>([&] {
              run<tag_v11<float>, shape::v11>(buffer_call<shape::v11, float>(queue_, 2, {}, {&a}));
            }),
            prefix + "buffer: index of input is too large");
}

}  // namespace
