// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <arbor/lumen/vm.hpp>
#include <cstdio>
#include <limits>
#include <vector>

namespace vm = arbor::lumen::vm;

int main() {
  sycl::queue queue;
  const std::vector<float> a = {1, std::numeric_limits<float>::max(), 0};
  const std::vector<float> up = {std::numeric_limits<float>::infinity()};
  std::vector<float> y(3);
  std::vector<vm::enums::status> status(3, vm::enums::success);  // one for each element
  const vm::error_handler<float> handler(status.data(), 3);

  // Kernels report status, the host does not. With cyclic slices a CPU runs the kernel, too.
  vm::nextafter(queue, a, {0, 3, 1}, up, {0, 1, 1}, y, {0, 3, 1}, {}, vm::enums::slice_cyclic,
                handler)
      .wait();

  for (int i = 0; i < 3; ++i) {
    std::printf("%.9g%s%s\n", y[i], status[i] & vm::enums::overflow ? " overflow" : "",
                status[i] & vm::enums::underflow ? " underflow" : "");
  }
}
