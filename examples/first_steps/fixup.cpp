// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <arbor/lumen/vm.hpp>
#include <cstdio>
#include <vector>

namespace vm = arbor::lumen::vm;

int main() {
  sycl::queue queue;
  const std::vector<float> a = {7.5f, -7.5f}, b = {2, 0};
  std::vector<float> y(4);
  // Instead of the NaN of a division by zero: 0 with the sign of the dividend.
  const bool copy_sign = true;
  const vm::error_handler<float> handler(0.0f, vm::enums::sing, copy_sign);

  // Kernels replace results, the host does not. With cyclic slices a CPU runs the kernel, too; each
  // element of a meets each of b.
  vm::fmod(queue, a, {0, 2, 1}, b, {0, 2, 1}, y, {0, 4, 1}, {}, vm::enums::slice_cyclic, handler)
      .wait();

  for (float remainder : y) std::printf("%g\n", remainder);
}
