// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <cstring>
#include <functional>
#include <type_traits>
#include <unordered_set>
#include <utility>

#include <gtest/gtest.h>
#include <sycl/sycl.hpp>

namespace {

template <typename T>
class ReferenceSemantics : public testing::Test {};

using handles =
    testing::Types<sycl::queue, sycl::context, sycl::device, sycl::platform, sycl::event>;
TYPED_TEST_SUITE(ReferenceSemantics, handles);

TYPED_TEST(ReferenceSemantics, CopiesAndMovesReferToTheSameObject) {
  static_assert(std::is_copy_constructible_v<TypeParam>);
  static_assert(std::is_copy_assignable_v<TypeParam>);
  static_assert(std::is_nothrow_move_constructible_v<TypeParam>);
  static_assert(std::is_nothrow_move_assignable_v<TypeParam>);
  static_assert(std::is_default_constructible_v<TypeParam>);
  static_assert(noexcept(std::declval<TypeParam&>() == std::declval<TypeParam&>()));
  TypeParam a;
  TypeParam copy = a;  // NOLINT: the copy is the point
  EXPECT_TRUE(a == copy);
  EXPECT_FALSE(a != copy);
  TypeParam moved = std::move(copy);
  EXPECT_TRUE(a == moved);
  copy = moved;
  EXPECT_TRUE(copy == a);
  TypeParam target;
  target = std::move(moved);
  EXPECT_TRUE(target == a);
  const std::hash<TypeParam> hash;
  EXPECT_EQ(hash(a), hash(target));
  EXPECT_EQ(std::unordered_set<TypeParam>({a, copy, target}).size(), 1U);
}

TYPED_TEST(ReferenceSemantics, TheFirstWordIsTheImplementation) {
  const TypeParam a;
  const void* first = nullptr;
  std::memcpy(&first, &a, sizeof first);
  EXPECT_NE(first, nullptr);
  EXPECT_EQ(first, sycl::detail::handle_access::impl(a).get());
}

TEST(Handles, ObjectsMadeApartDiffer) {
  EXPECT_FALSE(sycl::queue() == sycl::queue());
  EXPECT_FALSE(sycl::event() == sycl::event());
  EXPECT_FALSE(sycl::context() == sycl::context());
  EXPECT_TRUE(sycl::device() == sycl::device());
  EXPECT_TRUE(sycl::platform() == sycl::platform());
}

}  // namespace
