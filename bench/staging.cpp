// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Copies of host memory around a device call, against the bandwidth of memcpy.

#include <benchmark/benchmark.h>

#include <arbor/lumen/vm.hpp>
#include <cstring>
#include <vector>

#include "devices.hpp"

namespace vm = arbor::lumen::vm;

namespace {

/// `abs` of plain host memory: the input goes in, the output goes in and comes back, so three
/// copies beside the kernel's one read and one write.
void staged_call(benchmark::State& state) {
  sycl::queue queue(bench::first_gpu());
  const auto n = static_cast<std::size_t>(state.range(0));
  std::vector<float> a(n, -1.0f), y(n);
  for (auto _ : state) vm::abs(queue, state.range(0), a.data(), y.data());
  state.SetBytesProcessed(state.iterations() * state.range(0) * 3 *
                          static_cast<std::int64_t>(sizeof(float)));
}
BENCHMARK(staged_call)
    ->Name("staging/abs of host memory, bytes copied")
    ->RangeMultiplier(16)
    ->Range(1 << 12, 1 << 24)
    ->UseRealTime();

void plain_memcpy(benchmark::State& state) {
  const auto n = static_cast<std::size_t>(state.range(0));
  std::vector<float> a(n, -1.0f), y(n);
  for (auto _ : state) {
    for (int copy = 0; copy < 3; ++copy) {
      std::memcpy(y.data(), a.data(), n * sizeof(float));
      benchmark::ClobberMemory();
    }
  }
  state.SetBytesProcessed(state.iterations() * state.range(0) * 3 *
                          static_cast<std::int64_t>(sizeof(float)));
}
BENCHMARK(plain_memcpy)
    ->Name("staging/three memcpy")
    ->RangeMultiplier(16)
    ->Range(1 << 12, 1 << 24)
    ->UseRealTime();

}  // namespace
