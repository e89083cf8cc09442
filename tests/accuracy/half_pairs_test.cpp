// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Four million pairs of halves of any size through every half functor of two operands.

#include <gtest/gtest.h>

#include <sstream>
#include <string>
#include <vector>

#include "functor.hpp"
#include "limits.hpp"
#include "measurement.hpp"
#include "reference.hpp"
#include "report.hpp"

namespace arbor::lumen::accuracy {
namespace {

std::vector<functor> functors_of_pairs() {
  std::vector<functor> list;
  for (const functor& f : functors()) {
    if (f.type == 'h' && f.inputs() == 2 && find_reference(f.function) != nullptr)
      list.push_back(f);
  }
  return list;
}

class HalfPairs : public ::testing::TestWithParam<functor> {};

TEST_P(HalfPairs, AreWithinTheLimitOfTheTier) {
  const functor& f = GetParam();
  sampling samples;
  // Numbers of both signs, where the domain has negative ones.
  for (const range& ordinary : find_reference(f.function)->ranges('h'))
    samples.ranges.push_back({ordinary.low < 0 ? -65504.0 : 0.0, 65504});
  samples.count = 4'000'000;
  const subject s = subject_of(f);
  const measurement m = measure({&s, 1}, *find_reference(f.function), samples).front();
  std::ostringstream report;
  write_report(report, s, samples, m);
  EXPECT_EQ(m.count, samples.count);
  EXPECT_LE(m.largest, limit_of(f)) << report.str();
}

INSTANTIATE_TEST_SUITE_P(All, HalfPairs, ::testing::ValuesIn(functors_of_pairs()),
                         [](const auto& tested) { return std::string(tested.param.name); });

}  // namespace
}  // namespace arbor::lumen::accuracy
