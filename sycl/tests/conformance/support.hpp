// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <future>
#include <memory>
#include <sycl/sycl.hpp>
#include <system_error>
#include <type_traits>
#include <utility>

namespace conformance {

/// What the type of every object with common reference semantics offers.
template <typename T>
constexpr bool has_reference_semantics =
    std::is_copy_constructible_v<T>&& std::is_copy_assignable_v<T>&& std::is_move_constructible_v<
        T>&& std::is_move_assignable_v<T>&& std::is_destructible_v<T>&&
        std::is_same_v<decltype(std::declval<const T&>() == std::declval<const T&>()), bool>&&
            std::is_same_v<decltype(std::declval<const T&>() != std::declval<const T&>()), bool>&&
                std::is_same_v<decltype(std::hash<T>()(std::declval<const T&>())), std::size_t>;

/// Copies and moved-to objects are the object itself; `other` is a different one.
template <typename T>
void expect_reference_semantics(T object, T other) {
  static_assert(has_reference_semantics<T>);
  EXPECT_TRUE(object == object);
  EXPECT_FALSE(object != object);
  EXPECT_FALSE(object == other);
  EXPECT_FALSE(other == object);
  EXPECT_TRUE(object != other);

  const std::hash<T> hash;
  const T copy(object);
  EXPECT_TRUE(copy == object);
  EXPECT_TRUE(object == copy);
  EXPECT_EQ(hash(copy), hash(object));

  T assigned(other);
  assigned = object;
  EXPECT_TRUE(assigned == object);
  EXPECT_TRUE(assigned != other);
  EXPECT_EQ(hash(assigned), hash(object));

  T source(object);
  const T moved(std::move(source));
  EXPECT_TRUE(moved == object);
  EXPECT_EQ(hash(moved), hash(object));

  T second_source(object);
  T target(other);
  target = std::move(second_source);
  EXPECT_TRUE(target == object);
  EXPECT_TRUE(target != other);

  T self(object);
  const T& alias = self;
  self = alias;
  EXPECT_TRUE(self == object);
}

/// The call throws a sycl::exception with the code.
template <typename Function>
::testing::AssertionResult throws(sycl::errc expected, Function&& function) {
  try {
    std::forward<Function>(function)();
  } catch (const sycl::exception& error) {
    if (error.code() == expected) return ::testing::AssertionSuccess();
    return ::testing::AssertionFailure()
           << "threw code " << error.code().value() << " (" << error.what() << ") instead of "
           << static_cast<int>(expected);
  } catch (const std::exception& error) {
    return ::testing::AssertionFailure() << "threw no sycl::exception: " << error.what();
  }
  return ::testing::AssertionFailure() << "threw nothing";
}

/// A host task that does not finish before the gate is opened; opens it at the latest on
/// destruction, so that a failed assertion does not leave the queue stuck.
class gate {
 public:
  explicit gate(sycl::queue q) {
    event_ = q.submit([&](sycl::handler& cgh) {
      cgh.host_task([opened = opened_.get_future().share()] { opened.wait(); });
    });
  }
  gate(const gate&) = delete;
  gate& operator=(const gate&) = delete;
  ~gate() { open(); }

  void open() {
    if (std::exchange(closed_, false)) opened_.set_value();
  }
  const sycl::event& event() const { return event_; }

 private:
  std::promise<void> opened_;
  bool closed_ = true;
  sycl::event event_;
};

inline bool is_complete(const sycl::event& event) {
  return event.get_info<sycl::info::event::command_execution_status>() ==
         sycl::info::event_command_status::complete;
}

}  // namespace conformance
