// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <algorithm>
#include <cstdio>
#include <string>
#include <vector>

#include "choice.hpp"
#include "commands.hpp"
#include "dispatch/key.hpp"
#include "dispatch/select_key.hpp"
#include "dispatch/texts.hpp"
#include "element_types.hpp"
#include "unserved.hpp"
#include "words.hpp"

namespace arbor::lumen::vm::tool {
namespace {

struct search_step {
  detail::search_pass pass;
  std::uint64_t key;
};

const char* pass_name(detail::search_pass pass) {
  switch (pass) {
    case detail::search_pass::ascending:
      return "ascending";
    case detail::search_pass::descending:
      return "descending";
    default:
      return "host";
  }
}

std::uint64_t precision_of(const chosen_call& call) {
  return with_types(call.in, call.out, []<typename T, typename U>() {
    return std::uint64_t{detail::precision_of_pair<T, U>};
  });
}

/// Every step of the search, as if no row were there.
std::vector<search_step> steps_of(const chosen_call& call) {
  std::vector<search_step> steps;
  detail::search(precision_of(call), call.device_word, call.mode,
                 [&](detail::search_pass pass, std::uint64_t key) {
                   steps.push_back({pass, key});
                   return false;
                 });
  return steps;
}

const char* fallback_words(std::uint32_t mode) {
  if ((mode & enums::mode_relaxed_fallback) != 0)
    return "relaxed: on a GPU any accuracy, then the host";
  if ((mode & enums::mode_host_fallback) != 0) return "the host";
  return "none";
}

void print_call(const chosen_call& call) {
  const auto name = call.device.device.get_info<sycl::info::device::name>();
  std::printf("function  %s (%s), %s", call.family.name, call.family.shape, element_name(call.in));
  if (call.out != call.in) std::printf(" to %s", element_name(call.out));
  std::printf("\ndevice    %zu, %s\n", call.device.number, name.c_str());
  std::printf("          %s %s\n", hex(call.device_word, 16).c_str(),
              device_words(call.device_word).c_str());
  std::printf("mode      %s %s\n", hex(call.mode, 8).c_str(),
              detail::mode_to_text(call.mode).c_str());
  std::printf("fallback  %s\n", fallback_words(call.mode));
}

void print_steps(const std::vector<search_step>& steps, std::size_t found,
                 const detail::implementation_table& table) {
  std::printf("\n%-10s  %-8s  %-13s  %-17s  %s\n", "pass", "accuracy", "key", "feature", "row");
  for (std::size_t i = 0; i < steps.size(); ++i) {
    const auto [pass, key] = steps[i];
    std::string row = "no row";
    if (i == found) row = std::string("found: ") + table.find(key)->implementation;
    if (i > found) row = "not reached";
    std::printf("%-10s  %-8s  %-13s  %-17s  %s\n", pass_name(pass), accuracy_words(key).c_str(),
                hex(key, 1).c_str(), feature_words(key).c_str(), row.c_str());
  }
  if (steps.empty()) std::printf("(no candidates)\n");
}

}  // namespace

int explain(const call_request& request) {
  const chosen_call call = choose(request);
  const detail::implementation_table& table = call.family.table();
  const auto steps = steps_of(call);
  const auto found = static_cast<std::size_t>(
      std::ranges::find_if(steps, [&](const search_step& s) { return table.find(s.key); }) -
      steps.begin());
  print_call(call);
  print_steps(steps, found, table);

  const std::uint64_t key =
      detail::select_key(precision_of(call), call.device_word, call.mode, table);
  if (key != 0) {
    std::string text = detail::key_to_text(key, true);
    text.pop_back();  // the blank behind the last field
    std::printf("\nkey       %s %s\n", hex(key, 1).c_str(), text.c_str());
    std::printf("runs      %s\n", table.find(key)->implementation);
  } else {
    sycl::queue queue(call.device.device);
    std::printf("\nkey       none\n");
    std::printf("ends      %s\n", end_of_unserved(call, queue).c_str());
  }
  return 0;
}

}  // namespace arbor::lumen::vm::tool
