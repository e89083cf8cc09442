// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The tables of kernels: one entry per class of processors, in the order of
/// `lumen_arr_kernel_GetTTableIndex`.
#pragma once

#include "lumen_arr.h"

#if defined(__x86_64__)
#define LUMEN_ARR_CLASSES(M, name) M(baseline, name) M(avx2, name) M(avx512, name)
#define LUMEN_ARR_COSTS(cost) cost, cost, cost
#else
#define LUMEN_ARR_CLASSES(M, name) M(baseline, name)
#define LUMEN_ARR_COSTS(cost) cost
#endif

#define LUMEN_ARR_DECLARE(class_name, name) extern "C" void lumen_arr_##class_name##_##name();
#define LUMEN_ARR_ENTRY(class_name, name) &lumen_arr_##class_name##_##name,
#define LUMEN_ARR_ENTRY_OF_ANY(class_name, name) &lumen_arr_any_##name,

#define LUMEN_ARR_CTAB(name, cost) \
  extern "C" LUMEN_ARR_API const float lumen_arr_kernel_##name##_ctab[] = {LUMEN_ARR_COSTS(cost)};

#define LUMEN_ARR_TABLE(name, cost)                                                    \
  LUMEN_ARR_CLASSES(LUMEN_ARR_DECLARE, name)                                           \
  extern "C" LUMEN_ARR_API const lumen_arr_kernel lumen_arr_kernel_##name##_ttab[] = { \
      LUMEN_ARR_CLASSES(LUMEN_ARR_ENTRY, name)};                                       \
  LUMEN_ARR_CTAB(name, cost)

/// Of a kernel that is the same for every class.
#define LUMEN_ARR_TABLE_OF_ANY(name, cost)                                             \
  LUMEN_ARR_DECLARE(any, name)                                                         \
  extern "C" LUMEN_ARR_API const lumen_arr_kernel lumen_arr_kernel_##name##_ttab[] = { \
      LUMEN_ARR_CLASSES(LUMEN_ARR_ENTRY_OF_ANY, name)};                                \
  LUMEN_ARR_CTAB(name, cost)
