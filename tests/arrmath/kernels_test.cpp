// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Every kernel, under every class of processors that this machine is of, has the bits of the
/// functors' calls.

#include <complex>
#include <cstdint>
#include <cstring>
#include <random>
#include <vector>

#include "functor.hpp"
#include "kernel_list.hpp"
#include "module.hpp"

namespace {

using namespace arbor::lumen::tests;
namespace accuracy = arbor::lumen::accuracy;

struct kernel {
  const char* name;
  const char* shape;
  char in, out;
  const char* functors[3];  // of ha, la, ep
};
void PrintTo(const kernel& k, std::ostream* out) { *out << k.name; }

const kernel all_kernels[] = {
#define LUMEN_ROW(name, shape, in, out, ha, la, ep) \
  {#name, #shape, #in[0], #out[0], {#ha, #la, #ep}},
    LUMEN_KERNELS(LUMEN_ROW)
#undef LUMEN_ROW
};
constexpr std::int64_t modes[] = {LUMEN_ARR_HA, LUMEN_ARR_LA, LUMEN_ARR_EP};

/// Arrays of one call: 1 or 2 inputs, 1 or 2 outputs, a constant as an input that stays the same.
template <typename T, typename U>
struct operands {
  std::vector<T> a, b;
  std::vector<U> y, z;
};

template <typename T, typename U>
void run(const kernel& k, lumen_arr_kernel entry, std::int32_t n, const T* a, const T* b, U* y,
         U* z) {
  const std::string shape = k.shape;
  if (shape == "v11") reinterpret_cast<void (*)(std::int32_t, const T*, U*)>(entry)(n, a, y);
  if (shape == "v12") reinterpret_cast<void (*)(std::int32_t, const T*, U*, U*)>(entry)(n, a, y, z);
  if (shape == "v21")
    reinterpret_cast<void (*)(std::int32_t, const T*, const T*, U*)>(entry)(n, a, b, y);
  if (shape == "v21c")
    reinterpret_cast<void (*)(std::int32_t, const T*, T, U*)>(entry)(n, a, *b, y);
}

template <typename T, typename U>
void run_strided(const kernel& k, lumen_arr_kernel entry, std::int32_t n, const T* a,
                 std::int64_t inca, const T* b, std::int64_t incb, U* y, std::int64_t incy, U* z,
                 std::int64_t incz) {
  using i64 = std::int64_t;
  const std::string shape = k.shape;
  if (shape == "v11")
    reinterpret_cast<void (*)(std::int32_t, const T*, i64, U*, i64)>(entry)(n, a, inca, y, incy);
  if (shape == "v12")
    reinterpret_cast<void (*)(std::int32_t, const T*, i64, U*, i64, U*, i64)>(entry)(n, a, inca, y,
                                                                                     incy, z, incz);
  if (shape == "v21")
    reinterpret_cast<void (*)(std::int32_t, const T*, i64, const T*, i64, U*, i64)>(entry)(
        n, a, inca, b, incb, y, incy);
  if (shape == "v21c")
    reinterpret_cast<void (*)(std::int32_t, const T*, i64, T, U*, i64)>(entry)(n, a, inca, *b, y,
                                                                               incy);
}

/// Numbers of ordinary size, every seventh any pattern at all.
template <typename T>
std::vector<T> draw(std::size_t n, std::uint64_t seed) {
  std::mt19937_64 engine(seed);
  std::vector<T> x(n);
  auto* const bytes = reinterpret_cast<unsigned char*>(x.data());
  constexpr std::size_t part =
      sizeof(T) % 8 == 0 && !std::is_same_v<T, std::complex<float>> ? 8 : 4;
  for (std::size_t at = 0; at < n * sizeof(T); at += part) {
    const std::uint64_t drawn = engine();
    if constexpr (part == 8) {
      double v = std::ldexp(static_cast<double>(static_cast<std::int64_t>(drawn)), -60);
      if (drawn % 7 == 0) std::memcpy(&v, &drawn, 8);
      std::memcpy(bytes + at, &v, 8);
    } else {
      float v = std::ldexp(static_cast<float>(static_cast<std::int32_t>(drawn)), -28);
      if (drawn % 7 == 0) std::memcpy(&v, &drawn, 4);
      std::memcpy(bytes + at, &v, 4);
    }
  }
  return x;
}

/// Equal patterns, or two NaNs: whose sign and payload an instruction takes may differ with the
/// order of its operands.
template <typename R>
bool same(R x, R y) {
  return std::memcmp(&x, &y, sizeof x) == 0 || (x != x && y != y);
}
template <typename R>
bool same(std::complex<R> x, std::complex<R> y) {
  return same(x.real(), y.real()) && same(x.imag(), y.imag());
}

class Kernels : public ::testing::TestWithParam<kernel> {
 public:
  template <typename T, typename U>
  void expect_bits() {
    const kernel& k = GetParam();
    const lumen_arr_kernel* const linear = ttab(k.name);
    const lumen_arr_kernel* const strided = ttab(std::string(k.name) + "I");
    const auto classes = static_cast<int>(arbor::lumen::arr::own_processor_class()) + 1;
    const bool constant = std::string(k.shape) == "v21c";
    for (int tier = 0; tier < 3; ++tier) {
      const accuracy::functor* const f = accuracy::find_functor(k.functors[tier]);
      ASSERT_NE(f, nullptr) << k.functors[tier];
      for (const std::size_t n : {1, 7, 64, 100, 128, 203, 1000}) {
        const std::vector<T> a = draw<T>(n, n), drawn = draw<T>(n, n + 1);
        const std::vector<T> b = constant ? std::vector<T>(n, drawn[0]) : drawn;
        std::vector<U> y(n), z(n);
        std::vector<std::uint32_t> status(n);
        const void* in[] = {a.data(), b.data()};
        void* out[] = {y.data(), z.data()};
        f->run(in, out, status.data(), n);
        std::uint32_t all = 0;
        for (const std::uint32_t s : status) all |= s;
        for (int c = 0; c < classes; ++c) {
          state_.set_mode(modes[tier]);
          state_.clear_status();
          operands<T, U> o{a, b, std::vector<U>(n + 1), std::vector<U>(n + 1)};
          o.y[n] = o.z[n] = U(1);
          run<T, U>(k, linear[c], static_cast<std::int32_t>(n), o.a.data(), o.b.data(), o.y.data(),
                    o.z.data());
          ASSERT_EQ(static_cast<std::uint32_t>(state_.get_status()), all) << n << ", class " << c;
          for (std::size_t i = 0; i < n; ++i) {
            ASSERT_TRUE(same(o.y[i], y[i]) && same(o.z[i], z[i]))
                << k.functors[tier] << ", class " << c << ", element " << i << " of " << n;
          }
          ASSERT_TRUE(o.y[n] == U(1) && o.z[n] == U(1)) << "written behind the end";
          if constexpr (std::is_same_v<T, U>) {
            run<T, U>(k, linear[c], static_cast<std::int32_t>(n), o.a.data(), o.b.data(),
                      o.a.data(), o.z.data());
            for (std::size_t i = 0; i < n; ++i)
              ASSERT_TRUE(same(o.a[i], y[i])) << "in place, class " << c << ", " << i;
          }
          expect_strided<T, U>(strided[c], a, b, y, z);
        }
      }
    }
  }

 private:
  arr_state state_;

  /// The input backwards, the results three apart.
  template <typename T, typename U>
  void expect_strided(lumen_arr_kernel entry, std::vector<T> a, const std::vector<T>& b,
                      const std::vector<U>& y, const std::vector<U>& z) {
    const std::size_t n = a.size();
    std::reverse(a.begin(), a.end());
    std::vector<U> spread_y(3 * n, U(1)), spread_z(2 * n, U(1));
    run_strided<T, U>(GetParam(), entry, static_cast<std::int32_t>(n), &a[n - 1], -1, b.data(), 1,
                      spread_y.data(), 3, spread_z.data(), 2);
    const bool two = std::string(GetParam().shape) == "v12";
    for (std::size_t i = 0; i < n; ++i) {
      ASSERT_TRUE(same(spread_y[3 * i], y[i])) << "with increments, element " << i << " of " << n;
      ASSERT_TRUE(spread_y[3 * i + 1] == U(1) && spread_y[3 * i + 2] == U(1));
      ASSERT_TRUE(!two || (same(spread_z[2 * i], z[i]) && spread_z[2 * i + 1] == U(1))) << i;
    }
  }
};

TEST_P(Kernels, HaveTheBitsOfTheFunctors) {
  const std::string types{GetParam().in, GetParam().out};
  if (types == "ss") expect_bits<float, float>();
  if (types == "dd") expect_bits<double, double>();
  if (types == "cc") expect_bits<std::complex<float>, std::complex<float>>();
  if (types == "zz") expect_bits<std::complex<double>, std::complex<double>>();
  if (types == "cs") expect_bits<std::complex<float>, float>();
  if (types == "zd") expect_bits<std::complex<double>, double>();
  if (types == "sc") expect_bits<float, std::complex<float>>();
  if (types == "dz") expect_bits<double, std::complex<double>>();
}

INSTANTIATE_TEST_SUITE_P(All, Kernels, ::testing::ValuesIn(all_kernels),
                         [](const auto& tested) { return std::string(tested.param.name); });

}  // namespace
