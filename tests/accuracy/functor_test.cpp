// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Every functor with a reference stays within the limit of its tier: halves at every argument,
/// floats and doubles at samples of the numbers and of the values of its ranges.

#include <gtest/gtest.h>

#include <sstream>
#include <vector>

#include "functor.hpp"
#include "limits.hpp"
#include "measurement.hpp"
#include "reference.hpp"
#include "report.hpp"

namespace arbor::lumen::accuracy {

namespace {

std::vector<functor> measurable() {
  std::vector<functor> list;
  for (const functor& f : functors()) {
    if (f.is_real() && find_reference(f.function) != nullptr) list.push_back(f);
  }
  return list;
}

std::string name_of(const ::testing::TestParamInfo<functor>& info) {
  return std::string(info.param.name);
}

class FunctorAccuracy : public ::testing::TestWithParam<functor> {
 protected:
  void expect_within_limit(const sampling& samples) {
    const functor& f = GetParam();
    const subject s = subject_of(f);
    const measurement m = measure({&s, 1}, *find_reference(f.function), samples).front();
    std::ostringstream report;
    write_report(report, s, samples, m);
    EXPECT_GT(m.count, 0u);
    EXPECT_LE(m.largest, limit_of(f)) << report.str();
    RecordProperty("largest_ulp", std::to_string(m.largest));
  }
};

TEST_P(FunctorAccuracy, WithinTheLimitOfItsTier) {
  const functor& f = GetParam();
  sampling samples;
  samples.ranges = find_reference(f.function)->ranges(f.type);
  if (f.type == 'h' && f.inputs() == 1) {
    samples.ranges = {{-65504, 65504}};
    samples.step = 1;
    expect_within_limit(samples);
    return;
  }
  samples.count = 10'000;
  expect_within_limit(samples);
  samples.uniform = true;
  samples.seed += 1;
  expect_within_limit(samples);
}

INSTANTIATE_TEST_SUITE_P(All, FunctorAccuracy, ::testing::ValuesIn(measurable()), name_of);

}  // namespace
}  // namespace arbor::lumen::accuracy
