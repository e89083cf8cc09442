// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include "functors.hpp"
#include "memory.hpp"
#include "queues.hpp"
#include "recorded_kernels.hpp"
#include "records.hpp"

namespace {

using namespace arbor::lumen::tests;

constexpr std::int64_t too_many = std::int64_t{1} << 31;
constexpr const char* range_text =
    "Provided range is out of integer limits. Pass `-fno-sycl-id-queries-fit-in-int' to disable "
    "range check.";

/// The launcher of a v11 call refuses the range and leaves the output as it is.
template <typename Record>
void expect_out_of_range(const Record& record) {
  try {
    norvane::launcher<shape::v11, tag_v11<float>>(record, {1});
    ADD_FAILURE() << "no exception";
  } catch (const sycl::exception& thrown) {
    EXPECT_STREQ(thrown.what(), range_text);
    EXPECT_EQ(thrown.code().value(), 4);
    EXPECT_EQ(thrown.code(), sycl::errc::nd_range);
    EXPECT_EQ(&thrown.category(), &sycl::sycl_category());
  }
}

class RangeLimit : public ::testing::TestWithParam<memory> {
 protected:
  sycl::queue queue_ = gpu_queue();
  array<float> a_{queue_, GetParam(), 8, 1.0f};
  array<float> y_{queue_, GetParam(), 8, 50.0f};

  void TearDown() override {
    queue_.wait_and_throw();
    EXPECT_EQ(y_.read(), std::vector<float>(8, 50.0f));
  }
};

INSTANTIATE_TEST_SUITE_P(Memories, RangeLimit, ::testing::Values(memory::device, memory::shared),
                         [](const auto& tested) { return name_of(tested.param); });

TEST_P(RangeLimit, WholeArrays) {
  for (const std::int64_t n : {too_many, too_many + 5, INT64_MAX}) {
    auto record = linear_call<shape::v11, float>(queue_, n, {a_}, {y_});
    expect_out_of_range(record);
    record.handler.enabled = true;
    expect_out_of_range(record);
    record.handler.enabled = false;
    record.mode = mode_with(enums::global_status_report);
    expect_out_of_range(record);
  }
}

TEST_P(RangeLimit, Slices) {
  for (const std::int64_t stride : {0, 1, -1}) {
    const slice s{stride < 0 ? too_many : 0, too_many, stride};
    expect_out_of_range(strided_call<shape::v11, float>(queue_, {{a_, s}}, {{y_, s}}));
  }
  auto cyclic =
      strided_call<shape::v11, float>(queue_, {{a_, {0, 3, 1}}}, {{y_, {0, too_many, 0}}});
  cyclic.mode = mode_with(enums::slice_cyclic);
  expect_out_of_range(cyclic);
}

TEST_P(RangeLimit, ANegativeSizeThatIsNotEmpty) {
  // Its last index, (-3 - 1) * -1 + 0, is not negative.
  const slice s{0, -3, -1};
  expect_out_of_range(strided_call<shape::v11, float>(queue_, {{a_, s}}, {{y_, s}}));
}

TEST(RangeLimitOfBuffers, LinearAndSliced) {
  sycl::queue queue = gpu_queue();
  sycl::buffer<float, 1> a{sycl::range<1>(8)};
  std::vector<float> results(8, 50.0f);
  sycl::buffer<float, 1> y{results};
  expect_out_of_range(buffer_call<shape::v11, float>(queue, too_many, {&a}, {&y}));
  const slice s{0, too_many, 0};
  auto sliced = buffer_strided_call<shape::v11, float>(queue, {{&a, s}}, {{&y, s}});
  expect_out_of_range(sliced);
  sliced.mode = mode_with(enums::global_status_report);
  expect_out_of_range(sliced);
  EXPECT_EQ(contents_of(y), std::vector<float>(8, 50.0f));
}

TEST(RangeLimitOfHostMemory, TheRefusalComesAfterStaging) {
  sycl::queue queue = gpu_queue();
  std::vector<float> a(8, 1.0f), y(8, 50.0f);
  const slice s{0, too_many, 0};
  // Extents of one element are staged; then the range is refused, and the copies go.
  expect_out_of_range(strided_call<shape::v11, float>(queue, {{a.data(), s}}, {{y.data(), s}}));
  EXPECT_EQ(y, std::vector<float>(8, 50.0f));
}

TEST(RangeLimitOfHostMemory, TheLargestRangeIsAccepted) {
  EXPECT_NO_THROW(norvane::require_31_bits(too_many - 1));
  EXPECT_NO_THROW(norvane::require_31_bits(0));
  EXPECT_THROW(norvane::require_31_bits(too_many), sycl::exception);
  EXPECT_THROW(norvane::require_31_bits(-1), sycl::exception);
}

}  // namespace
