// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "host/kernel_binding.hpp"

#include <gtest/gtest.h>

#include <complex>
#include <string>
#include <vector>

#include "host/kernels.hpp"

namespace {

namespace binding = arbor::lumen::vm::detail::cpu::binding;

struct report {
  std::string routine;
  std::int64_t position;
  bool operator==(const report&) const = default;
};
void PrintTo(const report& r, std::ostream* out) { *out << r.routine << " " << r.position; }

/// Notes reports, and the status of the array-math layer behind them.
class Binding : public ::testing::Test {
 public:
  Binding() {
    reports_.clear();
    lumen_serv_set_xerbla([](const char* routine, const void* position, std::int32_t length) {
      reports_.push_back({std::string(routine, static_cast<std::size_t>(length)),
                          *static_cast<const std::int64_t*>(position)});
    });
    binding::arr_state().clear_status();
  }
  ~Binding() override {
    lumen_serv_set_xerbla(nullptr);
    binding::arr_state().clear_status();
  }

 protected:
  void expect(const std::string& routine, std::int64_t position, std::int32_t status) {
    EXPECT_EQ(reports_, (std::vector<report>{{routine, position}}));
    EXPECT_EQ(binding::arr_state().get_status(), status);
    reports_.clear();
    binding::arr_state().clear_status();
  }
  void expect_nothing() {
    EXPECT_TRUE(reports_.empty());
    EXPECT_EQ(binding::arr_state().get_status(), 0);
  }

  static inline std::vector<report> reports_;
  float a_ = 1, b_ = 2, y_ = 3, z_ = 4;
  const float* none_ = nullptr;
  float* no_result_ = nullptr;
};

TEST_F(Binding, ANegativeLengthComesFirstAndHasANameOfItsOwn) {
  binding::vsAbs(-1, none_, no_result_, 2);
  expect("vsAbs_64", 1, LUMEN_ARR_STATUS_BADSIZE);
  binding::vsAbsI(-5, &a_, 1, &y_, 1, 2);
  expect("vsAbsI_64", 1, LUMEN_ARR_STATUS_BADSIZE);
  binding::vdPow(-1, nullptr, nullptr, nullptr, 2);
  expect("vdPow_64", 1, LUMEN_ARR_STATUS_BADSIZE);
  EXPECT_EQ(y_, 3);
}

TEST_F(Binding, NoElementsAreNoCall) {
  binding::vsAbs(0, none_, no_result_, 2);
  binding::vsAbsI(0, none_, 1, no_result_, 1, 2);
  expect_nothing();
}

TEST_F(Binding, ANullPointerIsReportedByItsPosition) {
  binding::vsAbs(1, none_, &y_, 2);
  expect("vsAbs", 2, LUMEN_ARR_STATUS_NULLPTR);
  binding::vsAbs(1, &a_, no_result_, 2);
  expect("vsAbs", 3, LUMEN_ARR_STATUS_NULLPTR);
  binding::vsAbs(1, none_, no_result_, 2);
  expect("vsAbs", 2, LUMEN_ARR_STATUS_NULLPTR);
  binding::vsAbsI(1, &a_, 1, no_result_, 1, 2);
  expect("vsAbsI", 4, LUMEN_ARR_STATUS_NULLPTR);
  binding::vsAdd(1, &a_, none_, &y_, 2);
  expect("vsAdd", 3, LUMEN_ARR_STATUS_NULLPTR);
  binding::vsAddI(1, &a_, 1, none_, 1, &y_, 1, 2);
  expect("vsAddI", 4, LUMEN_ARR_STATUS_NULLPTR);
  binding::vsAddI(1, &a_, 1, &b_, 1, no_result_, 1, 2);
  expect("vsAddI", 6, LUMEN_ARR_STATUS_NULLPTR);
  binding::vsSinCos(1, &a_, &y_, no_result_, 2);
  expect("vsSinCos", 4, LUMEN_ARR_STATUS_NULLPTR);
  binding::vsPowx(1, &a_, 2.0f, no_result_, 2);
  expect("vsPowx", 4, LUMEN_ARR_STATUS_NULLPTR);
  EXPECT_EQ(y_, 3);
}

TEST_F(Binding, AKernelRunsAtTheModeOfTheCallAndGivesTheModeBack) {
  binding::arr_state().set_mode(0x77);
  binding::vsAdd(1, &a_, &b_, &y_, 1);
  EXPECT_EQ(y_, 3);
  EXPECT_EQ(binding::arr_state().set_mode(LUMEN_ARR_HA), 0x77);
  binding::vsPowx(1, &b_, 3.0f, &y_, 2);
  EXPECT_EQ(y_, 8);
  const std::complex<double> u(1, 2), v(3, 4);
  std::complex<double> w;
  binding::vzMul(1, &u, &v, &w, 2);
  EXPECT_EQ(w, std::complex<double>(-5, 10));
  double modulus;
  const std::complex<double> right(3, 4);
  binding::vzAbs(1, &right, &modulus, 2);
  EXPECT_EQ(modulus, 5);
  expect_nothing();
}

/// A threader that only notes the parts of a call.
struct parts {
  struct part {
    std::int32_t n;
    const float* a;
    float* y;
    std::int64_t mode;
    bool operator==(const part&) const = default;
  };
  static inline std::vector<part> all;

  static void linear(lumen_arr_kernel_s_1i_1o, std::int32_t n, const float* a, float* y, float,
                     void*) {
    all.push_back({n, a, y, binding::arr_state().get_mode()});
  }
  static void strided(lumen_arr_kernel_s_1iI_1oI, std::int32_t n, const float* a, std::int64_t inca,
                      float* y, std::int64_t incy, float, void*) {
    EXPECT_EQ(inca, 2);
    EXPECT_EQ(incy, -3);
    all.push_back({n, a, y, binding::arr_state().get_mode()});
  }
};

/// An address that nothing is read from.
template <typename T>
T* address(std::int64_t element) {
  return reinterpret_cast<T*>(std::uintptr_t{0x100000} +
                              sizeof(float) * static_cast<std::uintptr_t>(element));
}

TEST_F(Binding, VeryLongCallsGoInPartsOf31Bits) {
  static binding::kernel_binding linear{"vsAbs", "lumen_arr_kernel_sAbs_ttab",
                                        "lumen_arr_kernel_sAbs_ctab"};
  static binding::kernel_binding strided{"vsAbsI", "lumen_arr_kernel_sAbsI_ttab",
                                         "lumen_arr_kernel_sAbsI_ctab"};
  constexpr std::int64_t longest = 0x7fffffff;
  const auto parts_of = [&](std::int64_t n) {
    parts::all.clear();
    run(linear, &parts::linear, n, 3, address<const float>(0), address<float>(5));
    return parts::all;
  };
  const auto part = [](std::int64_t n, std::int64_t first) {
    return parts::part{static_cast<std::int32_t>(n), address<const float>(first),
                       address<float>(5 + first), 3};
  };
  using list = std::vector<parts::part>;
  EXPECT_EQ(parts_of(1), (list{part(1, 0)}));
  EXPECT_EQ(parts_of(longest), (list{part(longest, 0)}));
  EXPECT_EQ(parts_of(longest + 1), (list{part(longest, 0), part(1, longest)}));
  EXPECT_EQ(parts_of(2 * longest), (list{part(longest, 0), part(longest, longest)}));

  // The increments have no part in where the second part begins.
  parts::all.clear();
  run(strided, &parts::strided, longest + 2, 3, address<const float>(0), std::int64_t{2},
      address<float>(5), std::int64_t{-3});
  EXPECT_EQ(parts::all, (list{part(longest, 0), part(2, longest)}));
}

}  // namespace
