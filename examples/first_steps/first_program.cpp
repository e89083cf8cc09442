// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <arbor/lumen/vm.hpp>
#include <cstdio>
#include <vector>

namespace vm = arbor::lumen::vm;

int main() {
  sycl::queue queue;  // the default device
  const std::vector<float> price = {19.90f, 4.50f, 3.25f};
  const std::vector<float> count = {1, 12, 4};
  std::vector<float> total(3);

  vm::mul(queue, price, count, total).wait();

  for (float t : total) std::printf("%.2f\n", t);
}
