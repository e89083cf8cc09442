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
#include <tuple>
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

/// A kernel on arrays of `T` beside the functor, under the classes that this machine is of. The
/// baseline, class 0, has no fma: it is slow, and left out where `first_class` is 1.
template <typename T>
class compared_kernel {
 public:
  compared_kernel(const block_kernel& k, std::int64_t mode, int first_class)
      : functor_(accuracy::find_functor(k.functor)),
        table_(ttab(k.name)),
        first_class_(first_class) {
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
    for (int c = first_class_; c < classes; ++c) {
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
  int first_class_;
  arr_state state_;
  std::vector<T> expected_, y_;
  std::vector<std::uint32_t> status_;
};

class FloatBlocks : public ::testing::TestWithParam<block_kernel> {
 public:
  /// Every `step`-th float, both signs.
  void expect_bits(std::uint64_t step, int first_class = 1) {
    compared_kernel<float> kernel(GetParam(), LUMEN_ARR_HA, first_class);
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
TEST_P(FloatBlocks, HaveTheBitsOfTheFunctorInTheBaselineToo) { expect_bits(65521, 0); }

class SlowFloatBlocks : public FloatBlocks {};
TEST_P(SlowFloatBlocks, HaveTheBitsOfTheFunctorForEveryFloat) { expect_bits(1); }

constexpr block_kernel kernels[] = {
    {"sSin", "sin_s_ha_fp64only"}, {"sCos", "cos_s_ha_fp64only"}, {"sTan", "tan_s_ha_fp64only"},
    {"sExp", "exp_s_ha_gen"},      {"sExp2", "exp2_s_ha_gen"},    {"sExp10", "exp10_s_ha_gen"},
    {"sExpm1", "expm1_s_ha_gen"},  {"sLog1p", "log1p_s_ha_gen"},  {"sSqrt", "sqrt_s_ha_gen"},
};
INSTANTIATE_TEST_SUITE_P(All, FloatBlocks, ::testing::ValuesIn(kernels),
                         [](const auto& tested) { return std::string(tested.param.name); });
INSTANTIATE_TEST_SUITE_P(All, SlowFloatBlocks, ::testing::ValuesIn(kernels),
                         [](const auto& tested) { return std::string(tested.param.name); });

/// A family of functors of doubles with its kernel, and the magnitude from which on its results
/// leave the normal numbers.
struct limited_family {
  const char* kernel;
  const char* name;
  double limit;
};
struct named_mode {
  const char* tier;
  std::int64_t mode;
};

class DoubleBlocks : public ::testing::TestWithParam<std::tuple<limited_family, named_mode>> {
 public:
  static std::string functor_name(const ParamType& tested) {
    return std::string(std::get<0>(tested).name) + "_d_" + std::get<1>(tested).tier + "_gen";
  }

 protected:
  const double limit_ = std::get<0>(GetParam()).limit;
  const std::string functor_ = functor_name(GetParam());
  compared_kernel<double> compared_{
      {std::get<0>(GetParam()).kernel, functor_.c_str()}, std::get<1>(GetParam()).mode, 0};
};

TEST_P(DoubleBlocks, HaveTheBitsOfTheFunctorWhereResultsAreNotNormal) {
  std::mt19937_64 generator(1);
  std::vector<double> x(1 << 14);
  // Both sides of the limit, and where all results are zero or infinite; then magnitudes of all
  // kinds.
  for (const double sign : {-1.0, 1.0}) {
    for (const double to : {1.08, 1.2, 1e3}) {
      std::uniform_real_distribution<double> magnitude(0.999 * limit_, to * limit_);
      for (double& element : x) element = sign * magnitude(generator);
      ASSERT_NO_FATAL_FAILURE(compared_.expect_bits(x));
    }
  }
  // Which operand's payload a NaN of two NaNs gets is the compiler's choice.
  for (double& element : x) {
    const std::uint64_t pattern = generator();
    std::memcpy(&element, &pattern, sizeof pattern);
    if (std::isnan(element)) element = limit_;
  }
  ASSERT_NO_FATAL_FAILURE(compared_.expect_bits(x));
}

TEST_P(DoubleBlocks, HaveTheBitsOfTheFunctorForSpecialNumbers) {
  using limits = std::numeric_limits<double>;
  const double special[] = {limits::infinity(),     -limits::infinity(), limits::quiet_NaN(),
                            -limits::quiet_NaN(),   limits::max(),       limits::lowest(),
                            limits::signaling_NaN()};
  for (const double all : special) {
    ASSERT_NO_FATAL_FAILURE(compared_.expect_bits(std::vector<double>(1024, all)));
    // Among arguments of ordinary results.
    std::vector<double> mixed(1024);
    for (std::size_t i = 0; i < mixed.size(); ++i)
      mixed[i] = i % 3 == 0 ? all : limit_ * (static_cast<double>(i % 97) / 64 - 0.75);
    ASSERT_NO_FATAL_FAILURE(compared_.expect_bits(mixed));
  }
}

constexpr limited_family limited_families[] = {{"dExp", "exp", 708.0},
                                               {"dExp2", "exp2", 1022.0},
                                               {"dExp10", "exp10", 307.6},
                                               {"dExpm1", "expm1", 708.0}};
constexpr named_mode named_modes[] = {
    {"ha", LUMEN_ARR_HA}, {"la", LUMEN_ARR_LA}, {"ep", LUMEN_ARR_EP}};
INSTANTIATE_TEST_SUITE_P(All, DoubleBlocks,
                         ::testing::Combine(::testing::ValuesIn(limited_families),
                                            ::testing::ValuesIn(named_modes)),
                         [](const auto& tested) {
                           return DoubleBlocks::functor_name(tested.param);
                         });

TEST(HypotBlocks, HaveTheBitsOfTheFunctorForNumbersOfAllSizes) {
  compared_kernel<double> compared({"dHypot", "hypot_d_ha_gen"}, LUMEN_ARR_HA, 0);
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
