// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include <arbor/lumen/vm.hpp>
#include <complex>
#include <cstdint>
#include <span>
#include <sycl/sycl.hpp>
#include <type_traits>
#include <vector>

#include "frontend/functions.hpp"

namespace {

using namespace arbor::lumen;
namespace functions = arbor::lumen::tests::functions;
using events = const std::vector<sycl::event>&;
using count = std::int64_t;
using mode = vm::enums::mode;

template <typename... A>
struct list {};

/// Whether a function returns an event when called with the lists' types one after the other.
template <typename Function, typename... Lists>
struct accepts;
template <typename Function, typename... A>
struct accepts<Function, list<A...>> : std::is_invocable_r<sycl::event, Function, A...> {};
template <typename Function, typename... A, typename... B, typename... Rest>
struct accepts<Function, list<A...>, list<B...>, Rest...>
    : accepts<Function, list<A..., B...>, Rest...> {};

/// The operands of a shape in order, each input and output as a list of its own.
template <typename Shape, typename In, typename C, typename Out>
struct arrange;
struct v11;
struct v12;
struct v21;
struct v21c;
struct v61;
template <typename... In, typename C, typename... Out>
struct arrange<v11, list<In...>, C, list<Out...>> {
  using type = list<In..., Out...>;
};
template <typename... In, typename C, typename... Out>
struct arrange<v12, list<In...>, C, list<Out...>> {
  using type = list<In..., Out..., Out...>;
};
template <typename... In, typename C, typename... Out>
struct arrange<v21, list<In...>, C, list<Out...>> {
  using type = list<In..., In..., Out...>;
};
template <typename... In, typename C, typename... Out>
struct arrange<v21c, list<In...>, C, list<Out...>> {
  using type = list<In..., C, Out...>;
};
template <typename... In, typename C, typename... Out>
struct arrange<v61, list<In...>, C, list<Out...>> {
  using type = list<In..., In..., C, C, C, C, Out...>;
};

using queue_only = list<sycl::queue&>;
using queue_and_count = list<sycl::queue&, count>;

/// One form: what comes first, what stands for arrays, and what follows.
template <typename Function, typename Shape, typename T, typename U, typename Lead, typename In,
          typename Out, typename Tail>
struct form {
  using arrays = typename arrange<Shape, In, T, Out>::type;
  using handler = list<const vm::error_handler<U>&>;

  static constexpr bool plain = accepts<Function, Lead, arrays>::value;
  static constexpr bool with_tail = accepts<Function, Lead, arrays, Tail>::value;
  static constexpr bool with_handler = accepts<Function, Lead, arrays, Tail, handler>::value;
  /// Arguments may be left out at the end, and a handler stands nowhere but there.
  static constexpr bool handler_alone = accepts<Function, Lead, arrays, handler>::value;
};

template <typename Function, typename Shape, typename T, typename U>
struct forms {
  using after_pointers = list<events, mode>;
  using after_buffers = list<mode>;
  using pointer =
      form<Function, Shape, T, U, queue_and_count, list<const T*>, list<U*>, after_pointers>;
  using pointer_slice = form<Function, Shape, T, U, queue_only, list<const T*, slice>,
                             list<U*, slice>, after_pointers>;
  using buffer = form<Function, Shape, T, U, queue_and_count, list<sycl::buffer<T, 1>&>,
                      list<sycl::buffer<U, 1>&>, after_buffers>;
  using buffer_slice = form<Function, Shape, T, U, queue_only, list<sycl::buffer<T, 1>&, slice>,
                            list<sycl::buffer<U, 1>&, slice>, after_buffers>;
  using span = form<Function, Shape, T, U, queue_only, list<std::span<const T>>, list<std::span<U>>,
                    after_pointers>;
  using span_slice = form<Function, Shape, T, U, queue_only, list<std::span<const T>, slice>,
                          list<std::span<U>, slice>, after_pointers>;
  // Inputs that convert to spans.
  using span_of_mutable = form<Function, Shape, T, U, queue_only, list<std::span<T>>,
                               list<std::span<U>>, after_pointers>;
  using vector = form<Function, Shape, T, U, queue_only, list<const std::vector<T>&>,
                      list<std::vector<U>&>, after_pointers>;
  using vector_slice = form<Function, Shape, T, U, queue_only, list<std::vector<T>&, slice>,
                            list<std::vector<U>&, slice>, after_pointers>;
  // What must not compile: outputs that are inputs, events beside buffers, no count.
  using constant_output =
      form<Function, Shape, T, U, queue_and_count, list<const T*>, list<const U*>, after_pointers>;
  using buffer_with_events = form<Function, Shape, T, U, queue_and_count, list<sycl::buffer<T, 1>&>,
                                  list<sycl::buffer<U, 1>&>, after_pointers>;
  using pointer_without_count =
      form<Function, Shape, T, U, queue_only, list<const T*>, list<U*>, after_pointers>;
};

template <typename Form, bool Handler>
constexpr bool complete =
    Form::plain&& Form::with_tail&& Form::with_handler == Handler && !Form::handler_alone;

#define LUMEN_CHECK(function, shape, letter, input, output, handler)                \
  namespace function##_##letter {                                                   \
    using f = forms<functions::function, shape, input, output>;                     \
    static_assert(complete<f::pointer, handler>);                                   \
    static_assert(complete<f::pointer_slice, handler>);                             \
    static_assert(complete<f::buffer, handler>);                                    \
    static_assert(complete<f::buffer_slice, handler>);                              \
    static_assert(complete<f::span, handler>);                                      \
    static_assert(complete<f::span_slice, handler>);                                \
    static_assert(complete<f::span_of_mutable, handler>);                           \
    static_assert(complete<f::vector, handler>);                                    \
    static_assert(complete<f::vector_slice, handler>);                              \
    static_assert(!f::constant_output::plain && !f::buffer_with_events::with_tail); \
    static_assert(!f::pointer_without_count::plain);                                \
  }
LUMEN_OVERLOADS(LUMEN_CHECK)
#undef LUMEN_CHECK

template <typename Function, typename Shape, typename T, typename U>
constexpr bool exists = forms<Function, Shape, T, U>::pointer::plain;
using complex_float = std::complex<float>;
using complex_double = std::complex<double>;

// The modulus of a complex number is real, and so is its argument; neither is written as complex.
static_assert(exists<functions::abs, v11, complex_float, float>);
static_assert(exists<functions::abs, v11, complex_double, double>);
static_assert(!exists<functions::abs, v11, complex_float, complex_float>);
static_assert(exists<functions::arg, v11, complex_float, float>);
static_assert(!exists<functions::arg, v11, complex_float, complex_float>);
static_assert(!exists<functions::arg, v11, float, float>);
static_assert(exists<functions::cis, v11, float, complex_float>);
static_assert(!exists<functions::cis, v11, complex_float, complex_float>);
static_assert(!exists<functions::cis, v11, sycl::half, complex_float>);
static_assert(exists<functions::conj, v11, complex_double, complex_double>);
static_assert(!exists<functions::conj, v11, double, double>);
// No function mixes precisions.
static_assert(!exists<functions::exp, v11, float, double>);
static_assert(!exists<functions::exp, v11, sycl::half, float>);
// Complex elements only where the function has them.
static_assert(!exists<functions::atan2, v21, complex_float, complex_float>);
static_assert(exists<functions::powx, v21c, complex_float, complex_float>);
static_assert(!exists<functions::jn, v21c, complex_float, complex_float>);

// The documented table of handlers, a few of each row.
template <typename Function, typename Shape, typename T, typename U>
constexpr bool has_handler = forms<Function, Shape, T, U>::span::with_handler;
static_assert(has_handler<functions::expint1, v11, float, float>);
static_assert(!has_handler<functions::abs, v11, complex_float, float>);
static_assert(!has_handler<functions::erf, v11, double, double>);
static_assert(has_handler<functions::erfc, v11, double, double>);
static_assert(!has_handler<functions::tanh, v11, float, float>);
static_assert(has_handler<functions::tan, v11, float, float>);
static_assert(has_handler<functions::cis, v11, float, complex_float>);
static_assert(!has_handler<functions::modf, v12, float, float>);
static_assert(has_handler<functions::sincos, v12, sycl::half, sycl::half>);
static_assert(has_handler<functions::mulbyconj, v21, complex_float, complex_float>);
static_assert(!has_handler<functions::fmax, v21, float, float>);
static_assert(has_handler<functions::fmod, v21, float, float>);
static_assert(!has_handler<functions::jn, v21c, double, double>);
static_assert(has_handler<functions::yn, v21c, double, double>);
static_assert(has_handler<functions::linearfrac, v61, float, float>);

TEST(Signatures, OverloadSetsAreAllOfTheCatalogue) {
  int sets = 0, with_handler = 0;
#define LUMEN_COUNT(function, shape, letter, input, output, handler) \
  ++sets, with_handler += handler;
  LUMEN_OVERLOADS(LUMEN_COUNT)
#undef LUMEN_COUNT
  EXPECT_EQ(1890, 6 * sets);
  EXPECT_EQ(sets, 3 * 1 + 2 * 2 + 3 * 19 + 3 * 25 + 5 * 4 + 5 * 13 + 2 + 3 + 6 + 2 + 27 + 12 + 25 +
                      3 + 3 + 5 + 3);
  EXPECT_EQ(with_handler, 3 + 3 * 25 + 5 * 13 + 2 + 6 + 2 + 12 + 25 + 3 + 5 + 3);
}

TEST(Signatures, DefaultsAreTheQueuesModeAndNoHandler) {
  sycl::queue queue;
  const std::vector<float> a{-1, 2, -3};
  std::vector<float> y(3);
  vm::abs(queue, a, y).wait();
  EXPECT_EQ((std::vector<float>{1, 2, 3}), y);
  vm::abs(queue, 2, a.data(), y.data(), {}, vm::enums::la).wait();
  vm::add(queue, a, a, y, {}, vm::enums::ep, {}).wait();
  EXPECT_EQ((std::vector<float>{-2, 4, -6}), y);
}

}  // namespace
