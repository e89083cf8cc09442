// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include <algorithm>
#include <deque>
#include <random>
#include <set>
#include <vector>

#include "arbor/lumen/vm/enums.hpp"
#include "dispatch/family.hpp"
#include "dispatch/select_key.hpp"

namespace {

namespace enums = arbor::lumen::vm::enums;
using arbor::lumen::vm::detail::families;
using arbor::lumen::vm::detail::family;
using arbor::lumen::vm::detail::implementation_table;
using arbor::lumen::vm::detail::search;
using arbor::lumen::vm::detail::search_pass;
using arbor::lumen::vm::detail::select_key;
using arbor::lumen::vm::detail::TuningInfo;
using arbor::lumen::vm::detail::input::vxx;

using key_list = std::vector<std::uint64_t>;

constexpr std::uint64_t half = 0x100000000;
constexpr std::uint64_t single = 0x400000000;
constexpr std::uint64_t double_ = 0x800000000;
constexpr std::uint64_t complex_double = 0x1800000000;
constexpr std::uint64_t precisions[] = {half, single, double_, 0x1000000000, complex_double};

constexpr std::uint64_t cpu = 0x1000000000000;
constexpr std::uint64_t accelerator = 0x4000000000000;
constexpr std::uint64_t gpu = 0x2000900000020;  // discrete, beryl, fp64
constexpr std::uint64_t integrated_gpu = 0x2000A00000002;
constexpr std::uint64_t gpu_without_double = 0x2000500000020;
constexpr std::uint64_t ours = 0x8000000000000000;
constexpr std::uint64_t device_words[] = {0,
                                          cpu,
                                          cpu | ours,
                                          accelerator,
                                          gpu,
                                          gpu | ours,
                                          integrated_gpu,
                                          gpu_without_double,
                                          gpu_without_double | ours};

constexpr std::uint32_t host_fallback = 0x100000;
constexpr std::uint32_t relaxed_fallback = 0x800000;
constexpr std::uint32_t without_fallback = 0x1011204;
constexpr std::uint32_t with_host_fallback = 0x1111204;

/// Words with every fallback group, every slice policy and accuracies known and unknown.
std::vector<std::uint32_t> modes() {
  std::vector<std::uint32_t> words;
  for (const std::uint32_t accuracy : {0u, 1u, 4u, 12u, 15u}) {
    for (const std::uint32_t slices : {0u, 0x1000u, 0x2000u, 0x4000u}) {
      for (std::uint32_t fallback = 0; fallback < 16; ++fallback)
        words.push_back(0x10200 | accuracy | slices | fallback << 20);
    }
  }
  return words;
}

/// The partial keys of a device in search order, written out.
std::deque<std::uint64_t> model_candidates(std::uint64_t precision, std::uint64_t word,
                                           std::uint32_t mode) {
  const bool cyclic = (mode & 0x7000) == 0x4000;
  if ((word & 0x2000000000000) != 0) {
    if ((word & 0x400000000) != 0) return {};
    if (precision == half)
      return {half | 0x420, half | 0x120, half | 0x820, 0x100001420, 0x100001120, 0x100001820};
    return {precision | 0x420, precision | 0x120, precision | 0x820};
  }
  if ((word & cpu) != 0) {
    if (precision == half && cyclic)
      return {half | 0x120, half | 0x820, 0x100001420, 0x100001120, 0x100001820};
    if (precision == half) return {0x100001420, 0x100001120, 0x100001820};
    if (cyclic) return {precision | 0x120, precision | 0x820};
  }
  return {};
}

key_list at_accuracies(const std::deque<std::uint64_t>& candidates,
                       const std::vector<std::uint64_t>& codes) {
  key_list keys;
  for (const std::uint64_t code : codes) {
    for (const std::uint64_t candidate : candidates) keys.push_back(candidate | code);
  }
  return keys;
}

/// All keys of a search in order, made without any of the library's code.
key_list model_search(std::uint64_t precision, std::uint64_t word, std::uint32_t mode) {
  const std::vector<std::uint64_t> asked = (mode & 0xF) == 15   ? key_list{1, 2, 4}
                                           : (mode & 0xF) == 12 ? key_list{2, 4}
                                                                : key_list{4};
  auto candidates = model_candidates(precision, word, mode);
  key_list keys = at_accuracies(candidates, asked);
  if ((mode & relaxed_fallback) != 0 && (word & 0x2000000000000) != 0) {
    for (const std::uint64_t key : at_accuracies(candidates, {4, 2, 1})) keys.push_back(key);
  }
  if ((mode & (relaxed_fallback | host_fallback)) != 0) {
    candidates.push_front(precision | 0x8010);
    for (const std::uint64_t key : at_accuracies(candidates, asked)) keys.push_back(key);
  }
  return keys;
}

key_list visited(std::uint64_t precision, std::uint64_t word, std::uint32_t mode) {
  key_list keys;
  search(precision, word, mode, [&](search_pass, std::uint64_t key) {
    keys.push_back(key);
    return false;
  });
  return keys;
}

template <typename Holds>
std::uint64_t first(const key_list& keys, Holds holds) {
  const auto found = std::ranges::find_if(keys, holds);
  return found == keys.end() ? 0 : *found;
}

template <typename Check>
void for_every_call(Check check) {
  const auto words = modes();
  for (const std::uint64_t precision : precisions) {
    for (const std::uint64_t device : device_words) {
      for (const std::uint32_t mode : words) check(precision, device, mode);
    }
  }
}

TEST(Search, VisitsKeysInTheStatedOrder) {
  for_every_call([](std::uint64_t precision, std::uint64_t device, std::uint32_t mode) {
    ASSERT_EQ(visited(precision, device, mode), model_search(precision, device, mode))
        << std::hex << precision << ' ' << device << ' ' << mode;
  });
}

TEST(Search, StopsAtTheFirstAcceptedKey) {
  std::mt19937 random(20240229);
  for_every_call([&](std::uint64_t precision, std::uint64_t device, std::uint32_t mode) {
    const auto keys = model_search(precision, device, mode);
    std::set<std::uint64_t> held;
    for (const std::uint64_t key : keys) {
      if (random() % 8 == 0) held.insert(key);
    }
    const auto holds = [&](std::uint64_t key) { return held.contains(key); };
    int after_the_first = 0;
    bool accepted = false;
    const std::uint64_t found =
        search(precision, device, mode, [&](search_pass, std::uint64_t key) {
          after_the_first += accepted ? 1 : 0;
          accepted = holds(key);
          return accepted;
        });
    ASSERT_EQ(found, first(keys, holds)) << std::hex << precision << ' ' << device << ' ' << mode;
    ASSERT_EQ(after_the_first, 0);
  });
}

TEST(Search, NamesItsPasses) {
  std::vector<search_pass> passes;
  search(double_, gpu, enums::default_mode, [&](search_pass pass, std::uint64_t) {
    passes.push_back(pass);
    return false;
  });
  std::vector<search_pass> expected(3, search_pass::ascending);
  expected.insert(expected.end(), 9, search_pass::descending);
  expected.insert(expected.end(), 4, search_pass::host);
  EXPECT_EQ(passes, expected);
}

TEST(SelectKey, IsTheFirstVisitedKeyOfEveryFamily) {
  for (const family& candidate : families()) {
    const implementation_table& table = candidate.table();
    const auto holds = [&](std::uint64_t key) { return table.find(key) != nullptr; };
    for_every_call([&](std::uint64_t precision, std::uint64_t device, std::uint32_t mode) {
      ASSERT_EQ(select_key(precision, device, mode, table),
                first(visited(precision, device, mode), holds))
          << candidate.name << std::hex << ' ' << precision << ' ' << device << ' ' << mode;
    });
  }
}

sycl::event run(const vxx&, TuningInfo) { return {}; }

TEST(SelectKey, PrefersCastWithGenWhereThereIsNoPlainHalf) {
  const implementation_table table{{0x100001124, run, ""}, {0x400000124, run, ""}};
  EXPECT_EQ(select_key(half, gpu, enums::default_mode, table), 0x100001124);
  EXPECT_EQ(select_key(half, cpu, without_fallback, table), 0x100001124);
  EXPECT_EQ(select_key(half, accelerator, enums::default_mode, table), 0);
}

TEST(SelectKey, PrefersPlainHalfToCasts) {
  const implementation_table table{
      {0x100000124, run, ""}, {0x100001424, run, ""}, {0x100001124, run, ""}};
  EXPECT_EQ(select_key(half, gpu, enums::default_mode, table), 0x100000124);
}

TEST(SelectKey, PrefersNolutToGenToFp64only) {
  const implementation_table table{{0x800000124, run, ""}, {0x800000424, run, ""},
                                   {0x800000824, run, ""}, {0x400000822, run, ""},
                                   {0x400000122, run, ""}, {0x400000824, run, ""}};
  EXPECT_EQ(select_key(double_, gpu, enums::default_mode, table), 0x800000424);
  EXPECT_EQ(select_key(single, gpu, enums::default_mode, table), 0x400000824);
  EXPECT_EQ(select_key(single, gpu, 0x181120C, table), 0x400000122);
}

TEST(SelectKey, PutsAccuracyBeforeVariant) {
  const implementation_table table{{0x1800000422, run, ""}, {0x1800000824, run, ""}};
  EXPECT_EQ(select_key(complex_double, gpu, enums::default_mode, table), 0x1800000824);
  EXPECT_EQ(select_key(complex_double, gpu, 0x181120F, table), 0x1800000422);
}

/// Kernel rows for la and ep only, host rows for every accuracy.
const implementation_table& without_ha_kernel() {
  static const implementation_table table{{0x800000122, run, ""},
                                          {0x800000121, run, ""},
                                          {0x800008014, run, ""},
                                          {0x800008012, run, ""},
                                          {0x800008011, run, ""}};
  return table;
}

TEST(SelectKey, LowersAccuracyOnAGpuBeforeItGoesToTheHost) {
  EXPECT_EQ(select_key(double_, gpu, enums::default_mode, without_ha_kernel()), 0x800000122);
}

TEST(SelectKey, KeepsAccuracyWhereOnlyTheHostMayServe) {
  EXPECT_EQ(select_key(double_, gpu, with_host_fallback, without_ha_kernel()), 0x800008014);
}

TEST(SelectKey, IsZeroWithoutFallback) {
  EXPECT_EQ(select_key(double_, gpu, without_fallback, without_ha_kernel()), 0);
  EXPECT_EQ(select_key(double_, cpu, without_fallback, without_ha_kernel()), 0);
}

TEST(SelectKey, RunsKernelsOnACpuForCyclicSlices) {
  const implementation_table table{{0x400000121, run, ""}, {0x400008011, run, ""}};
  EXPECT_EQ(select_key(single, cpu, 0x181120F, table), 0x400008011);
  EXPECT_EQ(select_key(single, cpu, 0x181420F, table), 0x400000121);
  EXPECT_EQ(select_key(single, accelerator, 0x181420F, table), 0x400008011);
}

TEST(SelectKey, NeverFindsRowsMadeForDevicesWithoutDouble) {
  const implementation_table table{{0x400000224, run, ""}, {0x100001224, run, ""}};
  for_every_call([&](std::uint64_t precision, std::uint64_t device, std::uint32_t mode) {
    ASSERT_EQ(select_key(precision, device, mode, table), 0);
  });
}

TEST(SelectKey, SendsADeviceWithoutDoubleToTheHost) {
  const implementation_table table{{0x400000124, run, ""}, {0x400008014, run, ""}};
  EXPECT_EQ(select_key(single, gpu_without_double, enums::default_mode, table), 0x400008014);
  EXPECT_EQ(select_key(single, gpu_without_double, without_fallback, table), 0);
}

}  // namespace
