// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "peers.hpp"

#include <immintrin.h>
#include <sleef.h>

namespace {

#if defined(__AVX512F__)
using float_vector = __m512;
using double_vector = __m512d;
float_vector load(const float* x) { return _mm512_loadu_ps(x); }
double_vector load(const double* x) { return _mm512_loadu_pd(x); }
void store(float* y, float_vector v) { _mm512_storeu_ps(y, v); }
void store(double* y, double_vector v) { _mm512_storeu_pd(y, v); }
#define SLEEF_FLOAT(name, bound) Sleef_##name##f16_##bound##avx512f
#define SLEEF_DOUBLE(name, bound) Sleef_##name##d8_##bound##avx512f
#define MVEC_FLOAT(arguments, name) _ZGVeN16##arguments##_##name##f
#define MVEC_DOUBLE(arguments, name) _ZGVeN8##arguments##_##name
#else
using float_vector = __m256;
using double_vector = __m256d;
float_vector load(const float* x) { return _mm256_loadu_ps(x); }
double_vector load(const double* x) { return _mm256_loadu_pd(x); }
void store(float* y, float_vector v) { _mm256_storeu_ps(y, v); }
void store(double* y, double_vector v) { _mm256_storeu_pd(y, v); }
#define SLEEF_FLOAT(name, bound) Sleef_##name##f8_##bound##avx2
#define SLEEF_DOUBLE(name, bound) Sleef_##name##d4_##bound##avx2
#define MVEC_FLOAT(arguments, name) _ZGVdN8##arguments##_##name##f
#define MVEC_DOUBLE(arguments, name) _ZGVdN4##arguments##_##name
#endif

template <auto f, typename T>
void run_one(const T* const* in, T* y, std::int64_t n) {
  constexpr auto width = static_cast<std::int64_t>(sizeof(load(y)) / sizeof(T));
  for (std::int64_t i = 0; i < n; i += width) store(y + i, f(load(in[0] + i)));
}

template <auto f, typename T>
void run_two(const T* const* in, T* y, std::int64_t n) {
  constexpr auto width = static_cast<std::int64_t>(sizeof(load(y)) / sizeof(T));
  for (std::int64_t i = 0; i < n; i += width) store(y + i, f(load(in[0] + i), load(in[1] + i)));
}

/// SLEEF returns the two vectors in a structure.
template <auto f, typename T>
void run_sincos(const T* const* in, T* y, std::int64_t n) {
  constexpr auto width = static_cast<std::int64_t>(sizeof(load(y)) / sizeof(T));
  for (std::int64_t i = 0; i < n; i += width) {
    const auto both = f(load(in[0] + i));
    store(y + i, both.x);
    store(y + n + i, both.y);
  }
}

// Name in the catalogue, name in the C library.
#define MVEC_FUNCTIONS(ONE, TWO)                                                                   \
  ONE(acos, acos)                                                                                  \
  ONE(asin, asin)                                                                                  \
  ONE(atan, atan)                                                                                  \
  ONE(cbrt, cbrt) ONE(cos, cos) ONE(exp, exp) ONE(exp10, exp10) ONE(exp2, exp2) ONE(expm1, expm1)  \
      ONE(ln, log) ONE(log10, log10) ONE(log1p, log1p) ONE(log2, log2) ONE(sin, sin) ONE(tan, tan) \
          TWO(atan2, atan2) TWO(hypot, hypot) TWO(pow, pow)

// Name in the catalogue, name in SLEEF, bound in tenths of an ulp.
#define SLEEF_FUNCTIONS(ONE, TWO)                                                                 \
  ONE(acos, acos, u10)                                                                            \
  ONE(acos, acos, u35)                                                                            \
  ONE(asin, asin, u10)                                                                            \
  ONE(asin, asin, u35) ONE(atan, atan, u10) ONE(atan, atan, u35) ONE(cbrt, cbrt, u10)             \
      ONE(cbrt, cbrt, u35) ONE(cos, cos, u10) ONE(cos, cos, u35) ONE(exp, exp, u10)               \
          ONE(exp10, exp10, u10) ONE(exp10, exp10, u35) ONE(exp2, exp2, u10) ONE(exp2, exp2, u35) \
              ONE(expm1, expm1, u10) ONE(ln, log, u10) ONE(ln, log, u35) ONE(log10, log10, u10)   \
                  ONE(log1p, log1p, u10) ONE(log2, log2, u10) ONE(log2, log2, u35)                \
                      ONE(sin, sin, u10) ONE(sin, sin, u35) ONE(sqrt, sqrt, u35)                  \
                          ONE(tan, tan, u10) ONE(tan, tan, u35) TWO(atan2, atan2, u10)            \
                              TWO(atan2, atan2, u35) TWO(hypot, hypot, u35) TWO(pow, pow, u10)

extern "C" {
#define DECLARE_ONE(name, c)                   \
  float_vector MVEC_FLOAT(v, c)(float_vector); \
  double_vector MVEC_DOUBLE(v, c)(double_vector);
#define DECLARE_TWO(name, c)                                  \
  float_vector MVEC_FLOAT(vv, c)(float_vector, float_vector); \
  double_vector MVEC_DOUBLE(vv, c)(double_vector, double_vector);
MVEC_FUNCTIONS(DECLARE_ONE, DECLARE_TWO)
}

constexpr bench::peer all_peers[] = {
#define MVEC_ONE(name, c)                                             \
  {#name, 's', "libmvec", run_one<MVEC_FLOAT(v, c), float>, nullptr}, \
      {#name, 'd', "libmvec", nullptr, run_one<MVEC_DOUBLE(v, c), double>},
#define MVEC_TWO(name, c)                                              \
  {#name, 's', "libmvec", run_two<MVEC_FLOAT(vv, c), float>, nullptr}, \
      {#name, 'd', "libmvec", nullptr, run_two<MVEC_DOUBLE(vv, c), double>},
#define SLEEF_ONE(name, sleef, bound)                                                \
  {#name, 's', "sleef_" #bound, run_one<SLEEF_FLOAT(sleef, bound), float>, nullptr}, \
      {#name, 'd', "sleef_" #bound, nullptr, run_one<SLEEF_DOUBLE(sleef, bound), double>},
#define SLEEF_TWO(name, sleef, bound)                                                \
  {#name, 's', "sleef_" #bound, run_two<SLEEF_FLOAT(sleef, bound), float>, nullptr}, \
      {#name, 'd', "sleef_" #bound, nullptr, run_two<SLEEF_DOUBLE(sleef, bound), double>},
    MVEC_FUNCTIONS(MVEC_ONE, MVEC_TWO) SLEEF_FUNCTIONS(SLEEF_ONE, SLEEF_TWO)};

}  // namespace

std::span<const bench::peer> bench::peers() { return all_peers; }
