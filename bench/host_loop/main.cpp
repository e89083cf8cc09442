// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Every body in the loop of a host kernel, beside SLEEF's functions of 1 and 3.5 ulp and the C
/// library's vector functions, on one thread, for the instruction set of the compilation.
///
/// Names are function/type/implementation/arguments/number of elements.

#include <benchmark/benchmark.h>

#include <algorithm>
#include <set>
#include <string>
#include <utility>

#include "arena.hpp"
#include "arguments.hpp"
#include "peers.hpp"
#include "scalar/block_loop.hpp"
#include "scalar/functors.hpp"
#include "scalar/generated/list.hpp"

namespace {

namespace scalar = arbor::lumen::vm::detail::gpu::norvane::scalar;
using bench::interval;
using bench::special;
using enum bench::spacing;

constexpr std::int64_t sizes[] = {4096, std::int64_t{1} << 20};

/// A second result goes behind the first one, to y + n.
template <typename T>
using array_function = void (*)(const T* const* in, T* y, std::int64_t n);

template <typename T>
void add_one(const std::string& name, array_function<T> f, const interval* from, special kind,
             std::int64_t n) {
  benchmark::RegisterBenchmark((name + "/" + std::to_string(n)).c_str(),
                               [=](benchmark::State& state) {
                                 const bench::arena<T>& arrays = bench::arena<T>::of(n);
                                 std::vector<T> x = bench::draw<T>(from[0], n, 1);
                                 bench::make_special(x, kind);
                                 std::ranges::copy(x, arrays.input(0));
                                 std::ranges::copy(bench::draw<T>(from[1], n, 2), arrays.input(1));
                                 const T* const in[] = {arrays.input(0), arrays.input(1)};
                                 for (auto _ : state) {
                                   f(in, arrays.results(), n);
                                   benchmark::ClobberMemory();
                                 }
                                 state.SetItemsProcessed(state.iterations() * n);
                               });
}

template <typename T>
void add(std::string_view function, char type, std::string_view implementation,
         array_function<T> f) {
  const bench::arguments* const from = bench::arguments_of(function);
  if (from == nullptr) return;
  const interval* const intervals = sizeof(T) == 4 ? from->of_float : from->of_double;
  const std::string name =
      std::string(function) + "/" + type + "/" + std::string(implementation) + "/";
  for (const std::int64_t n : sizes) add_one<T>(name + "ordinary", f, intervals, special::none, n);
  add_one<T>(name + "tenth_special", f, intervals, special::tenth_special, sizes[0]);
  add_one<T>(name + "denormal", f, intervals, special::all_denormal, sizes[0]);
  const bool trigonometric = function == "sin" || function == "cos" || function == "tan";
  if (trigonometric) {
    static constexpr interval large_float[] = {{logarithmic, 1e5, 1e38}, {}};
    static constexpr interval large_double[] = {{logarithmic, 1e10, 1e300}, {}};
    add_one<T>(name + "large", f, sizeof(T) == 4 ? large_float : large_double, special::none,
               sizes[0]);
  }
}

/// Functors that share a body are timed once, under the label that comes first.
template <typename Loop, typename T>
void run_loop(const T* const* in, T* y, std::int64_t n) {
  if constexpr (Loop::outputs == 2)
    Loop::run(n, {in[0]}, {y, y + n});
  else if constexpr (Loop::inputs == 1)
    Loop::run(n, {in[0]}, {y});
  else
    Loop::run(n, {in[0], in[1]}, {y});
}

template <typename F>
void add_functor(std::string_view function, char type, std::string_view tier,
                 std::string_view label, std::set<const void*>& timed) {
  using loop = scalar::block_loop_of<F>;
  if constexpr (!std::is_void_v<loop>) {
    using T = typename loop::input_type;
    if constexpr (std::is_same_v<T, typename loop::output_type> &&
                  (std::is_same_v<T, float> || std::is_same_v<T, double>)) {
      const array_function<T> run = &run_loop<loop, T>;
      if (!timed.insert(reinterpret_cast<const void*>(run)).second) return;
      add<T>(function, type, std::string(tier) + "_" + std::string(label), run);
    }
  }
}

void add_all() {
  std::set<const void*> timed;
#define LUMEN_ADD(function, shape, type, tier, label, name) \
  add_functor<scalar::name>(#function, #type[0], #tier, #label, timed);
  LUMEN_FUNCTORS(LUMEN_ADD)
#undef LUMEN_ADD
  for (const bench::peer& p : bench::peers()) {
    if (p.run_float != nullptr) add<float>(p.function, p.type, p.implementation, p.run_float);
    if (p.run_double != nullptr) add<double>(p.function, p.type, p.implementation, p.run_double);
  }
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
