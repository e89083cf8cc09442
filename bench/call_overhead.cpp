// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// What one call costs at n = 1: the library's share is the difference between a call and the bare
/// submission of an equal kernel to the runtime.

#include <benchmark/benchmark.h>

#include <arbor/lumen/vm.hpp>

#include "devices.hpp"

namespace vm = arbor::lumen::vm;

namespace {

struct operands {
  explicit operands(sycl::queue& q)
      : queue(q), a(sycl::malloc_shared<float>(3, queue)), b(a + 1), y(a + 2) {
    a[0] = b[0] = 1.0f;
  }
  operands(const operands&) = delete;
  operands& operator=(const operands&) = delete;
  ~operands() { sycl::free(a, queue); }
  sycl::queue& queue;
  float *a, *b, *y;
};

struct plain_add {
  const float *a, *b;
  float* y;
  void operator()(sycl::id<1> i) const { y[i] = a[i] + b[i]; }
};

void bare_submission(benchmark::State& state) {
  sycl::queue queue(bench::first_gpu());
  const operands x(queue);
  for (auto _ : state) {
    queue.submit([&](sycl::handler& group) {
      group.parallel_for(sycl::range<1>(1), plain_add{x.a, x.b, x.y});
    });
  }
  queue.wait();
}
BENCHMARK(bare_submission)->Name("n=1/device/bare submission");

void call_on_device(benchmark::State& state) {
  sycl::queue queue(bench::first_gpu());
  const operands x(queue);
  for (auto _ : state) vm::add(queue, 1, x.a, x.b, x.y);
  queue.wait();
}
BENCHMARK(call_on_device)->Name("n=1/device/add");

void bare_submission_and_wait(benchmark::State& state) {
  sycl::queue queue(bench::first_gpu());
  const operands x(queue);
  for (auto _ : state) {
    queue
        .submit([&](sycl::handler& group) {
          group.parallel_for(sycl::range<1>(1), plain_add{x.a, x.b, x.y});
        })
        .wait();
  }
}
BENCHMARK(bare_submission_and_wait)->Name("n=1/device/bare submission and wait");

void call_on_device_and_wait(benchmark::State& state) {
  sycl::queue queue(bench::first_gpu());
  const operands x(queue);
  for (auto _ : state) vm::add(queue, 1, x.a, x.b, x.y).wait();
}
BENCHMARK(call_on_device_and_wait)->Name("n=1/device/add and wait");

void call_on_cpu(benchmark::State& state) {
  sycl::queue queue{sycl::cpu_selector_v};
  const operands x(queue);
  for (auto _ : state) vm::add(queue, 1, x.a, x.b, x.y);
}
BENCHMARK(call_on_cpu)->Name("n=1/cpu/add");

}  // namespace
