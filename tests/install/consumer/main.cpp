// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// A project outside the tree that knows the library only by its installed package: `add` on every
/// kind of memory, on spans and with a dependency list.

#include <arbor/lumen/vm.hpp>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <vector>

namespace vm = arbor::lumen::vm;

namespace {

constexpr std::int64_t n = 1000;
int failures = 0;

void expect_sum(const char* what, const float* y) {
  for (std::int64_t i = 0; i < n; ++i) {
    if (y[i] == static_cast<float>(3 * i)) continue;
    std::printf("FAILED %s: element %lld is %g\n", what, static_cast<long long>(i), y[i]);
    ++failures;
    return;
  }
  std::printf("ok %s\n", what);
}

void add_on_usm(sycl::queue& queue, sycl::usm::alloc kind, const char* what) {
  float* a = sycl::malloc<float>(n, queue, kind);
  float* b = sycl::malloc<float>(n, queue, kind);
  float* y = sycl::malloc<float>(n, queue, kind);
  std::vector<float> host_a(n), host_b(n), host_y(n);
  for (std::int64_t i = 0; i < n; ++i) {
    host_a[i] = static_cast<float>(i);
    host_b[i] = static_cast<float>(2 * i);
  }
  const sycl::event copied_a = queue.memcpy(a, host_a.data(), n * sizeof(float));
  const sycl::event copied_b = queue.memcpy(b, host_b.data(), n * sizeof(float));
  // Host memory is copied to a device while the call is made, so it has to be complete by then.
  if (kind == sycl::usm::alloc::host) sycl::event::wait({copied_a, copied_b});
  sycl::event sum = vm::add(queue, n, a, b, y, {copied_a, copied_b});
  queue.memcpy(host_y.data(), y, n * sizeof(float), sum).wait_and_throw();
  expect_sum(what, host_y.data());
  for (float* array : {a, b, y}) sycl::free(array, queue);
}

void add_on_spans(sycl::queue& queue) {
  std::vector<float> a(n), b(n), y(n);
  for (std::int64_t i = 0; i < n; ++i) {
    a[i] = static_cast<float>(i);
    b[i] = static_cast<float>(2 * i);
  }
  vm::add(queue, a, b, y).wait_and_throw();
  expect_sum("spans of vectors", y.data());
  y.assign(n, 0.0f);
  vm::add(queue, n, a.data(), b.data(), y.data()).wait_and_throw();
  expect_sum("plain host memory", y.data());
}

void reject_short_span(sycl::queue& queue) {
  std::vector<float> a(8), y(8);
  sycl::buffer<float, 1> a_buffer(a.data(), sycl::range<1>(a.size()));
  sycl::buffer<float, 1> y_buffer(y.data(), sycl::range<1>(y.size()));
  try {
    vm::add(queue, 10, a_buffer, a_buffer, y_buffer);
  } catch (const arbor::lumen::invalid_argument& error) {
    const char* text = "arbor::lumen::vm::add: invalid argument: insufficient length of arguments";
    if (std::strcmp(error.what(), text) == 0) {
      std::printf("ok short buffers are rejected\n");
      return;
    }
  }
  std::printf("FAILED short buffers are rejected\n");
  ++failures;
}

}  // namespace

int main() {
  for (const sycl::device& device : sycl::device::get_devices()) {
    sycl::queue queue(device);
    std::printf("# %s\n", device.get_info<sycl::info::device::name>().c_str());
    add_on_usm(queue, sycl::usm::alloc::shared, "shared memory with dependencies");
    add_on_usm(queue, sycl::usm::alloc::device, "device memory with dependencies");
    add_on_usm(queue, sycl::usm::alloc::host, "host memory with dependencies");
    add_on_spans(queue);
    reject_short_span(queue);
  }
  return failures == 0 ? 0 : 1;
}
