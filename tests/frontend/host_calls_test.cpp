// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Public calls that the host serves: whole arrays and slices, in place, long ones on threads, and
/// functions that have no body of their own.

#include <gtest/gtest.h>

#include <arbor/lumen/vm.hpp>
#include <cmath>
#include <complex>
#include <cstdint>
#include <limits>
#include <numbers>
#include <sycl/sycl.hpp>
#include <vector>

namespace {

using namespace arbor::lumen;
namespace enums = vm::enums;
using doubles = std::vector<double>;

class HostCalls : public ::testing::Test {
 protected:
  sycl::queue queue_{sycl::cpu_selector_v};

  static void expect_near(double actual, long double exact) {
    EXPECT_NEAR(actual, static_cast<double>(exact), 1e-15 * std::abs(static_cast<double>(exact)));
  }
};

TEST_F(HostCalls, FunctionsWithoutABodyAreThoseOfALibrary) {
  const doubles a = {0.25, 0.5, 1.5, 3};
  doubles y(4);
  const auto expect_as = [&](auto function, auto exact) {
    function(y);
    for (std::size_t i = 0; i < a.size(); ++i) expect_near(y[i], exact(a[i]));
  };
  expect_as([&](doubles& out) { vm::erf(queue_, a, out).wait(); },
            [](long double x) { return std::erf(x); });
  expect_as([&](doubles& out) { vm::tgamma(queue_, a, out).wait(); },
            [](long double x) { return std::tgamma(x); });
  expect_as([&](doubles& out) { vm::tanh(queue_, a, out).wait(); },
            [](long double x) { return std::tanh(x); });
  expect_as([&](doubles& out) { vm::jn(queue_, a, 2.0, out).wait(); },
            [](long double x) { return std::cyl_bessel_j(2.0L, x); });
  expect_as([&](doubles& out) { vm::linearfrac(queue_, a, a, 2.0, 1.0, 1.0, 3.0, out).wait(); },
            [](long double x) { return (2 * x + 1) / (x + 3); });
}

TEST_F(HostCalls, ComplexFunctionsAreThoseOfALibrary) {
  const std::vector<std::complex<double>> a = {{0.5, 0.25}, {-2, 3}};
  std::vector<std::complex<double>> y(2);
  vm::acos(queue_, a, y).wait();
  for (std::size_t i = 0; i < 2; ++i) {
    const auto exact = std::acos(std::complex<long double>(a[i]));
    expect_near(y[i].real(), exact.real());
    expect_near(y[i].imag(), exact.imag());
  }
  doubles angle(2);
  vm::arg(queue_, a, angle).wait();
  expect_near(angle[1], std::arg(std::complex<long double>(a[1])));
  vm::cis(queue_, doubles{0.5, 1}, y).wait();
  expect_near(y[1].imag(), std::sin(1.0L));
}

TEST_F(HostCalls, APairOfKernelsMayOverwriteItsInput) {
  const doubles a = {0.125, 0.25, 1, 2.75};
  doubles sine(4), cosine(4);
  vm::sincospi(queue_, a, sine, cosine).wait();
  expect_near(sine[0], std::sin(0.125L * std::numbers::pi_v<long double>));
  EXPECT_EQ(cosine[2], -1);
  const std::int64_t n = 4;
  doubles first = a, second = a, other(4);
  vm::sincospi(queue_, n, first.data(), first.data(), other.data()).wait();
  EXPECT_EQ(first, sine);
  EXPECT_EQ(other, cosine);
  vm::sincospi(queue_, n, second.data(), other.data(), second.data()).wait();
  EXPECT_EQ(other, sine);
  EXPECT_EQ(second, cosine);
}

TEST_F(HostCalls, AConstantStandsForAnArrayOfIt) {
  const std::int64_t n = 1000;
  doubles a(n), b(n, 2.5), y(n), z(n);
  for (std::size_t i = 0; i < a.size(); ++i) a[i] = 0.01 * static_cast<double>(i + 1);
  vm::powx(queue_, n, a.data(), 2.5, y.data()).wait();
  vm::pow(queue_, n, a.data(), b.data(), z.data()).wait();
  EXPECT_EQ(y, z);
}

TEST_F(HostCalls, LongCallsGiveTheValuesOfShortOnes) {
  const std::size_t n = 300'000;
  doubles a(n), y(n), part(1000), reversed(n);
  for (std::size_t i = 0; i < n; ++i) a[i] = 1e-3 * static_cast<double>(i) - 100;
  vm::sin(queue_, a, y).wait();
  for (std::size_t first = 0; first < n; first += part.size()) {
    vm::sin(queue_, std::span<const double>(&a[first], part.size()), std::span<double>(part))
        .wait();
    for (std::size_t i = 0; i < part.size(); ++i) ASSERT_EQ(part[i], y[first + i]) << first + i;
  }
  const auto size = static_cast<std::int64_t>(n);
  vm::sin(queue_, a, {0, size, 1}, reversed, {size - 1, size, -1}).wait();
  for (std::size_t i = 0; i < n; ++i) ASSERT_EQ(reversed[n - 1 - i], y[i]) << i;
}

TEST_F(HostCalls, ReportNoStatus) {
  const doubles a = {-1, 0, 1};
  doubles y(3);
  std::vector<enums::status> status(3, enums::success);
  vm::clear_status(queue_);
  vm::ln(queue_, a, y, {}, enums::global_status_report,
         vm::error_handler<double>(status.data(), 3, enums::sing, 42.0))
      .wait();
  EXPECT_TRUE(std::isnan(y[0]));
  EXPECT_EQ(y[1], -std::numeric_limits<double>::infinity());
  EXPECT_EQ(status, std::vector<enums::status>(3, enums::success));
  EXPECT_EQ(vm::get_status(queue_), enums::success);
}

}  // namespace
