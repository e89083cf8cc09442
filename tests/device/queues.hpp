// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <functional>
#include <stdexcept>
#include <sycl/sycl.hpp>
#include <vector>

/// Queues on the devices beside which the tests run: a CPU, a GPU, and a GPU without double.
namespace arbor::lumen::tests {

/// The first device that `wanted` accepts.
inline sycl::device device_such_that(const std::function<bool(const sycl::device&)>& wanted) {
  for (const sycl::device& device : sycl::device::get_devices())
    if (wanted(device)) return device;
  throw std::runtime_error(
      "the tests need LUMEN_SYCL_DEVICES with a CPU, a GPU with double and "
      "a GPU without");
}

inline sycl::queue cpu_queue() {
  return sycl::queue(device_such_that([](const sycl::device& d) { return d.is_cpu(); }));
}
inline sycl::queue gpu_queue() {
  return sycl::queue(device_such_that(
      [](const sycl::device& d) { return d.is_gpu() && d.has(sycl::aspect::fp64); }));
}
inline sycl::queue gpu_queue_without_double() {
  return sycl::queue(device_such_that(
      [](const sycl::device& d) { return d.is_gpu() && !d.has(sycl::aspect::fp64); }));
}
inline std::vector<sycl::queue> all_queues() {
  return {cpu_queue(), gpu_queue(), gpu_queue_without_double()};
}

}  // namespace arbor::lumen::tests
