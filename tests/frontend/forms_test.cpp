// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "frontend/forms.hpp"

#include <gtest/gtest.h>

#include <map>
#include <set>
#include <string>
#include <tuple>
#include <vector>

#include "dispatch/simulated_devices.hpp"

namespace {

using namespace arbor::lumen::tests;
namespace enums = arbor::lumen::vm::enums;

const std::vector<functor_case>& all_cases() {
  static const std::vector<functor_case> cases = [] {
    std::vector<functor_case> all;
    for (const auto& part : {half_cases(), float_cases(), double_cases(), complex_float_cases(),
                             complex_double_cases()})
      all.insert(all.end(), part.begin(), part.end());
    return all;
  }();
  return cases;
}

std::vector<std::string> functions_with_functors() {
  std::set<std::string> names;
  for (const functor_case& c : all_cases()) names.emplace(c.function);
  return {names.begin(), names.end()};
}

using preference = std::vector<std::pair<std::string, bool>>;  // labels, whether cast to float

enum class served_by { host, kernels };

/// Which functors serve a type, the preferred ones first. Host rows run the body of a functor too.
/// On a CPU half is served by kernels that compute in float; elsewhere the host does not serve it.
preference preferred(served_by by, bool half, bool cpu) {
  if (by == served_by::kernels) {
    return {{"nolut", false}, {"gen", false}, {"fp64only", false},
            {"nolut", true},  {"gen", true},  {"fp64only", true}};
  }
  if (half && cpu) return {{"nolut", true}, {"gen", true}, {"fp64only", true}};
  if (half) return {};
  return {{"gen", false}, {"fp64only", false}, {"nolut", false}};
}

const functor_case* serving(const std::vector<functor_case>& cases, const preference& order) {
  for (const auto& [label, cast] : order) {
    for (const functor_case& c : cases)
      if (c.label == label && c.cast() == cast) return &c;
  }
  return nullptr;
}

class Forms : public testing::TestWithParam<std::string> {
 protected:
  void compare_on(const std::string& device, served_by by) {
    std::map<std::pair<std::string_view, std::string_view>, std::vector<functor_case>> by_tier;
    for (const functor_case& c : all_cases())
      if (c.function == GetParam()) by_tier[{c.type, c.tier}].push_back(c);
    sycl::queue queue(device_named(device));
    arbor::lumen::vm::clear_status(queue);
    for (const auto& [type_and_tier, cases] : by_tier) {
      const auto& [type, tier] = type_and_tier;
      const functor_case* functor = serving(cases, preferred(by, type == "h", device == "cpu"));
      if (functor == nullptr) continue;
      SCOPED_TRACE(std::string(functor->functor) + " on " + device);
      functor->check(queue, tier == "ha" ? enums::ha : tier == "la" ? enums::la : enums::ep);
      ++compared_;
    }
    EXPECT_EQ(0u, arbor::lumen::vm::get_status(queue));
  }
  int compared_ = 0;
};

TEST_P(Forms, GiveTheBitsOfTheFunctor) {
  compare_on("cpu", served_by::host);
  compare_on("foreign_nofp64", served_by::host);
  compare_on("without_identifier", served_by::kernels);
  compare_on("garnet", served_by::kernels);
  EXPECT_GT(compared_, 0);
}

INSTANTIATE_TEST_SUITE_P(Functions, Forms, testing::ValuesIn(functions_with_functors()),
                         [](const auto& param_info) { return param_info.param; });

}  // namespace
