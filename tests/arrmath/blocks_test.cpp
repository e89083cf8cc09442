// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Kernels that compute whole blocks in another way than the functors do, or the flagged elements
/// of a block together, have the functors' bits and status. A block with few such elements tests
/// nothing, so the arguments are neighbours here.

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <limits>
#include <random>
#include <string>
#include <vector>

#include "functor.hpp"
#include "module.hpp"

namespace {

using namespace arbor::lumen::tests;
namespace accuracy = arbor::lumen::accuracy;

struct block_kernel {
  const char* name;
  const char* functor;
};
void PrintTo(const block_kernel& k, std::ostream* out) { *out << k.name; }

/// A kernel on arrays of `T` beside the functor, under every class that this machine is of but the
/// baseline, which has no fma and no such blocks.
template <typename T>
class compared_kernel {
 public:
  compared_kernel(const block_kernel& k, std::int64_t mode)
      : functor_(accuracy::find_functor(k.functor)), table_(ttab(k.name)) {
    state_.set_mode(mode);
  }

  void expect_bits(const std::vector<T>& x) {
    const void* in[] = {x.data()};
    compare(x, in, [&](lumen_arr_kernel kernel, std::int32_t n) {
      reinterpret_cast<void (*)(std::int32_t, const T*, T*)>(kernel)(n, x.data(), y_.data());
    });
  }

  void expect_bits(const std::vector<T>& a, const std::vector<T>& b) {
    const void* in[] = {a.data(), b.data()};
    compare(a, in, [&](lumen_arr_kernel kernel, std::int32_t n) {
      reinterpret_cast<void (*)(std::int32_t, const T*, const T*, T*)>(kernel)(n, a.data(),
                                                                               b.data(), y_.data());
    });
  }

 private:
  template <typename Run>
  void compare(const std::vector<T>& x, const void* const* in, Run run) {
    ASSERT_NE(functor_, nullptr);
    const std::size_t n = x.size();
    expected_.resize(n);
    y_.resize(n);
    status_.resize(n);
    void* out[] = {expected_.data()};
    functor_->run(in, out, status_.data(), n);
    std::uint32_t all = 0;
    for (const std::uint32_t s : status_) all |= s;
    const auto classes = static_cast<int>(arbor::lumen::arr::own_processor_class()) + 1;
    for (int c = 1; c < classes; ++c) {
      state_.clear_status();
      run(table_[c], static_cast<std::int32_t>(n));
      ASSERT_EQ(static_cast<std::uint32_t>(state_.get_status()), all) << "class " << c;
      if (std::memcmp(expected_.data(), y_.data(), n * sizeof(T)) == 0) continue;
      for (std::size_t i = 0; i < n; ++i)
        ASSERT_EQ(std::memcmp(&expected_[i], &y_[i], sizeof(T)), 0)
            << "class " << c << ", argument " << std::hexfloat << x[i];
    }
  }

  const accuracy::functor* functor_;
  const lumen_arr_kernel* table_;
  arr_state state_;
  std::vector<T> expected_, y_;
  std::vector<std::uint32_t> status_;
};

class FloatBlocks : public ::testing::TestWithParam<block_kernel> {
 public:
  /// Every `step`-th float, both signs.
  void expect_bits(std::uint64_t step) {
    compared_kernel<float> kernel(GetParam(), LUMEN_ARR_HA);
    constexpr std::size_t n = 1 << 16;
    std::vector<float> x(n);
    for (std::uint64_t first = 0; first < std::uint64_t{1} << 32; first += n * step) {
      for (std::size_t i = 0; i < n; ++i) {
        const auto pattern = static_cast<std::uint32_t>(first + i * step);
        std::memcpy(&x[i], &pattern, sizeof pattern);
      }
      ASSERT_NO_FATAL_FAILURE(kernel.expect_bits(x));
    }
  }
};

TEST_P(FloatBlocks, HaveTheBitsOfTheFunctor) { expect_bits(251); }

class SlowFloatBlocks : public FloatBlocks {};
TEST_P(SlowFloatBlocks, HaveTheBitsOfTheFunctorForEveryFloat) { expect_bits(1); }

constexpr block_kernel kernels[] = {
    {"sSin", "sin_s_ha_fp64only"}, {"sCos", "cos_s_ha_fp64only"}, {"sTan", "tan_s_ha_fp64only"},
    {"sExp", "exp_s_ha_gen"},      {"sExp2", "exp2_s_ha_gen"},    {"sExp10", "exp10_s_ha_gen"},
    {"sExpm1", "expm1_s_ha_gen"},
};
INSTANTIATE_TEST_SUITE_P(All, FloatBlocks, ::testing::ValuesIn(kernels),
                         [](const auto& tested) { return std::string(tested.param.name); });
INSTANTIATE_TEST_SUITE_P(All, SlowFloatBlocks, ::testing::ValuesIn(kernels),
                         [](const auto& tested) { return std::string(tested.param.name); });

/// A kernel on doubles with the magnitude from which on its results leave the normal numbers.
struct limited_kernel {
  block_kernel kernel;
  std::int64_t mode;
  double limit;
};
void PrintTo(const limited_kernel& k, std::ostream* out) { PrintTo(k.kernel, out); }

class DoubleBlocks : public ::testing::TestWithParam<limited_kernel> {};

TEST_P(DoubleBlocks, HaveTheBitsOfTheFunctorWhereResultsAreNotNormal) {
  const auto& [kernel, mode, limit] = GetParam();
  compared_kernel<double> compared(kernel, mode);
  std::mt19937_64 generator(1);
  std::vector<double> x(1 << 14);
  // Both sides of the limit, and where all results are zero or infinite; then magnitudes of all
  // kinds.
  for (const double sign : {-1.0, 1.0}) {
    for (const double to : {1.08, 1.2, 1e3}) {
      std::uniform_real_distribution<double> magnitude(0.999 * limit, to * limit);
      for (double& element : x) element = sign * magnitude(generator);
      ASSERT_NO_FATAL_FAILURE(compared.expect_bits(x));
    }
  }
  // Which operand's payload a NaN of two NaNs gets is the compiler's choice.
  for (double& element : x) {
    const std::uint64_t pattern = generator();
    std::memcpy(&element, &pattern, sizeof pattern);
    if (std::isnan(element)) element = limit;
  }
  ASSERT_NO_FATAL_FAILURE(compared.expect_bits(x));
}

TEST_P(DoubleBlocks, HaveTheBitsOfTheFunctorForSpecialNumbers) {
  const auto& [kernel, mode, limit] = GetParam();
  compared_kernel<double> compared(kernel, mode);
  using limits = std::numeric_limits<double>;
  const double special[] = {limits::infinity(),     -limits::infinity(), limits::quiet_NaN(),
                            -limits::quiet_NaN(),   limits::max(),       limits::lowest(),
                            limits::signaling_NaN()};
  for (const double all : special) {
    ASSERT_NO_FATAL_FAILURE(compared.expect_bits(std::vector<double>(1024, all)));
    // Among arguments of ordinary results.
    std::vector<double> mixed(1024);
    for (std::size_t i = 0; i < mixed.size(); ++i)
      mixed[i] = i % 3 == 0 ? all : limit * (static_cast<double>(i % 97) / 64 - 0.75);
    ASSERT_NO_FATAL_FAILURE(compared.expect_bits(mixed));
  }
}

constexpr limited_kernel limited_kernels[] = {
    {{"dExp", "exp_d_ha_gen"}, LUMEN_ARR_HA, 708.0},
    {{"dExp", "exp_d_la_gen"}, LUMEN_ARR_LA, 708.0},
    {{"dExp", "exp_d_ep_gen"}, LUMEN_ARR_EP, 708.0},
    {{"dExp2", "exp2_d_ha_gen"}, LUMEN_ARR_HA, 1022.0},
    {{"dExp2", "exp2_d_la_gen"}, LUMEN_ARR_LA, 1022.0},
    {{"dExp2", "exp2_d_ep_gen"}, LUMEN_ARR_EP, 1022.0},
    {{"dExp10", "exp10_d_ha_gen"}, LUMEN_ARR_HA, 307.6},
    {{"dExp10", "exp10_d_la_gen"}, LUMEN_ARR_LA, 307.6},
    {{"dExp10", "exp10_d_ep_gen"}, LUMEN_ARR_EP, 307.6},
    {{"dExpm1", "expm1_d_ha_gen"}, LUMEN_ARR_HA, 708.0},
    {{"dExpm1", "expm1_d_la_gen"}, LUMEN_ARR_LA, 708.0},
    {{"dExpm1", "expm1_d_ep_gen"}, LUMEN_ARR_EP, 708.0},
};
INSTANTIATE_TEST_SUITE_P(All, DoubleBlocks, ::testing::ValuesIn(limited_kernels),
                         [](const auto& tested) {
                           return std::string(tested.param.kernel.functor);
                         });

TEST(HypotBlocks, HaveTheBitsOfTheFunctorForNumbersOfAllSizes) {
  compared_kernel<double> compared({"dHypot", "hypot_d_ha_gen"}, LUMEN_ARR_HA);
  std::mt19937_64 generator(1);
  std::vector<double> a(1 << 14), b(a.size());
  std::uniform_real_distribution<double> fraction(-2, 2);
  const auto fill = [&](std::vector<double>& v, int from, int to) {
    std::uniform_int_distribution<int> exponent(from, to);
    for (double& element : v) element = std::ldexp(fraction(generator), exponent(generator));
  };
  // Large ones and small ones, of about one size and of others.
  for (const int centre : {-1080, -1021, -700, -40, 40, 700, 1020, 1023}) {
    for (const int spread : {1, 60, 250}) {
      fill(a, centre - spread, centre);
      fill(b, centre - spread, centre);
      ASSERT_NO_FATAL_FAILURE(compared.expect_bits(a, b));
      b.assign(b.size(), 0.0);
      ASSERT_NO_FATAL_FAILURE(compared.expect_bits(a, b));
      ASSERT_NO_FATAL_FAILURE(compared.expect_bits(b, a));
    }
  }
  for (std::vector<double>* v : {&a, &b}) {
    for (double& element : *v) {
      const std::uint64_t pattern = generator();
      std::memcpy(&element, &pattern, sizeof pattern);
    }
  }
  ASSERT_NO_FATAL_FAILURE(compared.expect_bits(a, b));
}

}  // namespace
