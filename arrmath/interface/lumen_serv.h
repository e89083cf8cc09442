/* SPDX-FileCopyrightText: The Arbor Lumen authors
 * SPDX-License-Identifier: Apache-2.0
 */

/* Services around the array-math module: loading it, asking the system, reporting bad arguments,
 * and running its kernels on several threads. */
#ifndef LUMEN_SERV_H
#define LUMEN_SERV_H

#include <stdint.h>

#include "lumen_arr.h"

#ifdef __cplusplus
extern "C" {
#endif

/* The module, loaded on the first call and kept; null if it cannot be loaded. It is looked for
 * beside this library, then where the system looks for libraries. */
LUMEN_ARR_API void* lumen_serv_load_arr(void);

/* The address of a symbol of the module; null if it has none of that name. */
LUMEN_ARR_API void* lumen_serv_find_symbol(void* module, const char* name);

/* The class of this machine's processor, 0 to 9: 9 with AVX-512 (F, DQ, BW, VL), 7 with AVX2 and
 * FMA, else 0. */
LUMEN_ARR_API int32_t lumen_serv_arr_cpu_detect(void);

/* Copies the value of an environment variable, cut to `size` - 1 characters, and returns the length
 * of the copy: 0 if the variable is not set. */
LUMEN_ARR_API int32_t lumen_serv_getenv(const char* name, char* buffer, int32_t size);

/* Reports of bad arguments: the routine's name with its length and the address of the argument's
 * position, counted from 1. The interface says how wide the position is: 4 or 8 bytes. The reporter
 * can be replaced; null stands for the default one, which writes a line to the standard error. */
typedef void (*lumen_serv_reporter)(const char* routine, const void* position, int32_t length);
LUMEN_ARR_API void lumen_serv_set_xerbla_interface(int32_t bytes_of_position);
LUMEN_ARR_API lumen_serv_reporter lumen_serv_set_xerbla(lumen_serv_reporter reporter);
LUMEN_ARR_API void lumen_serv_xerbla(const char* routine, const void* position, int32_t length);
LUMEN_ARR_API void lumen_serv_default_xerbla(const char* routine, const void* position,
                                             int32_t length);

/* Writes message `number` to the standard error, with `count` texts put in. */
LUMEN_ARR_API void lumen_serv_print(int32_t severity, int32_t number, int32_t count, ...);

/* A lock around a word that is 0 at first. */
LUMEN_ARR_API void lumen_serv_lock(int32_t* word);
LUMEN_ARR_API void lumen_serv_unlock(int32_t* word);

/* Ends the process at once, unless a hook is set: then the hook is called instead. Setting a hook
 * returns the one before. */
typedef void (*lumen_serv_exit_hook)(int32_t code);
LUMEN_ARR_API lumen_serv_exit_hook lumen_serv_set_exit_hook(lumen_serv_exit_hook hook);
LUMEN_ARR_API void lumen_serv_exit(int32_t code);

/* lumen_arr_serv_threader_<form> runs a kernel over n elements, on several threads where they pay
 * and the caller is not in a parallel region already; OMP_NUM_THREADS is honoured. A form names
 * element types, the number of inputs and outputs, and with I that they have increments. `cost` is
 * the kernel's entry in its _ctab, `module` what lumen_serv_load_arr returned. The mode of the
 * calling thread holds for all threads, and their statuses are ored into its own. While errors are
 * reported to a callback, one thread is used. */
#define LUMEN_SERV_DECLARE(form, ...)                                                          \
  typedef void (*lumen_arr_kernel_##form)(int32_t n, __VA_ARGS__);                             \
  LUMEN_ARR_API void lumen_arr_serv_threader_##form(lumen_arr_kernel_##form kernel, int32_t n, \
                                                    __VA_ARGS__, float cost, void* module);

#define LUMEN_SERV_DECLARE_11(form, formI, T, U) \
  LUMEN_SERV_DECLARE(form, const T* a, U* y)     \
  LUMEN_SERV_DECLARE(formI, const T* a, int64_t inca, U* y, int64_t incy)
#define LUMEN_SERV_DECLARE_12(form, formI, T)      \
  LUMEN_SERV_DECLARE(form, const T* a, T* y, T* z) \
  LUMEN_SERV_DECLARE(formI, const T* a, int64_t inca, T* y, int64_t incy, T* z, int64_t incz)
#define LUMEN_SERV_DECLARE_21(form, formI, T)            \
  LUMEN_SERV_DECLARE(form, const T* a, const T* b, T* y) \
  LUMEN_SERV_DECLARE(formI, const T* a, int64_t inca, const T* b, int64_t incb, T* y, int64_t incy)
#define LUMEN_SERV_DECLARE_21C(form, formI, T)    \
  LUMEN_SERV_DECLARE(form, const T* a, T b, T* y) \
  LUMEN_SERV_DECLARE(formI, const T* a, int64_t inca, T b, T* y, int64_t incy)
#define LUMEN_SERV_DECLARE_61(form, formI, T)                                                    \
  LUMEN_SERV_DECLARE(form, const T* a, const T* b, T scalea, T shifta, T scaleb, T shiftb, T* y) \
  LUMEN_SERV_DECLARE(formI, const T* a, int64_t inca, const T* b, int64_t incb, T scalea,        \
                     T shifta, T scaleb, T shiftb, T* y, int64_t incy)

/* Every pair of forms: M11(form, form with increments, input, output), the others likewise. */
#define LUMEN_SERV_THREADERS(M11, M12, M21, M21C, M61)        \
  M11(s_1i_1o, s_1iI_1oI, float, float)                       \
  M11(d_1i_1o, d_1iI_1oI, double, double)                     \
  M11(c_1i_1o, c_1iI_1oI, _LUMEN_Complex8, _LUMEN_Complex8)   \
  M11(z_1i_1o, z_1iI_1oI, _LUMEN_Complex16, _LUMEN_Complex16) \
  M11(c_1i_s_1o, c_1iI_s_1oI, _LUMEN_Complex8, float)         \
  M11(z_1i_d_1o, z_1iI_d_1oI, _LUMEN_Complex16, double)       \
  M11(s_1i_c_1o, s_1iI_c_1oI, float, _LUMEN_Complex8)         \
  M11(d_1i_z_1o, d_1iI_z_1oI, double, _LUMEN_Complex16)       \
  M12(s_1i_2o, s_1iI_2oI, float)                              \
  M12(d_1i_2o, d_1iI_2oI, double)                             \
  M21(s_2i_1o, s_2iI_1oI, float)                              \
  M21(d_2i_1o, d_2iI_1oI, double)                             \
  M21(c_2i_1o, c_2iI_1oI, _LUMEN_Complex8)                    \
  M21(z_2i_1o, z_2iI_1oI, _LUMEN_Complex16)                   \
  M21C(s_cs_2i_s_1o, s_cs_2iI_s_1oI, float)                   \
  M21C(d_cd_2i_d_1o, d_cd_2iI_d_1oI, double)                  \
  M21C(c_cc_2i_c_1o, c_cc_2iI_c_1oI, _LUMEN_Complex8)         \
  M21C(z_cz_2i_z_1o, z_cz_2iI_z_1oI, _LUMEN_Complex16)        \
  M61(s_6i_1o, s_6iI_1oI, float)                              \
  M61(d_6i_1o, d_6iI_1oI, double)

LUMEN_SERV_THREADERS(LUMEN_SERV_DECLARE_11, LUMEN_SERV_DECLARE_12, LUMEN_SERV_DECLARE_21,
                     LUMEN_SERV_DECLARE_21C, LUMEN_SERV_DECLARE_61)

#ifdef __cplusplus
}
#endif

#endif
