// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Throughput of every function with a row, on the host path and on the device path, in USM device
/// memory. Names are path/function/type.

#include <benchmark/benchmark.h>

#include <arbor/lumen/vm.hpp>
#include <complex>
#include <cstdint>
#include <string>

#include "devices.hpp"
#include "dispatch/families.hpp"
#include "frontend/call.hpp"

namespace detail = arbor::lumen::vm::detail;
namespace input = detail::input;

namespace {

constexpr std::int64_t n = std::int64_t{1} << 20;

/// Arguments that are ordinary for every function: between 1 and 2, never equal in two arrays.
template <typename T>
T ordinary(std::int64_t i, int array) {
  return T(static_cast<float>(1.0 + 0.25 * array + 0.5 * static_cast<double>(i % 1000) / 1000.0));
}

template <typename T>
class array {
 public:
  array(sycl::queue& queue, int number) : queue_(queue), data_(sycl::malloc_shared<T>(n, queue)) {
    for (std::int64_t i = 0; i < n; ++i) data_[i] = ordinary<T>(i, number);
  }
  array(const array&) = delete;
  array& operator=(const array&) = delete;
  ~array() { sycl::free(data_, queue_); }
  T* get() const { return data_; }

 private:
  sycl::queue& queue_;
  T* data_;
};

template <typename Shape, typename T, typename U>
void run(benchmark::State& state, const detail::family& family, const sycl::device& device) {
  sycl::queue queue(device);
  const array<T> a(queue, 0), b(queue, 1);
  const array<U> y(queue, 2), z(queue, 3);
  for (auto _ : state) {
    detail::call<input::usm::linear<Shape, T, U>> call(family.name, queue, n,
                                                       arbor::lumen::vm::enums::not_defined);
    call.in(a.get());
    if constexpr (Shape::inputs > 1) call.in(b.get());
    for (int c = 0; c < Shape::constants; ++c) call.constant(ordinary<T>(c, 2));
    call.out(y.get());
    if constexpr (Shape::outputs > 1) call.out(z.get());
    call.run(family.dispatch).wait();
  }
  state.SetItemsProcessed(state.iterations() * n);
}

template <typename T, typename U>
void add(const detail::family& family, const std::string& letter) {
  const auto precision = detail::precision_of_pair<T, U>;
  bool present = false;
  family.table().for_each([&](std::uint64_t key, const auto&) {
    present = present || (key & 0xff00000000) == precision;
  });
  if (!present) return;
  const std::string shape = family.shape;
  for (const auto& [path, device] : {std::pair{"cpu", sycl::device(sycl::cpu_selector_v)},
                                     std::pair{"device", bench::first_gpu()}}) {
    const std::string name = std::string(path) + "/" + family.name + "/" + letter;
    const auto body = [&family, device = device, shape](benchmark::State& state) {
      if (shape == "v11") run<detail::shape::v11, T, U>(state, family, device);
      if constexpr (std::is_same_v<T, U>) {
        if (shape == "v21") run<detail::shape::v21, T, U>(state, family, device);
        if (shape == "v21c") run<detail::shape::v21c, T, U>(state, family, device);
        if (shape == "v12") run<detail::shape::v12, T, U>(state, family, device);
        if constexpr (std::is_same_v<T, float> || std::is_same_v<T, double>) {
          if (shape == "v61") run<detail::shape::v61, T, U>(state, family, device);
        }
      }
    };
    benchmark::RegisterBenchmark(name.c_str(), body)->UseRealTime();
  }
}

}  // namespace

int main(int argc, char** argv) {
  for (const detail::family& family : detail::families()) {
    add<sycl::half, sycl::half>(family, "h");
    add<float, float>(family, "s");
    add<double, double>(family, "d");
    if (std::string(family.name) == "abs") {
      add<std::complex<float>, float>(family, "c");
      add<std::complex<double>, double>(family, "z");
    } else {
      add<std::complex<float>, std::complex<float>>(family, "c");
      add<std::complex<double>, std::complex<double>>(family, "z");
    }
  }
  benchmark::Initialize(&argc, argv);
  if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
  benchmark::RunSpecifiedBenchmarks();
  return 0;
}
