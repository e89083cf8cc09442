// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

namespace arbor::lumen::arr {

/// The classes of processors that kernels are compiled for, each a superset of the ones before.
enum class processor_class : std::int32_t {
  baseline = 0,
  avx2 = 1,   ///< AVX2 and FMA
  avx512 = 2  ///< AVX-512 F, DQ, BW and VL
};

/// The best class that this processor is of.
inline processor_class own_processor_class() {
#if defined(__x86_64__)
  const bool avx2 = __builtin_cpu_supports("avx2") && __builtin_cpu_supports("fma");
  const bool avx512 = avx2 && __builtin_cpu_supports("avx512f") &&
                      __builtin_cpu_supports("avx512dq") && __builtin_cpu_supports("avx512bw") &&
                      __builtin_cpu_supports("avx512vl");
  if (avx512) return processor_class::avx512;
  if (avx2) return processor_class::avx2;
#endif
  return processor_class::baseline;
}

}  // namespace arbor::lumen::arr
