// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The parts of a dispatch: what happens between an exported function and its launcher.

#include <benchmark/benchmark.h>

#include "call/mode_word.hpp"
#include "call/queue_store.hpp"
#include "devices.hpp"
#include "dispatch/device_word.hpp"
#include "dispatch/dispatch_call.hpp"
#include "dispatch/key.hpp"
#include "dispatch/select_key.hpp"

namespace detail = arbor::lumen::vm::detail;

namespace {

sycl::event do_nothing(const detail::input::vxx&, detail::TuningInfo) { return {}; }

const detail::implementation_table& table() {
  static const detail::implementation_table rows{{0x400000124, &do_nothing, "ha"},
                                                 {0x400000122, &do_nothing, "la"},
                                                 {0x400000121, &do_nothing, "ep"}};
  return rows;
}

void queue_key(benchmark::State& state) {
  sycl::queue queue(bench::first_gpu());
  for (auto _ : state) benchmark::DoNotOptimize(detail::queue_key(&queue));
}
BENCHMARK(queue_key)->Name("dispatch/queue key");

void device_word(benchmark::State& state) {
  sycl::queue queue(bench::first_gpu());
  for (auto _ : state) benchmark::DoNotOptimize(detail::device_word::of_queue(&queue));
}
BENCHMARK(device_word)->Name("dispatch/device word");

void search(benchmark::State& state) {
  const std::uint64_t word = detail::device_word::classify(bench::first_gpu());
  for (auto _ : state)
    benchmark::DoNotOptimize(detail::select_key(detail::precision_of<float>, word,
                                                arbor::lumen::vm::enums::default_mode, table()));
}
BENCHMARK(search)->Name("dispatch/search for a key");

void whole(benchmark::State& state) {
  sycl::queue queue(bench::first_gpu());
  detail::input::usm::linear<detail::shape::v11, float, float> record;
  record.name = "exp";
  record.queue = &queue;
  record.n = 1;
  record.mode = arbor::lumen::vm::enums::default_mode;
  for (auto _ : state) benchmark::DoNotOptimize(detail::dispatch_call(record, table()));
}
BENCHMARK(whole)->Name("dispatch/whole, launcher empty");

}  // namespace
