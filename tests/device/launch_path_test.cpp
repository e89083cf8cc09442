// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include <complex>

#include "functors.hpp"
#include "queues.hpp"
#include "recorded_kernels.hpp"
#include "records.hpp"

namespace {

using namespace arbor::lumen::tests;
using arbor::lumen::vm::detail::TuningInfo;

/// Calls of one shape whose operands are shared memory or buffers of four elements.
template <typename Shape>
class LaunchPath : public ::testing::Test {
 public:
  using recorded = recorded_kernels<Shape, float>;

  LaunchPath() { recorded::reset(); }
  ~LaunchPath() override { sycl::free(memory_, queue_); }

  template <typename Record>
  Record filled(Record record) {
    const bool buffers = !std::is_same_v<Record, input::usm::linear<Shape, float, float>> &&
                         !std::is_same_v<Record, input::usm::strided<Shape, float, float>>;
    const bool slices = std::is_same_v<Record, input::usm::strided<Shape, float, float>> ||
                        std::is_same_v<Record, input::buffer::strided<Shape, float, float>>;
    for (int k = 0; k < Shape::inputs; ++k) {
      if (buffers)
        record.in_buffers.push_back(&buffer_);
      else
        record.in_pointers.push_back(memory_);
      if (slices) record.in_slices.push_back({0, 4, 1});
    }
    for (int c = 0; c < Shape::constants; ++c) record.constants.push_back(17.0f);
    for (int j = 0; j < Shape::outputs; ++j) {
      if (buffers)
        record.out_buffers.push_back(&buffer_);
      else
        record.out_pointers.push_back(memory_);
      if (slices) record.out_slices.push_back({0, 4, 1});
    }
    if (!slices) record.n = 4;
    return record;
  }
  template <typename Record>
  Record made() {
    return filled(record_on<Record>(queue_));
  }

 protected:
  sycl::queue queue_ = gpu_queue();
  float* memory_ = sycl::malloc_shared<float>(4, queue_);
  sycl::buffer<float, 1> buffer_{sycl::range<1>(4)};
};

using shapes = ::testing::Types<shape::v11, shape::v12, shape::v21, shape::v21c>;
TYPED_TEST_SUITE(LaunchPath, shapes);

TYPED_TEST(LaunchPath, WholeArraysWithoutStatusAreFast) {
  using kernels = recorded_kernels<TypeParam, float>;
  auto record = this->template made<input::usm::linear<TypeParam, float, float>>();
  kernels::launch(record);
  EXPECT_EQ(kernels::path, "fast");
  EXPECT_EQ(kernels::count, 4);
  for (const float* a : kernels::args.in) EXPECT_EQ(a, this->memory_);
  for (const float* y : kernels::args.out) EXPECT_EQ(y, this->memory_);
  for (const float c : kernels::args.constants) EXPECT_EQ(c, 17.0f);
}

TYPED_TEST(LaunchPath, AnEnabledHandlerTakesTheStridedKernelWithUnitStrides) {
  using kernels = recorded_kernels<TypeParam, float>;
  auto record = this->template made<input::usm::linear<TypeParam, float, float>>();
  record.handler.enabled = true;
  kernels::launch(record);
  EXPECT_EQ(kernels::path, "strided");
  EXPECT_EQ(kernels::context.cell, nullptr);
  EXPECT_EQ(kernels::storage, nullptr);
  const auto& stride = kernels::context.stride;
  EXPECT_EQ(stride.count, 4);
  for (int k = 0; k < TypeParam::inputs; ++k) {
    EXPECT_EQ(stride.divisor[k], 1);
    EXPECT_EQ(stride.in_size[k], 4);
    EXPECT_EQ(stride.in_start[k], 0);
    EXPECT_EQ(stride.in_stride[k], 1);
  }
  for (int j = 0; j < TypeParam::outputs; ++j) {
    EXPECT_EQ(stride.out_start[j], 0);
    EXPECT_EQ(stride.out_stride[j], 1);
  }
}

TYPED_TEST(LaunchPath, AGlobalReportTakesTheStridedKernel) {
  using kernels = recorded_kernels<TypeParam, float>;
  auto record = this->template made<input::usm::linear<TypeParam, float, float>>();
  record.mode = mode_with(enums::global_status_report);
  kernels::launch(record);
  EXPECT_EQ(kernels::path, "strided");
  EXPECT_NE(kernels::context.cell, nullptr);
}

TYPED_TEST(LaunchPath, SlicesTakeTheStridedKernel) {
  using kernels = recorded_kernels<TypeParam, float>;
  auto record = this->template made<input::usm::strided<TypeParam, float, float>>();
  kernels::launch(record);
  EXPECT_EQ(kernels::path, "strided");
  EXPECT_EQ(kernels::count, 4);
}

TYPED_TEST(LaunchPath, BuffersTakeTheirKernelWhateverTheStatus) {
  using kernels = recorded_kernels<TypeParam, float>;
  for (const bool enabled : {false, true}) {
    for (const std::uint32_t mode : {0u, static_cast<unsigned>(enums::global_status_report)}) {
      auto linear = this->template made<input::buffer::linear<TypeParam, float, float>>();
      linear.handler.enabled = enabled;
      linear.mode = mode_with(mode);
      kernels::reset();
      kernels::launch(linear);
      EXPECT_EQ(kernels::path, "buffer");
      EXPECT_EQ(kernels::count, 4);
      EXPECT_EQ(kernels::context.cell != nullptr, mode != 0);
      for (const float c : kernels::args.constants) EXPECT_EQ(c, 17.0f);

      auto strided = this->template made<input::buffer::strided<TypeParam, float, float>>();
      strided.handler.enabled = enabled;
      strided.mode = mode_with(mode);
      kernels::reset();
      kernels::launch(strided);
      EXPECT_EQ(kernels::path, "buffer");
      EXPECT_EQ(kernels::count, 4);
    }
  }
}

/// Gives `record` to the launcher of a shape; returns the text of what it throws.
template <typename Shape, typename Record>
std::string refusal_of(const Record& record) {
  return message_of<std::runtime_error>(
      [&] { norvane::launcher<Shape, tag<Shape, float>>(record, {1}); });
}

/// All forms of another shape or of other element types.
template <typename Shape, typename OtherShape, typename T, typename U>
void expect_refused(sycl::queue& queue) {
  const std::string text = std::string("vm::detail::gpu::norvane::") + Shape::name +
                           " function was called with incorrect argument types";
  EXPECT_EQ(refusal_of<Shape>(record_on<input::usm::linear<OtherShape, T, U>>(queue)), text);
  EXPECT_EQ(refusal_of<Shape>(record_on<input::usm::strided<OtherShape, T, U>>(queue)), text);
  EXPECT_EQ(refusal_of<Shape>(record_on<input::buffer::linear<OtherShape, T, U>>(queue)), text);
  EXPECT_EQ(refusal_of<Shape>(record_on<input::buffer::strided<OtherShape, T, U>>(queue)), text);
}

TYPED_TEST(LaunchPath, ARecordOfAnotherKindIsRefused) {
  using other = std::conditional_t<std::is_same_v<TypeParam, shape::v11>, shape::v21, shape::v11>;
  expect_refused<TypeParam, other, float, float>(this->queue_);
  expect_refused<TypeParam, TypeParam, double, double>(this->queue_);
  expect_refused<TypeParam, TypeParam, sycl::half, sycl::half>(this->queue_);
  expect_refused<TypeParam, TypeParam, std::complex<float>, float>(this->queue_);
  expect_refused<TypeParam, TypeParam, float, std::complex<float>>(this->queue_);
}

TYPED_TEST(LaunchPath, ARefusedRecordComesBeforeAnyWork) {
  using other = std::conditional_t<std::is_same_v<TypeParam, shape::v11>, shape::v21, shape::v11>;
  using kernels = recorded_kernels<TypeParam, float>;
  auto record = record_on<input::usm::linear<other, float, float>>(this->queue_, 4);
  EXPECT_THROW(kernels::launch(record), std::runtime_error);
  record.mode = mode_with(enums::global_status_report);
  record.handler.enabled = true;
  EXPECT_THROW(kernels::launch(record), std::runtime_error);
  EXPECT_EQ(kernels::path, "none");
}

TEST(LaunchPathOfAnyShape, MissingOperandsAreNamed) {
  sycl::queue queue = gpu_queue();
  const auto text_of = [](const auto& record) {
    return message_of<std::logic_error>(
        [&] { norvane::launcher<shape::v21c, tag_v21c<float>>(record, {1}); });
  };
  const std::string prefix = "ArborLumen::vm::detail::input::name: ";
  float values[4] = {};
  sycl::buffer<float, 1> buffer{sycl::range<1>(4)};
  EXPECT_EQ(text_of(linear_call<shape::v21c, float>(queue, 4, {}, {values}, {1.0f})),
            prefix + "usm: index of input is too large");
  EXPECT_EQ(text_of(linear_call<shape::v21c, float>(queue, 4, {values}, {}, {1.0f})),
            prefix + "usm: index of input is too large");
  EXPECT_EQ(text_of(linear_call<shape::v21c, float>(queue, 4, {values}, {values}, {})),
            prefix + "index of constant is too large");
  EXPECT_EQ(text_of(buffer_call<shape::v21c, float>(queue, 4, {}, {&buffer}, {1.0f})),
            prefix + "buffer: index of input is too large");
  EXPECT_EQ(text_of(buffer_call<shape::v21c, float>(queue, 4, {&buffer}, {}, {1.0f})),
            prefix + "buffer: index of output is too large");
}

TEST(LaunchPathOfAnyShape, DependenciesReachTheKernel) {
  sycl::queue queue = gpu_queue();
  using kernels = recorded_kernels<shape::v11, float>;
  kernels::reset();
  auto record = linear_call<shape::v11, float>(queue, 0, {nullptr}, {nullptr});
  record.depends.resize(3);
  kernels::launch(record);
  EXPECT_EQ(kernels::depends, 3u);
  record.handler.enabled = true;
  kernels::launch(record);
  EXPECT_EQ(kernels::path, "strided");
  EXPECT_EQ(kernels::depends, 3u);
}

}  // namespace
