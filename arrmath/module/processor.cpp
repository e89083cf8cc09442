// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <algorithm>
#include <atomic>
#include <cstdint>
#include <cstdio>

#include "lumen_arr.h"
#include "processor_class.hpp"

using arbor::lumen::arr::own_processor_class;
using arbor::lumen::arr::processor_class;

namespace {

/// The class of each type of processors. Types without kernels of their own have those of the one
/// below.
constexpr processor_class class_of_type[] = {
    processor_class::baseline, processor_class::baseline, processor_class::baseline,
    processor_class::avx2,     processor_class::avx2,     processor_class::avx512};

}  // namespace

std::int32_t lumen_arr_kernel_GetTTableIndex(std::int32_t processor_type) {
  static const processor_class best = own_processor_class();
  const processor_class wanted = class_of_type[std::clamp(processor_type, 0, 5)];
  if (wanted <= best) return static_cast<std::int32_t>(wanted);
  static std::atomic<bool> warned{false};
  if (!warned.exchange(true)) {
    std::fprintf(stderr,
                 "arbor lumen: this processor is not of type %d; it runs the kernels of the best "
                 "type that it is\n",
                 static_cast<int>(processor_type));
  }
  return static_cast<std::int32_t>(best);
}
