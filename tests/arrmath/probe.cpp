// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Prints the type of the processor, the index of its kernels, and the bits of exp(x) for some x,
/// as the library gets them.

#include <cstdio>
#include <cstring>

#include "host/kernel_binding.hpp"
#include "host/kernels.hpp"

namespace binding = arbor::lumen::vm::detail::cpu::binding;

int main() {
  const auto index_of = reinterpret_cast<decltype(&lumen_arr_kernel_GetTTableIndex)>(
      binding::find_symbol("lumen_arr_kernel_GetTTableIndex"));
  const std::int32_t type = binding::processor_type();
  std::printf("%d %d\n", static_cast<int>(type), static_cast<int>(index_of(type)));
  double x[100], y[100];
  for (int i = 0; i < 100; ++i) x[i] = 0.37 * i - 12;
  binding::vdExp(100, x, y, 2);
  for (const double value : y) {
    unsigned long long bits;
    std::memcpy(&bits, &value, sizeof bits);
    std::printf("%016llx\n", bits);
  }
}
