// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Kernels that compute whole blocks in another way than the functors do have their bits. A block
/// that holds one argument which they leave to the main path tests nothing, so the arguments are
/// neighbours here.

#include <cstddef>
#include <cstdint>
#include <cstring>
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

class FloatBlocks : public ::testing::TestWithParam<block_kernel> {
 public:
  /// Every `step`-th float, both signs, under every class that this machine is of.
  void expect_bits(std::uint64_t step) {
    using entry = void (*)(std::int32_t, const float*, float*);
    const accuracy::functor* const f = accuracy::find_functor(GetParam().functor);
    ASSERT_NE(f, nullptr);
    const lumen_arr_kernel* const table = ttab(GetParam().name);
    const auto classes = static_cast<int>(arbor::lumen::arr::own_processor_class()) + 1;
    constexpr std::size_t n = 1 << 16;
    std::vector<float> x(n), expected(n), y(n);
    std::vector<std::uint32_t> status(n);
    state_.set_mode(LUMEN_ARR_HA);
    for (std::uint64_t first = 0; first < std::uint64_t{1} << 32; first += n * step) {
      for (std::size_t i = 0; i < n; ++i) {
        const auto pattern = static_cast<std::uint32_t>(first + i * step);
        std::memcpy(&x[i], &pattern, sizeof pattern);
      }
      const void* in[] = {x.data()};
      void* out[] = {expected.data()};
      f->run(in, out, status.data(), n);
      std::uint32_t all = 0;
      for (const std::uint32_t s : status) all |= s;
      for (int c = 1; c < classes; ++c) {
        state_.clear_status();
        reinterpret_cast<entry>(table[c])(n, x.data(), y.data());
        ASSERT_EQ(static_cast<std::uint32_t>(state_.get_status()), all) << "class " << c;
        if (std::memcmp(expected.data(), y.data(), n * sizeof(float)) == 0) continue;
        for (std::size_t i = 0; i < n; ++i)
          ASSERT_EQ(std::memcmp(&expected[i], &y[i], sizeof(float)), 0)
              << "class " << c << ", argument " << std::hexfloat << x[i];
      }
    }
  }

 private:
  arr_state state_;
};

/// The baseline has no fma and no such blocks: it is class 0, left out.
TEST_P(FloatBlocks, HaveTheBitsOfTheFunctor) { expect_bits(251); }

class SlowFloatBlocks : public FloatBlocks {};
TEST_P(SlowFloatBlocks, HaveTheBitsOfTheFunctorForEveryFloat) { expect_bits(1); }

constexpr block_kernel kernels[] = {
    {"sSin", "sin_s_ha_fp64only"},
    {"sCos", "cos_s_ha_fp64only"},
    {"sTan", "tan_s_ha_fp64only"},
};
INSTANTIATE_TEST_SUITE_P(All, FloatBlocks, ::testing::ValuesIn(kernels),
                         [](const auto& tested) { return std::string(tested.param.name); });
INSTANTIATE_TEST_SUITE_P(All, SlowFloatBlocks, ::testing::ValuesIn(kernels),
                         [](const auto& tested) { return std::string(tested.param.name); });

}  // namespace
