// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "utilities/calls.hpp"

#include <gtest/gtest.h>

#include <arbor/lumen/exception.hpp>
#include <arbor/lumen/vm/queue_state.hpp>
#include <complex>
#include <cstddef>
#include <limits>
#include <span>
#include <string>
#include <sycl/sycl.hpp>
#include <typeinfo>
#include <vector>

#include "dispatch/simulated_devices.hpp"

namespace {

namespace utilities = arbor::lumen::tests::utilities;
using namespace utilities;
using arbor::lumen::invalid_argument;
using arbor::lumen::slice;
using arbor::lumen::tests::device_named;
namespace vm = arbor::lumen::vm;
namespace enums = arbor::lumen::vm::enums;

/// Beside a device that the host serves, one with kernels, and one without double, where the host
/// steps in.
class Utilities : public testing::TestWithParam<const char*> {
 protected:
  void SetUp() override { vm::clear_status(queue_); }
  void TearDown() override { EXPECT_EQ(enums::success, vm::clear_status(queue_)); }

  template <typename Utility, typename T>
  void compare_forms(layout how, std::size_t count, enums::mode mode) {
    for (const auto& form : six_forms<Utility, T>) {
      if (how == layout::cyclic && !form.sliced) continue;
      SCOPED_TRACE(std::string(Utility::name) + " of " + typeid(T).name() + ", " + form.name +
                   ", " + std::to_string(count) + " elements");
      auto o = lay_out<Utility, T>(form, how, count);
      const auto expected = expected_outputs<Utility, T>(o, how, count);
      run(form, queue_, o, mode);
      expect_outputs(expected, o.out);
      ++compared_;
    }
  }
  template <typename Utility>
  void compare_types(layout how, std::size_t count, enums::mode mode) {
    compare_forms<Utility, float>(how, count, mode);
    compare_forms<Utility, double>(how, count, mode);
    compare_forms<Utility, std::complex<float>>(how, count, mode);
    compare_forms<Utility, std::complex<double>>(how, count, mode);
  }
  void compare_all(layout how, std::size_t count, enums::mode mode = enums::not_defined) {
#define LUMEN_COMPARE(utility) compare_types<utilities::utility>(how, count, mode);
    LUMEN_UTILITIES(LUMEN_COMPARE)
#undef LUMEN_COMPARE
  }

  sycl::queue queue_{device_named(GetParam())};
  int compared_ = 0;
};
INSTANTIATE_TEST_SUITE_P(Devices, Utilities, testing::Values("cpu", "jasper", "foreign_nofp64"),
                         [](const auto& param_info) { return std::string(param_info.param); });

TEST_P(Utilities, ServeAllTheOverloads) {
  compare_all(layout::one_size, 111);
  EXPECT_EQ(240, compared_);
}

TEST_P(Utilities, ServeSingleElements) {
  compare_all(layout::one_size, 1);
  EXPECT_EQ(240, compared_);
}

TEST_P(Utilities, ServeEveryAccuracy) {
  for (const enums::mode mode : {enums::ha, enums::la, enums::ep})
    compare_all(layout::one_size, 7, mode);
  EXPECT_EQ(3 * 240, compared_);
}

// On a CPU this runs kernels, where there are any.
TEST_P(Utilities, CycleThroughTheirInputs) {
  compare_all(layout::cyclic, 30, enums::slice_cyclic);
  compare_all(layout::cyclic, 24, enums::slice_cyclic);
  EXPECT_EQ(2 * 120, compared_);
}

template <typename T>
class Arrays {
 public:
  explicit Arrays(const std::string& device) : queue_(device_named(device)) {}

  /// copy1 in place, whole and from one part of an array to another.
  void copy_in_place() {
    for (const auto& form : six_forms<copy1, T>) {
      SCOPED_TRACE(form.name);
      const std::vector<T> before = values(12);
      operands<copy1::shape, T> o;
      o.n = 12;
      o.in[0].part = slice{0, 6, 1};
      o.out[0].part = slice{11, 6, -1};
      o.in[0].data = before;
      auto& array = o.in[0].data;
      std::vector<T> expected = before;
      if (form.sliced) {
        for (std::size_t i = 0; i < 6; ++i) expected[11 - i] = before[i];
      }
      if (form.where == memory::buffer) {
        sycl::buffer<T, 1> shared(array.data(), sycl::range<1>(array.size()));
        if (form.sliced)
          vm::detail::copy1(queue_, shared, o.in[0].part, shared, o.out[0].part);
        else
          vm::detail::copy1(queue_, 12, shared, shared);
      } else if (form.where == memory::pointer) {
        T* const a = array.data();
        if (form.sliced)
          vm::detail::copy1(queue_, a, o.in[0].part, a, o.out[0].part).wait();
        else
          vm::detail::copy1(queue_, 12, a, a).wait();
      } else {
        const std::span<T> a(array);
        if (form.sliced)
          vm::detail::copy1(queue_, a, o.in[0].part, a, o.out[0].part).wait();
        else
          vm::detail::copy1(queue_, a, a).wait();
      }
      for (std::size_t i = 0; i < 12; ++i)
        EXPECT_TRUE(same_bits(expected[i], array[i])) << i << ": " << array[i];
    }
  }

 private:
  static std::vector<T> values(std::size_t count) {
    std::vector<T> list;
    for (std::size_t i = 0; i < count; ++i) list.push_back(argument<copy1, T>(i, 0));
    return list;
  }
  sycl::queue queue_;
};

TEST_P(Utilities, CopyInPlace) {
  Arrays<float>(GetParam()).copy_in_place();
  Arrays<double>(GetParam()).copy_in_place();
  Arrays<std::complex<float>>(GetParam()).copy_in_place();
  Arrays<std::complex<double>>(GetParam()).copy_in_place();
}

/// Calls with nothing to do leave their outputs alone. A buffer call without a count works on the
/// whole buffer.
template <typename Utility, typename T>
void expect_nothing_done(sycl::queue& queue) {
  for (const auto& form : six_forms<Utility, T>) {
    SCOPED_TRACE(std::string(Utility::name) + ", " + form.name);
    auto o = lay_out<Utility, T>(form, layout::one_size, 0);
    o.for_each_array([](operand<T>& array) { array.part = slice{0, 0, 1}; });
    const auto before = o.out;
    if (form.sliced) {
      EXPECT_THROW(run(form, queue, o, enums::not_defined), invalid_argument);
      o.for_each_array([](operand<T>& array) { array.buffer.reset(); });
      run(form, queue, o, enums::badarg_quiet);
      expect_outputs(before, o.out);
    } else if (form.where == memory::buffer) {
      const auto whole = expected_outputs<Utility, T>(o, layout::one_size, 3);
      run(form, queue, o, enums::not_defined);
      expect_outputs(whole, o.out);
    } else {
      run(form, queue, o, enums::not_defined);
      expect_outputs(before, o.out);
    }
  }
}

TEST_P(Utilities, OfNoElementsDoNothing) {
#define LUMEN_EXPECT(utility)                                           \
  expect_nothing_done<utilities::utility, float>(queue_);               \
  expect_nothing_done<utilities::utility, double>(queue_);              \
  expect_nothing_done<utilities::utility, std::complex<float>>(queue_); \
  expect_nothing_done<utilities::utility, std::complex<double>>(queue_);
  LUMEN_UTILITIES(LUMEN_EXPECT)
#undef LUMEN_EXPECT
}

TEST_P(Utilities, RejectBadArguments) {
  float y[4] = {1, 2, 3, 4};
  const float a[4] = {5, 6, 7, 8};
  EXPECT_THROW(vm::detail::assign(queue_, -1, 9.0f, y), invalid_argument);
  EXPECT_THROW(vm::detail::iota(queue_, -1, 0.0f, 1.0f, y), invalid_argument);
  EXPECT_THROW(vm::detail::copy1(queue_, a, slice{0, 4, 1}, y, slice{0, 3, 1}), invalid_argument);
  sycl::buffer<float, 1> four{sycl::range<1>(4)};
  EXPECT_THROW(vm::detail::assign(queue_, 5, 9.0f, four), invalid_argument);
  EXPECT_EQ(3.0f, y[2]);
  vm::detail::copy1(queue_, a, slice{0, 4, 1}, y, slice{0, 3, 1}, {}, enums::slice_minimum).wait();
  EXPECT_EQ(7.0f, y[2]);
  EXPECT_EQ(4.0f, y[3]);
}

/// The status of fma over arrays with one NaN, as it arrives on the queue. The outputs keep what
/// they held.
template <typename T>
enums::status status_of_fma(sycl::queue& queue, T nan, enums::mode mode) {
  const std::vector<T> a{T(1), nan, T(3)}, one{T(1)};
  std::vector<T> y(3, untouched<T>());
  const slice all{0, 3, 1}, first{0, 1, 1}, reversed{2, 3, -1};
  const bool cyclic = (mode & enums::slice_cyclic) != 0;
  mode |= enums::global_status_report;
  if (cyclic)
    vm::detail::fma(queue, a, all, one, first, one, first, y, reversed, {}, mode).wait();
  else
    vm::detail::fma(queue, a, all, a, all, a, all, y, reversed, {}, mode).wait();
  for (const T element : y) EXPECT_TRUE(same_bits(untouched<T>(), element)) << element;
  const enums::status sliced = vm::clear_status(queue);
  if (!cyclic) {
    vm::detail::fma(queue, a, a, a, y, {}, mode).wait();
    for (const T element : y) EXPECT_TRUE(same_bits(untouched<T>(), element)) << element;
    EXPECT_EQ(sliced, vm::clear_status(queue));
    vm::detail::fma(queue, 1, a.data(), a.data(), a.data(), y.data(), {}, mode).wait();
    EXPECT_EQ(enums::success, vm::clear_status(queue)) << "of an element that is no NaN";
  }
  return sliced;
}

// The status tells kernels from host loops, which report none.
TEST_P(Utilities, ReportTheNaNsOfFmaWhereKernelsRun) {
  const std::string device = GetParam();
  const double nan = std::numeric_limits<double>::quiet_NaN();
  const auto expect = [&](bool kernels, enums::mode mode) {
    const enums::status expected = kernels ? enums::errdom : enums::success;
    const auto single = static_cast<float>(nan);
    EXPECT_EQ(expected, status_of_fma<float>(queue_, single, mode));
    EXPECT_EQ(expected, status_of_fma<double>(queue_, nan, mode));
    EXPECT_EQ(expected, status_of_fma<std::complex<float>>(queue_, {1, single}, mode));
    EXPECT_EQ(expected, status_of_fma<std::complex<double>>(queue_, {nan, 1}, mode));
  };
  expect(device == "jasper", enums::slice_normal);
  expect(device != "foreign_nofp64", enums::slice_cyclic);
}

}  // namespace
