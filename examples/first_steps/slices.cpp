// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <arbor/lumen/vm.hpp>
#include <cstdio>
#include <vector>

namespace vm = arbor::lumen::vm;

void print(const std::vector<float>& y) {
  for (float value : y) std::printf("%g ", value);
  std::puts("");
}

int main() {
  sycl::queue queue;
  const std::vector<float> a = {1, -2, 3, -4, 5, -6}, pattern = {10, 100};
  std::vector<float> y(3), repeated(6), table(6);

  // A slice is {start, size, stride}: every second element.
  vm::abs(queue, a, {1, 3, 2}, y, {0, 3, 1}).wait();
  print(y);
  // The same from the last element of the output to its first.
  vm::abs(queue, a, {1, 3, 2}, y, {2, 3, -1}).wait();
  print(y);

  // Cyclic inputs repeat until the output is full; of two of them the last turns fastest.
  const auto cyclic = vm::enums::slice_cyclic;
  vm::abs(queue, pattern, {0, 2, 1}, repeated, {0, 6, 1}, {}, cyclic).wait();
  print(repeated);
  vm::mul(queue, a, {0, 3, 1}, pattern, {0, 2, 1}, table, {0, 6, 1}, {}, cyclic).wait();
  print(table);
}
