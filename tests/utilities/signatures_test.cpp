// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include <arbor/lumen/vm/error_handler.hpp>
#include <complex>
#include <concepts>
#include <sycl/sycl.hpp>
#include <tuple>
#include <type_traits>
#include <utility>

#include "utilities/calls.hpp"

namespace {

namespace utilities = arbor::lumen::tests::utilities;
using namespace utilities;
using arbor::lumen::vm::error_handler;

template <typename Utility, typename List>
inline constexpr bool accepts = false;
template <typename Utility, typename... A>
inline constexpr bool accepts<Utility, std::tuple<A...>> = requires(A&&... arguments) {
  { Utility()(std::forward<A>(arguments)...) } -> std::same_as<sycl::event>;
};

/// The argument types of a form, with `Rest` behind the mode.
template <typename Utility, memory M, bool Sliced, typename T, typename... Rest>
using list = decltype(argument_list<M, Sliced>(
    std::declval<sycl::queue&>(), std::declval<operands<typename Utility::shape, T>&>(),
    arbor::lumen::vm::enums::not_defined, std::declval<Rest>()...));

template <typename Utility, memory M, bool Sliced, typename T>
constexpr int overloads_of_form() {
  static_assert(accepts<Utility, list<Utility, M, Sliced, T>>);
  static_assert(!accepts<Utility, list<Utility, M, Sliced, T, error_handler<T>>>);
  return 1;
}
template <typename Utility, typename T>
constexpr int overloads_of_type() {
  return overloads_of_form<Utility, memory::pointer, false, T>() +
         overloads_of_form<Utility, memory::pointer, true, T>() +
         overloads_of_form<Utility, memory::buffer, false, T>() +
         overloads_of_form<Utility, memory::buffer, true, T>() +
         overloads_of_form<Utility, memory::span, false, T>() +
         overloads_of_form<Utility, memory::span, true, T>();
}
template <typename Utility>
constexpr int overloads() {
  static_assert(!accepts<Utility, list<Utility, memory::pointer, false, sycl::half>>,
                "there are no utilities for half");
  return overloads_of_type<Utility, float>() + overloads_of_type<Utility, double>() +
         overloads_of_type<Utility, std::complex<float>>() +
         overloads_of_type<Utility, std::complex<double>>();
}

TEST(UtilitySignatures, AreWithoutHandler) {
#define LUMEN_COUNT(utility) +overloads<utilities::utility>()
  EXPECT_EQ(240, LUMEN_UTILITIES(LUMEN_COUNT));
#undef LUMEN_COUNT
}

}  // namespace
