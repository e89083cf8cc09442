// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Every float through every float functor of one operand.

#include <gtest/gtest.h>

#include <iostream>
#include <sstream>
#include <string>
#include <vector>

#include "float_walk.hpp"
#include "functor.hpp"
#include "limits.hpp"
#include "reference.hpp"

namespace arbor::lumen::accuracy {
namespace {

std::vector<std::string> functions() {
  std::vector<std::string> list;
  for (const functor& f : functors()) {
    const reference* r = find_reference(f.function);
    if (f.type == 's' && f.shape == "v11" && r != nullptr && r->c_double != nullptr &&
        (list.empty() || list.back() != f.function))
      list.emplace_back(f.function);
  }
  return list;
}

class EveryFloat : public ::testing::TestWithParam<std::string> {};

TEST_P(EveryFloat, IsWithinTheLimitOfTheTier) {
  std::vector<functor> tested;
  std::vector<subject> subjects;
  for (const functor& f : functors()) {
    if (f.function != GetParam() || f.type != 's') continue;
    tested.push_back(f);
    subjects.push_back(loop_subject_of(f));
  }
  const auto measured = measure_every_float(subjects, *find_reference(GetParam()));
  for (std::size_t k = 0; k < tested.size(); ++k) {
    std::ostringstream text;
    text << tested[k].name << ": " << measured[k].largest << " ulp at 0x" << std::hex
         << measured[k].worst_argument[0];
    std::cout << text.str() << std::endl;
    EXPECT_EQ(measured[k].count, std::uint64_t{1} << 32);
    EXPECT_LE(measured[k].largest, limit_of(tested[k])) << text.str();
  }
}

INSTANTIATE_TEST_SUITE_P(All, EveryFloat, ::testing::ValuesIn(functions()),
                         [](const auto& tested) { return tested.param; });

}  // namespace
}  // namespace arbor::lumen::accuracy
