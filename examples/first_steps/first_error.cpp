// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <arbor/lumen/vm.hpp>
#include <cstdio>

namespace vm = arbor::lumen::vm;

int main() {
  sycl::queue queue;
  float a[4] = {1, 2, 3, 4}, b[4] = {5, 6, 7, 8}, y[4];
  try {
    vm::add(queue, -1, a, b, y);
  } catch (const arbor::lumen::invalid_argument& error) {
    std::puts(error.what());
  }
  // The same, quietly: the call does nothing and leaves a mark on the queue.
  vm::add(queue, -1, a, b, y, {}, vm::enums::mode::badarg_quiet);
  if (vm::clear_status(queue) & vm::enums::status::bad_argument) std::puts("bad argument");
}
