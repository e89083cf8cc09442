// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "call/input.hpp"

#include <gtest/gtest.h>

#include <complex>
#include <cstdint>
#include <cstring>
#include <limits>
#include <stdexcept>
#include <string>
#include <sycl/sycl.hpp>
#include <type_traits>
#include <utility>
#include <vector>

#include "arbor/lumen/exception.hpp"

namespace {

using namespace arbor::lumen::vm::detail;
using arbor::lumen::invalid_argument;
using arbor::lumen::slice;
using complex_float = std::complex<float>;
using complex_double = std::complex<double>;
using real_record = input::usm::linear<shape::v21, float, float>;

constexpr const char* too_short =
    "arbor::lumen::vm::add: invalid argument: insufficient length of arguments";
constexpr const char* negative = "arbor::lumen::vm::add: invalid argument: negative length";

template <typename Error, typename Action>
void expect_thrown(const char* text, Action action) {
  try {
    action();
    ADD_FAILURE() << "nothing was thrown, expected: " << text;
  } catch (const Error& error) {
    EXPECT_STREQ(text, error.what());
  }
}

class Input : public testing::Test {
 protected:
  real_record make(std::int64_t n, std::vector<std::int64_t> in, std::vector<std::int64_t> out) {
    real_record record;
    record.name = "add";
    record.queue = &queue_;
    record.n = n;
    record.in_lengths = std::move(in);
    record.out_lengths = std::move(out);
    return record;
  }
  void expect_accepted(const input::vxx& record) {
    EXPECT_TRUE(record.check(true));
    EXPECT_TRUE(record.check(false));
  }
  void expect_rejected(const input::vxx& record, const char* text) {
    EXPECT_FALSE(record.check(false));
    expect_thrown<invalid_argument>(text, [&] { record.check(true); });
  }

  sycl::queue queue_;
};

TEST_F(Input, StartsEmpty) {
  const real_record record;
  EXPECT_EQ("", record.name);
  EXPECT_EQ(nullptr, record.queue);
  EXPECT_EQ(0, record.n);
  EXPECT_EQ(0u, record.mode);
  EXPECT_TRUE(record.depends.empty());
  EXPECT_FALSE(record.has_slices());
  EXPECT_FALSE(record.handler.enabled);
}

TEST_F(Input, CheckThrowsForANullQueueUnderBothPolicies) {
  real_record record = make(1, {}, {});
  record.queue = nullptr;
  const char* text = "ArborLumen::vm::detail::input::add: q is nullptr";
  expect_thrown<std::logic_error>(text, [&] { record.check(true); });
  expect_thrown<std::logic_error>(text, [&] { record.check(false); });
  record.n = -1;  // the queue is looked at first
  expect_thrown<std::logic_error>(text, [&] { record.check(false); });
}

TEST_F(Input, CheckTakesAnyCountWithoutLengths) {
  for (const std::int64_t n : {std::int64_t{0}, std::int64_t{1}, std::int64_t{1} << 40})
    expect_accepted(make(n, {}, {}));
}

TEST_F(Input, CheckComparesTheCountWithTheShortestLength) {
  expect_accepted(make(8, {8, 9}, {10}));
  expect_accepted(make(7, {8, 9}, {10}));
  expect_accepted(make(0, {8, 9}, {10}));
  expect_rejected(make(9, {8, 9}, {10}), too_short);
  expect_rejected(make(9, {10, 8}, {10}), too_short);
  expect_rejected(make(9, {10, 10}, {8}), too_short);
  expect_rejected(make(10, {8, 8}, {8}), too_short);
  expect_rejected(make(9, {}, {8}), too_short);
}

// A shortest length of 0 stands for "unknown" too, so it is no limit.
TEST_F(Input, CheckTakesAnyCountBesideALengthOfZero) {
  expect_accepted(make(10, {0, 20}, {20}));
  expect_accepted(make(10, {20, 20}, {0}));
}

TEST_F(Input, CheckRejectsANegativeCount) {
  for (const std::int64_t n : {std::int64_t{-1}, std::numeric_limits<std::int64_t>::min()}) {
    expect_rejected(make(n, {}, {}), negative);
    expect_rejected(make(n, {8, 8}, {8}), negative);
    expect_rejected(make(n, {0}, {}), negative);
  }
}

TEST_F(Input, BaseCheckLeavesNegativeCountsToTheTypedOne) {
  const real_record record = make(-1, {8, 8}, {8});
  EXPECT_TRUE(record.input::vxx::check(true));
  EXPECT_TRUE(record.input::vxx::check(false));
}

TEST_F(Input, EffectiveCountIsTheGivenOne) {
  EXPECT_EQ(7, make(7, {}, {}).effective_count());
  EXPECT_EQ(7, make(7, {8, 9}, {10}).effective_count());
  EXPECT_EQ(0, make(-7, {8, 9}, {10}).effective_count());
  real_record sliced = make(7, {}, {});
  sliced.in_slices.push_back(slice{0, 3, 1});
  EXPECT_EQ(7, sliced.effective_count());
}

TEST_F(Input, EffectiveCountIsTheShortestLengthWithoutOne) {
  EXPECT_EQ(0, make(0, {}, {}).effective_count());
  EXPECT_EQ(5, make(0, {5, 7}, {9}).effective_count());
  EXPECT_EQ(5, make(0, {7, 5}, {9}).effective_count());
  EXPECT_EQ(5, make(0, {7, 9}, {5}).effective_count());
  EXPECT_EQ(5, make(0, {}, {5}).effective_count());
  EXPECT_EQ(0, make(0, {5, 0}, {9}).effective_count());
}

TEST_F(Input, EffectiveCountIsLeftToSlices) {
  real_record in = make(0, {5, 7}, {9});
  in.in_slices.push_back(slice{0, 3, 1});
  EXPECT_TRUE(in.has_slices());
  EXPECT_EQ(0, in.effective_count());
  real_record out = make(0, {5, 7}, {9});
  out.out_slices.push_back(slice{0, 3, 1});
  EXPECT_TRUE(out.has_slices());
  EXPECT_EQ(0, out.effective_count());
}

TEST_F(Input, GivesOperandsByIndex) {
  real_record record = make(2, {}, {});
  const float a[1] = {}, b[1] = {};
  float y[1] = {};
  sycl::buffer<float, 1> buffer_a{sycl::range<1>(3)}, buffer_y{sycl::range<1>(4)};
  record.in_pointers = {a, b};
  record.out_pointers = {y};
  record.in_buffers = {&buffer_a};
  record.out_buffers = {&buffer_y};
  record.constants = {2.5f};
  EXPECT_EQ(a, record.in_pointer(0));
  EXPECT_EQ(b, record.in_pointer(1));
  EXPECT_EQ(y, record.out_pointer(0));
  EXPECT_EQ(&buffer_a, &record.in_buffer(0));
  EXPECT_EQ(&buffer_y, &record.out_buffer(0));
  EXPECT_EQ(2.5f, record.constant(0));
}

TEST_F(Input, IndicesBeyondTheOperandsThrow) {
  real_record record = make(1, {}, {});
  const float a[1] = {};
  record.in_pointers = {a};
  const char* pointers = "ArborLumen::vm::detail::input::add: usm: index of input is too large";
  expect_thrown<std::logic_error>(pointers, [&] { record.in_pointer(1); });
  // Outputs are called inputs as well.
  expect_thrown<std::logic_error>(pointers, [&] { record.out_pointer(0); });
  expect_thrown<std::logic_error>(
      "ArborLumen::vm::detail::input::add: buffer: index of input is too large",
      [&] { record.in_buffer(0); });
  expect_thrown<std::logic_error>(
      "ArborLumen::vm::detail::input::add: buffer: index of output is too large",
      [&] { record.out_buffer(0); });
  expect_thrown<std::logic_error>(
      "ArborLumen::vm::detail::input::add: index of constant is too large",
      [&] { record.constant(0); });
}

TEST_F(Input, RecordsOfUnknownPrecisionHaveTheWholeField) {
  const input::vxx record;
  EXPECT_EQ(0xff00000000u, record.precision());
}

template <typename T, typename U>
std::uint64_t precision() {
  return input::usm::linear<shape::v11, T, U>().precision();
}

TEST_F(Input, PrecisionIsThatOfTheElements) {
  EXPECT_EQ(0x100000000u, (precision<sycl::half, sycl::half>()));
  EXPECT_EQ(0x400000000u, (precision<float, float>()));
  EXPECT_EQ(0x800000000u, (precision<double, double>()));
  EXPECT_EQ(0x1000000000u, (precision<complex_float, complex_float>()));
  EXPECT_EQ(0x1800000000u, (precision<complex_double, complex_double>()));
}

// Rows of functions between real and complex stand at the complex type, whichever side it is on.
TEST_F(Input, PrecisionOfMixedPairsIsTheComplexOne) {
  EXPECT_EQ(0x1000000000u, (precision<complex_float, float>()));
  EXPECT_EQ(0x1800000000u, (precision<complex_double, double>()));
  EXPECT_EQ(0x1000000000u, (precision<float, complex_float>()));
  EXPECT_EQ(0x1800000000u, (precision<double, complex_double>()));
}

TEST_F(Input, FormsAndShapesAreClassesOfTheirOwn) {
  using namespace input;
  const real_record record;
  const vxx& base = record;
  EXPECT_NE(nullptr, (dynamic_cast<const typed_vxx<float, float>*>(&base)));
  EXPECT_EQ(nullptr, (dynamic_cast<const typed_vxx<double, double>*>(&base)));
  EXPECT_NE(nullptr, (dynamic_cast<const usm::linear<shape::v21, float, float>*>(&base)));
  EXPECT_EQ(nullptr, (dynamic_cast<const usm::strided<shape::v21, float, float>*>(&base)));
  EXPECT_EQ(nullptr, (dynamic_cast<const buffer::linear<shape::v21, float, float>*>(&base)));
  EXPECT_EQ(nullptr, (dynamic_cast<const buffer::strided<shape::v21, float, float>*>(&base)));
  EXPECT_EQ(nullptr, (dynamic_cast<const usm::linear<shape::v11, float, float>*>(&base)));
  static_assert(sizeof(record) == sizeof(typed_vxx<float, float>), "forms add no fields");
}

TEST_F(Input, FieldsStandInTheirOrder) {
  const real_record r;
  const std::vector<const void*> fields{
      &r.name,        &r.queue,      &r.n,           &r.mode,         &r.depends,
      &r.in_slices,   &r.out_slices, &r.in_lengths,  &r.out_lengths,  &r.in_buffers,
      &r.in_pointers, &r.constants,  &r.out_buffers, &r.out_pointers, &r.handler};
  for (std::size_t i = 1; i < fields.size(); ++i) EXPECT_LT(fields[i - 1], fields[i]) << i;
}

#if defined(__x86_64__) && defined(__GNUC__)
/// The slot of a virtual member function, which the common C++ ABI keeps in pointers to members as
/// an offset in bytes plus one.
template <typename Member>
std::size_t slot_of(Member member) {
  std::uint64_t word;
  std::memcpy(&word, &member, sizeof word);
  return static_cast<std::size_t>((word - 1) / sizeof(void*));
}

// The destructor has the two slots before them.
TEST_F(Input, VirtualOperationsStandInTheirOrder) {
  EXPECT_EQ(2u, slot_of(&input::vxx::check));
  EXPECT_EQ(3u, slot_of(&input::vxx::precision));
}
#endif

TEST_F(Input, HandlerOfACallIsACopy) {
  static_assert(sizeof(error_handler_x<double>) == sizeof(error_handler<double>));
  namespace enums = arbor::lumen::vm::enums;
  enums::status cell{};
  const error_handler<double> callers(&cell, 1, enums::sing, 3.0, true);
  error_handler_x<double> own;
  own = callers;
  EXPECT_TRUE(own.enabled);
  EXPECT_EQ(&cell, own.status_array);
  EXPECT_EQ(1, own.length);
  EXPECT_EQ(2u, own.status_to_fix);
  EXPECT_EQ(3.0, own.fixup_value);
  EXPECT_TRUE(own.copy_sign);
  {
    sycl::buffer<enums::status, 1> shared = own.status_buffer;
    sycl::host_accessor cells(shared);
    cells[0] = enums::underflow;
  }
  sycl::buffer<enums::status, 1> seen = callers.status_buffer;
  sycl::host_accessor cells(seen);
  EXPECT_EQ(enums::underflow, cells[0]);
}

TEST_F(Input, NothingIsTakenOfAHandlerThatIsNotEnabled) {
  error_handler<double> callers(3.0, arbor::lumen::vm::enums::sing);
  error_handler_x<double> own(callers);
  EXPECT_TRUE(own.enabled);
  callers.enabled = false;
  own = callers;
  EXPECT_FALSE(own.enabled);
  const error_handler_x<double> other(callers);
  EXPECT_FALSE(other.enabled);
  EXPECT_FALSE(other.status_buffer == callers.status_buffer);
}

}  // namespace
