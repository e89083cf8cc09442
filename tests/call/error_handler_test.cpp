// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "arbor/lumen/vm/error_handler.hpp"

#include <gtest/gtest.h>

#include <complex>
#include <cstdint>
#include <sycl/sycl.hpp>
#include <type_traits>
#include <utility>
#include <vector>

#include "arbor/lumen/exception.hpp"

namespace {

namespace enums = arbor::lumen::vm::enums;
using arbor::lumen::invalid_argument;
using arbor::lumen::vm::error_handler;
using arbor::lumen::vm::detail::error_handler_base;

static_assert(std::is_polymorphic_v<error_handler_base>);
static_assert(std::has_virtual_destructor_v<error_handler_base>);
static_assert(std::is_default_constructible_v<error_handler_base>);
static_assert(std::is_copy_constructible_v<error_handler_base>);
static_assert(std::is_copy_assignable_v<error_handler_base>);

template <typename T>
class ErrorHandler : public testing::Test {};
using element_types =
    testing::Types<sycl::half, float, double, std::complex<float>, std::complex<double>>;
TYPED_TEST_SUITE(ErrorHandler, element_types);

/// Whether two handles are of one buffer: what is written through one is read through the other.
bool share(sycl::buffer<enums::status, 1> a, sycl::buffer<enums::status, 1> b) {
  sycl::host_accessor{b}[0] = enums::success;
  sycl::host_accessor{a}[0] = enums::overflow;
  return sycl::host_accessor{b}[0] == enums::overflow;
}

template <typename Construct>
void expect_rejected(const char* text, Construct construct) {
  try {
    construct();
    ADD_FAILURE() << "accepted, expected: " << text;
  } catch (const invalid_argument& error) {
    EXPECT_STREQ(text, error.what());
  }
}

TYPED_TEST(ErrorHandler, IsAHandlerBase) {
  static_assert(std::is_base_of_v<error_handler_base, error_handler<TypeParam>>);
  static_assert(std::has_virtual_destructor_v<error_handler<TypeParam>>);
  static_assert(std::is_copy_constructible_v<error_handler<TypeParam>>);
  static_assert(std::is_copy_assignable_v<error_handler<TypeParam>>);
  static_assert(std::is_move_constructible_v<error_handler<TypeParam>>);
  static_assert(std::is_move_assignable_v<error_handler<TypeParam>>);
  static_assert(std::is_nothrow_destructible_v<error_handler<TypeParam>>);
}

TYPED_TEST(ErrorHandler, DoesNothingByDefault) {
  const error_handler<TypeParam> handler;
  EXPECT_FALSE(handler.enabled);
  EXPECT_FALSE(handler.usm_flag);
  EXPECT_EQ(1u, handler.status_buffer.size());
  EXPECT_EQ(nullptr, handler.status_array);
  EXPECT_EQ(0, handler.length);
  EXPECT_EQ(0u, handler.status_to_fix);
  EXPECT_EQ(TypeParam(0), handler.fixup_value);
  EXPECT_FALSE(handler.copy_sign);
}

TYPED_TEST(ErrorHandler, FieldsStandInTheirOrder) {
  const error_handler<TypeParam> h;
  const std::vector<const void*> fields{&h.enabled,      &h.usm_flag, &h.status_buffer,
                                        &h.status_array, &h.length,   &h.status_to_fix,
                                        &h.fixup_value,  &h.copy_sign};
  for (std::size_t i = 1; i < fields.size(); ++i) EXPECT_LT(fields[i - 1], fields[i]) << i;
  static_assert(std::is_same_v<decltype(h.length), std::int64_t>);
  static_assert(std::is_same_v<decltype(h.status_to_fix), std::uint32_t>);
  static_assert(std::is_same_v<decltype(h.fixup_value), TypeParam>);
}

TYPED_TEST(ErrorHandler, DefaultBuffersAreOwn) {
  const error_handler<TypeParam> a, b;
  EXPECT_FALSE(share(a.status_buffer, b.status_buffer));
}

TYPED_TEST(ErrorHandler, ReportsIntoAnArray) {
  enums::status cells[3] = {};
  const error_handler<TypeParam> handler(cells, 3);
  EXPECT_TRUE(handler.enabled);
  EXPECT_FALSE(handler.usm_flag);
  EXPECT_EQ(cells, handler.status_array);
  EXPECT_EQ(3, handler.length);
  EXPECT_EQ(1u, handler.status_buffer.size());
  EXPECT_EQ(0u, handler.status_to_fix);
}

TYPED_TEST(ErrorHandler, ReportsIntoABuffer) {
  const sycl::buffer<enums::status, 1> buffer{sycl::range<1>(4)};
  const error_handler<TypeParam> handler(buffer, 2);
  EXPECT_TRUE(handler.enabled);
  EXPECT_EQ(nullptr, handler.status_array);
  EXPECT_EQ(2, handler.length);
  EXPECT_TRUE(share(buffer, handler.status_buffer));
}

TYPED_TEST(ErrorHandler, RepairsWithAValue) {
  const error_handler<TypeParam> plain(TypeParam(2), enums::sing | enums::overflow);
  EXPECT_TRUE(plain.enabled);
  EXPECT_EQ(0, plain.length);
  EXPECT_EQ(6u, plain.status_to_fix);
  EXPECT_EQ(TypeParam(2), plain.fixup_value);
  EXPECT_FALSE(plain.copy_sign);
  const error_handler<TypeParam> with_sign(TypeParam(3), enums::errdom, true);
  EXPECT_EQ(1u, with_sign.status_to_fix);
  EXPECT_TRUE(with_sign.copy_sign);
}

TYPED_TEST(ErrorHandler, ReportsAndRepairs) {
  enums::status cell = enums::success;
  const error_handler<TypeParam> array(&cell, 1, enums::errdom, TypeParam(5), true);
  EXPECT_TRUE(array.enabled);
  EXPECT_EQ(&cell, array.status_array);
  EXPECT_EQ(1, array.length);
  EXPECT_EQ(1u, array.status_to_fix);
  EXPECT_EQ(TypeParam(5), array.fixup_value);
  EXPECT_TRUE(array.copy_sign);

  const sycl::buffer<enums::status, 1> buffer{sycl::range<1>(4)};
  const error_handler<TypeParam> buffered(buffer, 4, enums::sing, TypeParam(6));
  EXPECT_TRUE(buffered.enabled);
  EXPECT_EQ(4, buffered.length);
  EXPECT_TRUE(share(buffer, buffered.status_buffer));
  EXPECT_EQ(2u, buffered.status_to_fix);
  EXPECT_EQ(TypeParam(6), buffered.fixup_value);
  EXPECT_FALSE(buffered.copy_sign);
}

TYPED_TEST(ErrorHandler, AcceptsNoCells) {
  EXPECT_EQ(0, error_handler<TypeParam>(static_cast<enums::status*>(nullptr), 0).length);
  const sycl::buffer<enums::status, 1> buffer{sycl::range<1>(4)};
  EXPECT_EQ(0, error_handler<TypeParam>(buffer, 0).length);
  EXPECT_EQ(4, error_handler<TypeParam>(buffer, 4).length);
}

TYPED_TEST(ErrorHandler, RejectsStorageThatCannotHoldTheReport) {
  enums::status cell{};
  const sycl::buffer<enums::status, 1> buffer{sycl::range<1>(4)};
  const char* negative = "arbor::lumen::vm::error_handler: invalid argument: negative length";
  const char* null = "arbor::lumen::vm::error_handler: invalid argument: status array is nullptr";
  const char* brief =
      "arbor::lumen::vm::error_handler: invalid argument: status buffer is shorter than length";
  using handler = error_handler<TypeParam>;
  enums::status* const nothing = nullptr;
  expect_rejected(negative, [&] { handler(&cell, -1); });
  expect_rejected(negative, [&] { handler(nothing, -1); });
  expect_rejected(negative, [&] { handler(buffer, -1); });
  expect_rejected(null, [&] { handler(nothing, 1); });
  expect_rejected(brief, [&] { handler(buffer, 5); });
  expect_rejected(negative, [&] { handler(&cell, -1, enums::sing, TypeParam(1)); });
  expect_rejected(null, [&] { handler(nothing, 2, enums::sing, TypeParam(1)); });
  expect_rejected(brief, [&] { handler(buffer, 5, enums::sing, TypeParam(1)); });
}

template <typename T>
void expect_equal_fields(const error_handler<T>& expected, const error_handler<T>& got) {
  EXPECT_EQ(expected.enabled, got.enabled);
  EXPECT_EQ(expected.usm_flag, got.usm_flag);
  EXPECT_EQ(expected.status_array, got.status_array);
  EXPECT_EQ(expected.length, got.length);
  EXPECT_EQ(expected.status_to_fix, got.status_to_fix);
  EXPECT_EQ(expected.fixup_value, got.fixup_value);
  EXPECT_EQ(expected.copy_sign, got.copy_sign);
  EXPECT_TRUE(share(expected.status_buffer, got.status_buffer));
}

TYPED_TEST(ErrorHandler, CopiesShareTheStorage) {
  enums::status cells[2] = {};
  error_handler<TypeParam> original(cells, 2, enums::overflow, TypeParam(7), true);
  original.usm_flag = true;
  const error_handler<TypeParam> copy(original);
  expect_equal_fields(original, copy);
  error_handler<TypeParam> assigned;
  assigned = original;
  expect_equal_fields(original, assigned);
}

TYPED_TEST(ErrorHandler, MovesKeepTheFields) {
  enums::status cells[2] = {};
  error_handler<TypeParam> original(cells, 2, enums::overflow, TypeParam(7), true);
  original.usm_flag = true;
  const error_handler<TypeParam> kept(original);
  error_handler<TypeParam> moved(std::move(original));
  expect_equal_fields(kept, moved);
  error_handler<TypeParam> assigned;
  assigned = std::move(moved);
  expect_equal_fields(kept, assigned);
}

}  // namespace
