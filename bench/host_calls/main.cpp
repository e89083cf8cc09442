// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Whole calls on a CPU queue: every function beside SLEEF's and the C library's vector functions
/// on one thread, cheap functions beside a copy, two threads beside one, and what a call of one
/// element costs. The peers are those of the instruction set of the compilation;
/// LUMEN_ARR_DEBUG_CPU_TYPE has to ask for the kernels of the same set.
///
/// Names are function/type/implementation/arguments/number of elements.

#include <benchmark/benchmark.h>
#include <omp.h>

#include <algorithm>
#include <arbor/lumen/vm.hpp>
#include <complex>
#include <string>
#include <type_traits>
#include <utility>

#include "arena.hpp"
#include "arguments.hpp"
#include "catalogue_lists.hpp"
#include "peers.hpp"

namespace {

namespace vm = arbor::lumen::vm;
using vm::enums::mode;

constexpr std::int64_t block = 4096, large = std::int64_t{1} << 20;

template <typename T>
using array_function = void (*)(const T* const* in, T* y, std::int64_t n);

/// Any callable of this form, timed with a number of threads.
template <typename T, typename Run>
void add(const std::string& name, const bench::interval* from, std::int64_t n, int threads,
         Run run) {
  benchmark::RegisterBenchmark((name + "/" + std::to_string(n)).c_str(), [=](benchmark::State&
                                                                                 state) {
    const bench::arena<T>& arrays = bench::arena<T>::of(n);
    for (int k = 0; k < 2; ++k) {
      std::ranges::copy(bench::draw<T>(from[k], n, 1 + k), arrays.input(k));
    }
    const T* const in[] = {arrays.input(0), arrays.input(1)};
    omp_set_num_threads(threads);
    for (auto _ : state) {
      run(in, arrays.results(), n);
      benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations() * n);
  })->UseRealTime();
}

sycl::queue& cpu_queue() {
  static sycl::queue queue{sycl::cpu_selector_v};
  return queue;
}

/// The public call of a function as a callable; a second result goes behind the first one.
#define LUMEN_CALL_v11(name) vm::name(cpu_queue(), n, in[0], y, {}, tier).wait()
#define LUMEN_CALL_v12(name) vm::name(cpu_queue(), n, in[0], y, y + n, {}, tier).wait()
#define LUMEN_CALL_v21(name) vm::name(cpu_queue(), n, in[0], in[1], y, {}, tier).wait()
#define LUMEN_CALL_v21c(name) vm::name(cpu_queue(), n, in[0], in[1][0], y, {}, tier).wait()
#define LUMEN_CALL_v61(name) \
  static_cast<void>(in), static_cast<void>(y), static_cast<void>(n), static_cast<void>(tier)

template <typename T>
using call = void (*)(const T* const* in, T* y, std::int64_t n, mode tier);

template <typename T>
void add_calls(std::string_view function, char type, call<T> f) {
  const std::string name = std::string(function) + "/" + type + "/";
  const auto at = [f](mode tier) {
    return [f, tier](const T* const* in, T* y, std::int64_t n) { f(in, y, n, tier); };
  };
  static constexpr bench::interval ordinary[] = {{bench::linear, 1, 2}, {bench::linear, 1, 2}};
  if (function == "add") add<T>(name + "ha_call/ordinary", ordinary, 1, 1, at(mode::ha));
  for (const std::string_view cheap : {"abs", "add", "mul", "sqr"}) {
    if (function == cheap) add<T>(name + "call/memory", ordinary, 16 * large, 1, at(mode::ha));
  }
  const bench::arguments* const from = bench::arguments_of(function);
  if (from == nullptr) return;
  const bench::interval* const intervals = sizeof(T) == 4 ? from->of_float : from->of_double;
  const std::pair<const char*, mode> tiers[] = {
      {"ha", mode::ha}, {"la", mode::la}, {"ep", mode::ep}};
  for (const auto& [tier_name, tier] : tiers) {
    for (const std::int64_t n : {block, large})
      add<T>(name + tier_name + "_call/ordinary", intervals, n, 1, at(tier));
  }
  add<T>(name + "ha_call/two_threads", intervals, large, 2, at(mode::ha));
}

template <typename T>
void add_peer(const bench::peer& peer, array_function<T> f) {
  const bench::arguments* const from = bench::arguments_of(peer.function);
  if (from == nullptr) return;
  const bench::interval* const intervals = sizeof(T) == 4 ? from->of_float : from->of_double;
  const std::string name = std::string(peer.function) + "/" + peer.type + "/" +
                           std::string(peer.implementation) + "/ordinary";
  for (const std::int64_t n : {block, large}) add<T>(name, intervals, n, 1, f);
}

/// What memory allows: a loop of the C library that copies.
template <typename T>
void add_copy(char type) {
  static constexpr bench::interval ordinary[] = {{bench::linear, 1, 2}, {bench::linear, 1, 2}};
  add<T>(std::string("copy/") + type + "/loop/memory", ordinary, 16 * large, 1,
         [](const T* const* in, T* y, std::int64_t n) {
           for (std::int64_t i = 0; i < n; ++i) y[i] = in[0][i];
         });
  add<T>(std::string("copy_sum/") + type + "/loop/memory", ordinary, 16 * large, 1,
         [](const T* const* in, T* y, std::int64_t n) {
           for (std::int64_t i = 0; i < n; ++i) y[i] = in[0][i] + in[1][i];
         });
}

/// Real functions only: those have peers.
template <typename T, typename U, typename Call>
void add_if_real(std::string_view function, char type, Call f) {
  if constexpr (std::is_same_v<T, U> && std::is_floating_point_v<T>)
    add_calls<T>(function, type, f);
}

void add_all() {
#define LUMEN_ADD(name, shape, letter, T, U, handler)                               \
  add_if_real<T, U>(#name, #letter[0],                                              \
                    [](const auto* const* in, auto* y, std::int64_t n, mode tier) { \
                      LUMEN_CALL_##shape(name);                                     \
                    });
  LUMEN_OVERLOADS(LUMEN_ADD)
#undef LUMEN_ADD
  for (const bench::peer& peer : bench::peers()) {
    if (peer.run_float != nullptr) add_peer<float>(peer, peer.run_float);
    if (peer.run_double != nullptr) add_peer<double>(peer, peer.run_double);
  }
  add_copy<float>('s');
  add_copy<double>('d');
}

}  // namespace

int main(int argc, char** argv) {
  benchmark::Initialize(&argc, argv);
  if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 2;
  add_all();
  benchmark::RunSpecifiedBenchmarks();
  benchmark::Shutdown();
  return 0;
}
