/* SPDX-FileCopyrightText: The Arbor Lumen authors
 * SPDX-License-Identifier: Apache-2.0
 */

/* The array-math module: kernels over plain arrays, one table of them per function.
 *
 * For each function F and element type t (s float, d double, c complex float, z complex double) the
 * module has four tables, with one entry per class of processors:
 *
 *   lumen_arr_kernel_<t><F>_ttab, lumen_arr_kernel_<t><F>I_ttab   kernels, with unit increments and
 *                                                                 with increments (I)
 *   lumen_arr_kernel_<t><F>_ctab, lumen_arr_kernel_<t><F>I_ctab   nanoseconds per element, about:
 *                                                                 what it takes to decide on
 * threads
 *
 * A kernel takes the number of elements as a 32-bit integer, then the operands in the order inputs,
 * constants, outputs; in the form with increments the 64-bit increment of an array follows its
 * pointer. It works at the accuracy of the calling thread's mode.
 */
#ifndef LUMEN_ARR_H
#define LUMEN_ARR_H

#include <stdint.h>

#define LUMEN_ARR_API __attribute__((visibility("default")))

#ifdef __cplusplus
extern "C" {
#endif

typedef struct {
  float real, imag;
} _LUMEN_Complex8;

typedef struct {
  double real, imag;
} _LUMEN_Complex16;

/* An entry of a table of kernels; what it really takes depends on the function. */
typedef void (*lumen_arr_kernel)(void);

/* The mode of a thread: an accuracy, and whether errors are reported to the callback. */
enum {
  LUMEN_ARR_LA = 1,
  LUMEN_ARR_HA = 2,
  LUMEN_ARR_EP = 3,
  LUMEN_ARR_ACCURACY = 0xf,
  LUMEN_ARR_CALLBACK = 0x1000
};

/* The error status of a thread: what its kernels met since it was cleared, the bits ored, or one of
 * the negative values of a call with bad arguments. */
enum {
  LUMEN_ARR_STATUS_OK = 0,
  LUMEN_ARR_STATUS_ERRDOM = 1,
  LUMEN_ARR_STATUS_SING = 2,
  LUMEN_ARR_STATUS_OVERFLOW = 4,
  LUMEN_ARR_STATUS_UNDERFLOW = 8,
  LUMEN_ARR_STATUS_BADSIZE = -1,
  LUMEN_ARR_STATUS_NULLPTR = -2
};

/* What a kernel tells the callback of one element. The callback may overwrite the results. */
typedef struct {
  int32_t code;  /* 1 domain, 2 pole, 3 overflow, 4 underflow */
  int32_t index; /* of the element in the call */
  double argument[2];
  double result[2];
  unsigned char reserved[72];
  double argument_imag[2];
  double result_imag[2];
} lumen_arr_error_record;

typedef int (*lumen_arr_error_callback)(lumen_arr_error_record*);

/* Each thread has its own mode, status and callback. The setters return what was set before. */
LUMEN_ARR_API int64_t lumen_arr_kernel_SetMode(int64_t mode);
LUMEN_ARR_API int64_t lumen_arr_kernel_GetMode(void);
LUMEN_ARR_API int32_t lumen_arr_kernel_SetErrStatus(int32_t status);
LUMEN_ARR_API int32_t lumen_arr_kernel_GetErrStatus(void);
LUMEN_ARR_API int32_t lumen_arr_kernel_ClearErrStatus(void);
LUMEN_ARR_API lumen_arr_error_callback
lumen_arr_kernel_SetErrorCallBack(lumen_arr_error_callback callback);

/* The index in the tables for a type of processors, 0 and above: 3 and 4 are those with AVX2 and
 * FMA, 5 and above those with AVX-512 (F, DQ, BW, VL) as well. A type that this machine is not of
 * stands for the best that it is, with a warning on the first call. */
LUMEN_ARR_API int32_t lumen_arr_kernel_GetTTableIndex(int32_t processor_type);

#ifdef __cplusplus
}
#endif

#endif
