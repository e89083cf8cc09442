// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Scalar bodies in a loop over blocks, as host kernels run them, beside SLEEF's functions of 1 ulp
/// and the C library's vector functions, for the instruction set that this file is compiled for.
///
/// Names are function/type/implementation/number of elements. The arguments are ordinary: none
/// takes the rare path.

#include <benchmark/benchmark.h>
#if defined(__x86_64__) && defined(__AVX2__)
#include <immintrin.h>
#endif
#if defined(LUMEN_BENCH_SLEEF)
#include <sleef.h>
#endif

#include <cstdint>
#include <random>
#include <string>
#include <vector>

#include "scalar/functors.hpp"

namespace scalar = arbor::lumen::vm::detail::gpu::norvane::scalar;

#if defined(__clang__)
#define LUMEN_BLOCK_LOOP _Pragma("clang loop interleave_count(4)")
#else
#define LUMEN_BLOCK_LOOP
#endif

namespace {

constexpr std::int64_t sizes[] = {4096, std::int64_t{1} << 20};

/// Finds the flagged elements of a block and runs the rare path on them.
template <typename F, typename T>
[[gnu::noinline, gnu::cold]] void repair(const T* x, T* y, int n) {
  for (int i = 0; i < n; ++i) F::call(x + i, y + i);
}

/// A block of 512 bytes is computed and its flags ORed; only a block with a flag is looked at
/// again.
template <typename F, typename T>
[[gnu::noinline]] void run_functor(const T* __restrict x, T* __restrict y, std::int64_t n) {
  constexpr int block = 512 / sizeof(T);
  for (std::int64_t first = 0; first < n; first += block) {
    const T* a = x + first;
    T* r = y + first;
    scalar::uint_of<T> flags = 0;
    LUMEN_BLOCK_LOOP
    for (int i = 0; i < block; ++i) {
      const auto result = F::main(a[i]);
      r[i] = result.value;
      flags |= result.rare;
    }
    if (flags != 0) repair<F>(a, r, block);
  }
}

#if defined(__AVX512F__)
using float_vector = __m512;
using double_vector = __m512d;
float_vector load(const float* x) { return _mm512_loadu_ps(x); }
double_vector load(const double* x) { return _mm512_loadu_pd(x); }
void store(float* y, float_vector v) { _mm512_storeu_ps(y, v); }
void store(double* y, double_vector v) { _mm512_storeu_pd(y, v); }
#define SLEEF_FLOAT(name) Sleef_##name##f16_u10avx512f
#define SLEEF_DOUBLE(name) Sleef_##name##d8_u10avx512f
#define MVEC_FLOAT(name) _ZGVeN16v_##name##f
#define MVEC_DOUBLE(name) _ZGVeN8v_##name
#elif defined(__AVX2__)
using float_vector = __m256;
using double_vector = __m256d;
float_vector load(const float* x) { return _mm256_loadu_ps(x); }
double_vector load(const double* x) { return _mm256_loadu_pd(x); }
void store(float* y, float_vector v) { _mm256_storeu_ps(y, v); }
void store(double* y, double_vector v) { _mm256_storeu_pd(y, v); }
#define SLEEF_FLOAT(name) Sleef_##name##f8_u10avx2
#define SLEEF_DOUBLE(name) Sleef_##name##d4_u10avx2
#define MVEC_FLOAT(name) _ZGVdN8v_##name##f
#define MVEC_DOUBLE(name) _ZGVdN4v_##name
#endif

#if defined(MVEC_FLOAT)
/// A function on vectors over an array whose length is a multiple of the vector's.
template <auto f, typename T>
[[gnu::noinline]] void run_vector(const T* __restrict x, T* __restrict y, std::int64_t n) {
  constexpr auto width = static_cast<std::int64_t>(sizeof(load(x)) / sizeof(T));
  for (std::int64_t i = 0; i < n; i += width) store(y + i, f(load(x + i)));
}

#if defined(__GLIBC__)
extern "C" {
#define LUMEN_DECLARE(name)                    \
  float_vector MVEC_FLOAT(name)(float_vector); \
  double_vector MVEC_DOUBLE(name)(double_vector);
LUMEN_DECLARE(exp)
LUMEN_DECLARE(exp2)
LUMEN_DECLARE(exp10)
LUMEN_DECLARE(expm1)
#undef LUMEN_DECLARE
}
#define LUMEN_BENCH_MVEC
#endif
#endif

template <typename T>
using array_function = void (*)(const T*, T*, std::int64_t);

template <typename T>
void add(const std::string& name, array_function<T> f, T low, T high) {
  for (const std::int64_t n : sizes) {
    benchmark::RegisterBenchmark((name + "/" + std::to_string(n)).c_str(),
                                 [=](benchmark::State& state) {
                                   std::mt19937_64 engine(1);
                                   std::uniform_real_distribution<T> values(low, high);
                                   std::vector<T> x(static_cast<std::size_t>(n)), y(x.size());
                                   for (T& v : x) v = values(engine);
                                   for (auto _ : state) {
                                     f(x.data(), y.data(), n);
                                     benchmark::ClobberMemory();
                                   }
                                   state.SetItemsProcessed(state.iterations() * n);
                                 });
  }
}

template <typename Ha, typename La, typename Ep, typename T>
void add_tiers(const std::string& name, T low, T high) {
  add<T>(name + "/ha", run_functor<Ha, T>, low, high);
  add<T>(name + "/la", run_functor<La, T>, low, high);
  add<T>(name + "/ep", run_functor<Ep, T>, low, high);
}

#if defined(LUMEN_BENCH_SLEEF) && defined(SLEEF_FLOAT)
#define LUMEN_ADD_SLEEF(name, s, d)                                          \
  add<float>(#name "/s/sleef", run_vector<SLEEF_FLOAT(name), float>, -s, s); \
  add<double>(#name "/d/sleef", run_vector<SLEEF_DOUBLE(name), double>, -d, d);
#else
#define LUMEN_ADD_SLEEF(name, s, d)
#endif
#if defined(LUMEN_BENCH_MVEC)
#define LUMEN_ADD_MVEC(name, s, d)                                            \
  add<float>(#name "/s/libmvec", run_vector<MVEC_FLOAT(name), float>, -s, s); \
  add<double>(#name "/d/libmvec", run_vector<MVEC_DOUBLE(name), double>, -d, d);
#else
#define LUMEN_ADD_MVEC(name, s, d)
#endif

/// One function with arguments in [-s, s] at float and [-d, d] at double.
#define LUMEN_ADD(name, s, d)                                                                      \
  add_tiers<scalar::name##_s_ha_gen, scalar::name##_s_la_gen, scalar::name##_s_ep_gen>(#name "/s", \
                                                                                       -s, s);     \
  add_tiers<scalar::name##_d_ha_gen, scalar::name##_d_la_gen, scalar::name##_d_ep_gen>(#name "/d", \
                                                                                       -d, d);     \
  LUMEN_ADD_SLEEF(name, s, d)                                                                      \
  LUMEN_ADD_MVEC(name, s, d)

void add_all() {
  LUMEN_ADD(exp, 80.0f, 600.0)
  LUMEN_ADD(exp2, 120.0f, 1000.0)
  LUMEN_ADD(exp10, 35.0f, 300.0)
  LUMEN_ADD(expm1, 80.0f, 600.0)
}

}  // namespace

int main(int argc, char** argv) {
  benchmark::Initialize(&argc, argv);
  if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 2;
  add_all();
  benchmark::RunSpecifiedBenchmarks();
  benchmark::Shutdown();
  return 0;
}
