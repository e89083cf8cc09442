// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The arithmetic that scalar bodies are written in.
///
/// This is the only scalar header that knows where an operation comes from: compiler built-ins on
/// the host and under the embedded SYCL runtime, `sycl::` built-ins where a SYCL compiler makes the
/// device code, CUDA's correctly rounded intrinsics under nvcc. Every operation here is correctly
/// rounded or exact, so a body gives the same bits wherever it runs, provided that the translation
/// unit is compiled without contraction (`-ffp-contract=off`).
#pragma once

#include <bit>
#include <cstdint>
#include <type_traits>

#if defined(__CUDACC__)
#define LUMEN_DEVICE __host__ __device__
#else
#define LUMEN_DEVICE
#endif

#if defined(ARBORLUMEN_SYCL_COMPILER)
#include <sycl/sycl.hpp>
#define LUMEN_BUILTIN(name) ::sycl::name
#endif

/// A main path: straight-line code that must inline into the loop around it to be vectorised.
#define LUMEN_MAIN [[gnu::always_inline]] LUMEN_DEVICE static inline
/// A rare path: out of line, so that its length costs the main path no registers.
#define LUMEN_RARE [[gnu::noinline, gnu::cold]] LUMEN_DEVICE static

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Unsigned and signed integers as wide as the floating type `T`.
template <typename T>
struct integers;
template <>
struct integers<float> {
  using unsigned_type = std::uint32_t;
  using signed_type = std::int32_t;
};
template <>
struct integers<double> {
  using unsigned_type = std::uint64_t;
  using signed_type = std::int64_t;
};
template <typename T>
using uint_of = typename integers<T>::unsigned_type;
template <typename T>
using int_of = typename integers<T>::signed_type;

/// The IEEE 754 pattern of `x`, and the value of a pattern.
LUMEN_DEVICE constexpr std::uint32_t bits(float x) { return std::bit_cast<std::uint32_t>(x); }
LUMEN_DEVICE constexpr std::uint64_t bits(double x) { return std::bit_cast<std::uint64_t>(x); }
LUMEN_DEVICE constexpr float value(std::uint32_t pattern) { return std::bit_cast<float>(pattern); }
LUMEN_DEVICE constexpr double value(std::uint64_t pattern) {
  return std::bit_cast<double>(pattern);
}

/// What a body needs to know of an IEEE 754 format. `special` is the pattern of infinity: a
/// magnitude pattern at or above it is an infinity or a NaN.
template <typename T>
struct format;
template <>
struct format<float> {
  static constexpr std::uint32_t sign = 0x80000000u;
  static constexpr std::uint32_t magnitude = 0x7fffffffu;
  static constexpr std::uint32_t special = 0x7f800000u;
  static constexpr std::uint32_t fraction = 0x007fffffu;
  static constexpr std::uint32_t one = 0x3f800000u;
  static constexpr std::uint32_t nan = 0x7fc00000u;
  static constexpr int fraction_bits = 23;
  static constexpr int bias = 127;
};
template <>
struct format<double> {
  static constexpr std::uint64_t sign = 0x8000000000000000u;
  static constexpr std::uint64_t magnitude = 0x7fffffffffffffffu;
  static constexpr std::uint64_t special = 0x7ff0000000000000u;
  static constexpr std::uint64_t fraction = 0x000fffffffffffffu;
  static constexpr std::uint64_t one = 0x3ff0000000000000u;
  static constexpr std::uint64_t nan = 0x7ff8000000000000u;
  static constexpr int fraction_bits = 52;
  static constexpr int bias = 1023;
};

/// `c ? a : b` between two values that both exist: the form that compilers turn into a blend and
/// never into a branch.
template <typename T>
LUMEN_DEVICE constexpr T select(bool c, T a, T b) {
  return c ? a : b;
}

/// `fma` is the exactly rounded fused multiply-add. `mad`, which a device may leave unfused, is
/// fused everywhere here, so that results do not depend on the device.
#if defined(__CUDA_ARCH__)
LUMEN_DEVICE inline float fma(float a, float b, float c) { return __fmaf_rn(a, b, c); }
LUMEN_DEVICE inline double fma(double a, double b, double c) { return __fma_rn(a, b, c); }
LUMEN_DEVICE inline float sqrt(float x) { return __fsqrt_rn(x); }
LUMEN_DEVICE inline double sqrt(double x) { return __dsqrt_rn(x); }
LUMEN_DEVICE inline float divide(float a, float b) { return __fdiv_rn(a, b); }
LUMEN_DEVICE inline double divide(double a, double b) { return __ddiv_rn(a, b); }
LUMEN_DEVICE inline float floor(float x) { return floorf(x); }
LUMEN_DEVICE inline double floor(double x) { return ::floor(x); }
LUMEN_DEVICE inline float ceil(float x) { return ceilf(x); }
LUMEN_DEVICE inline double ceil(double x) { return ::ceil(x); }
LUMEN_DEVICE inline float trunc(float x) { return truncf(x); }
LUMEN_DEVICE inline double trunc(double x) { return ::trunc(x); }
LUMEN_DEVICE inline float rint(float x) { return rintf(x); }
LUMEN_DEVICE inline double rint(double x) { return ::rint(x); }
#else
#if !defined(LUMEN_BUILTIN)
LUMEN_DEVICE inline float fma(float a, float b, float c) { return __builtin_fmaf(a, b, c); }
LUMEN_DEVICE inline double fma(double a, double b, double c) { return __builtin_fma(a, b, c); }
LUMEN_DEVICE inline float sqrt(float x) { return __builtin_sqrtf(x); }
LUMEN_DEVICE inline double sqrt(double x) { return __builtin_sqrt(x); }
LUMEN_DEVICE inline float floor(float x) { return __builtin_floorf(x); }
LUMEN_DEVICE inline double floor(double x) { return __builtin_floor(x); }
LUMEN_DEVICE inline float ceil(float x) { return __builtin_ceilf(x); }
LUMEN_DEVICE inline double ceil(double x) { return __builtin_ceil(x); }
LUMEN_DEVICE inline float trunc(float x) { return __builtin_truncf(x); }
LUMEN_DEVICE inline double trunc(double x) { return __builtin_trunc(x); }
LUMEN_DEVICE inline float rint(float x) { return __builtin_rintf(x); }
LUMEN_DEVICE inline double rint(double x) { return __builtin_rint(x); }
#else
LUMEN_DEVICE inline float fma(float a, float b, float c) { return LUMEN_BUILTIN(fma)(a, b, c); }
LUMEN_DEVICE inline double fma(double a, double b, double c) { return LUMEN_BUILTIN(fma)(a, b, c); }
LUMEN_DEVICE inline float sqrt(float x) { return LUMEN_BUILTIN(sqrt)(x); }
LUMEN_DEVICE inline double sqrt(double x) { return LUMEN_BUILTIN(sqrt)(x); }
LUMEN_DEVICE inline float floor(float x) { return LUMEN_BUILTIN(floor)(x); }
LUMEN_DEVICE inline double floor(double x) { return LUMEN_BUILTIN(floor)(x); }
LUMEN_DEVICE inline float ceil(float x) { return LUMEN_BUILTIN(ceil)(x); }
LUMEN_DEVICE inline double ceil(double x) { return LUMEN_BUILTIN(ceil)(x); }
LUMEN_DEVICE inline float trunc(float x) { return LUMEN_BUILTIN(trunc)(x); }
LUMEN_DEVICE inline double trunc(double x) { return LUMEN_BUILTIN(trunc)(x); }
LUMEN_DEVICE inline float rint(float x) { return LUMEN_BUILTIN(rint)(x); }
LUMEN_DEVICE inline double rint(double x) { return LUMEN_BUILTIN(rint)(x); }
#endif
LUMEN_DEVICE inline float divide(float a, float b) { return a / b; }
LUMEN_DEVICE inline double divide(double a, double b) { return a / b; }
#endif

/// Whether `fma` is an instruction of the processor compiled for. Where it is a function of the C
/// library, what counts on its speed is left out.
#if defined(__FMA__) || defined(__ARM_FEATURE_FMA)
inline constexpr bool has_fma = true;
#else
inline constexpr bool has_fma = false;
#endif

/// Whether loops run on vectors of 512 bits with masks. These pass the divider in parts, so that a
/// root and a division take as long as forty other operations, and a select between an operand and
/// what is computed from it is part of that operation. Where it pays, a body has two ways to the
/// same bits.
#if defined(__AVX512F__)
inline constexpr bool wide_vectors = true;
#else
inline constexpr bool wide_vectors = false;
#endif

template <typename T>
LUMEN_DEVICE inline T mad(T a, T b, T c) {
  return fma(a, b, c);
}

/// |x| by clearing the sign bit, also of a NaN.
template <typename T>
LUMEN_DEVICE constexpr T fabs(T x) {
  return value(bits(x) & format<T>::magnitude);
}

/// The sign bit of `x` alone, as a pattern.
template <typename T>
LUMEN_DEVICE constexpr uint_of<T> sign_bit(T x) {
  return bits(x) & format<T>::sign;
}

template <typename T>
LUMEN_DEVICE constexpr bool is_nan(T x) {
  return (bits(x) & format<T>::magnitude) > format<T>::special;
}

/// An exponent field of all ones: an infinity or a NaN.
template <typename T>
LUMEN_DEVICE constexpr bool is_special(T x) {
  return (bits(x) & format<T>::magnitude) >= format<T>::special;
}

/// An infinity of either sign.
template <typename T>
LUMEN_DEVICE constexpr bool is_infinite(T x) {
  return (bits(x) & format<T>::magnitude) == format<T>::special;
}

/// `magnitude` with the sign bit of `x` ORed on: a sign that is set already stays.
template <typename T>
LUMEN_DEVICE constexpr T or_sign(T magnitude, T x) {
  return value(bits(magnitude) | sign_bit(x));
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
