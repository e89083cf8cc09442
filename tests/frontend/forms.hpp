// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Calls of a public function in all its forms, compared bit by bit with a plain loop over the
/// scalar functor that should serve them.
#pragma once

#include <gtest/gtest.h>

#include <array>
#include <bit>
#include <complex>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <limits>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <sycl/sycl.hpp>
#include <type_traits>
#include <vector>

#include "call/shape.hpp"
#include "frontend/functions.hpp"

namespace arbor::lumen::tests {

namespace shape = vm::detail::shape;

enum class memory { pointer, buffer, span };

/// An array of a call: its storage and the part of it that the call works on.
template <typename E>
struct operand {
  std::vector<E> data;
  slice part{0, 0, 1};
  std::unique_ptr<sycl::buffer<E, 1>> buffer;

  std::size_t index(std::size_t i) const {
    return static_cast<std::size_t>(part.start + static_cast<std::int64_t>(i) * part.stride);
  }
};

template <typename Shape, typename T, typename U>
struct operands {
  std::int64_t n = 0;
  std::array<operand<T>, Shape::inputs> in;
  std::array<T, Shape::constants> constants;
  std::array<operand<U>, Shape::outputs> out;
};

template <memory M, typename E>
decltype(auto) as(operand<E>& array) {
  if constexpr (M == memory::pointer)
    return array.data.data();
  else if constexpr (M == memory::buffer)
    return static_cast<sycl::buffer<E, 1>&>(*array.buffer);
  else
    return std::span<E>(array.data);
}

/// One form of a function. `tail` is what follows the operands.
template <typename Function, memory M, bool Sliced, typename Shape, typename T, typename U,
          typename... Tail>
sycl::event call_form(sycl::queue& queue, operands<Shape, T, U>& o, const Tail&... tail) {
  constexpr Function function;
  auto& in = o.in;
  auto& out = o.out;
  auto& c = o.constants;
  if constexpr (Sliced) {
    const auto with_inputs = [&](auto&... rest) {
      if constexpr (Shape::inputs == 1)
        return function(queue, as<M>(in[0]), in[0].part, rest...);
      else
        return function(queue, as<M>(in[0]), in[0].part, as<M>(in[1]), in[1].part, rest...);
    };
    auto&& y = as<M>(out[0]);
    if constexpr (Shape::outputs == 2) {
      auto&& y2 = as<M>(out[1]);
      return with_inputs(y, out[0].part, y2, out[1].part, tail...);
    } else if constexpr (Shape::constants == 0) {
      return with_inputs(y, out[0].part, tail...);
    } else if constexpr (Shape::constants == 1) {
      return with_inputs(c[0], y, out[0].part, tail...);
    } else {
      return with_inputs(c[0], c[1], c[2], c[3], y, out[0].part, tail...);
    }
  } else {
    return [&]<std::size_t... I, std::size_t... C, std::size_t... O>(
        std::index_sequence<I...>, std::index_sequence<C...>, std::index_sequence<O...>) {
      if constexpr (M == memory::span)
        return function(queue, as<M>(in[I])..., c[C]..., as<M>(out[O])..., tail...);
      else
        return function(queue, o.n, as<M>(in[I])..., c[C]..., as<M>(out[O])..., tail...);
    }
    (std::make_index_sequence<Shape::inputs>(), std::make_index_sequence<Shape::constants>(),
     std::make_index_sequence<Shape::outputs>());
  }
}

template <typename Shape, typename T, typename U>
struct form_of {
  const char* name;
  memory where;
  bool sliced;
  sycl::event (*call)(sycl::queue&, operands<Shape, T, U>&, vm::enums::mode);
};

template <typename Function, memory M, bool Sliced, typename Shape, typename T, typename U>
sycl::event call_with_mode(sycl::queue& queue, operands<Shape, T, U>& o, vm::enums::mode mode) {
  if constexpr (M == memory::buffer)
    return call_form<Function, M, Sliced>(queue, o, mode);
  else
    return call_form<Function, M, Sliced>(queue, o, std::vector<sycl::event>(), mode);
}

template <typename Function, typename Shape, typename T, typename U>
inline constexpr std::array<form_of<Shape, T, U>, 6> six_forms{{
    {"pointer", memory::pointer, false,
     &call_with_mode<Function, memory::pointer, false, Shape, T, U>},
    {"pointer with slices", memory::pointer, true,
     &call_with_mode<Function, memory::pointer, true, Shape, T, U>},
    {"buffer", memory::buffer, false,
     &call_with_mode<Function, memory::buffer, false, Shape, T, U>},
    {"buffer with slices", memory::buffer, true,
     &call_with_mode<Function, memory::buffer, true, Shape, T, U>},
    {"span", memory::span, false, &call_with_mode<Function, memory::span, false, Shape, T, U>},
    {"span with slices", memory::span, true,
     &call_with_mode<Function, memory::span, true, Shape, T, U>},
}};

/// Arguments around which functions change their ways, and some of all sizes. One NaN stands for
/// all: the sum of two different ones has the payload of either.
template <typename R>
std::vector<R> arguments_of() {
  using limits = std::numeric_limits<R>;
  constexpr double magnitudes[] = {0,   0.25, 0.5, 0.75, 1,    1.0625, 1.5,
                                   2.5, 3,    7,   12.5, 88.5, 101,    1000.5};
  std::vector<R> values;
  for (const double magnitude : magnitudes) {
    values.push_back(static_cast<R>(magnitude));
    values.push_back(static_cast<R>(-magnitude));
  }
  for (const R extreme : {limits::infinity(), limits::max(), limits::min(), limits::denorm_min()}) {
    values.push_back(extreme);
    values.push_back(-extreme);
  }
  values.push_back(limits::quiet_NaN());
  return values;
}

template <typename T>
struct is_complex : std::false_type {};
template <typename R>
struct is_complex<std::complex<R>> : std::true_type {};

/// Element `i` of input `k`. The inputs go through the arguments at different speeds, so that they
/// meet in many pairs.
template <typename T>
T argument(std::size_t i, std::size_t k) {
  if constexpr (is_complex<T>::value) {
    using R = typename T::value_type;
    return T(argument<R>(i, k), argument<R>(3 * i + 1, k + 1));
  } else {
    static const std::vector<T> values = arguments_of<T>();
    return values[(i * (2 * k + 1) + 5 * k) % values.size()];
  }
}

/// What outputs hold before a call, to see what the call leaves alone.
template <typename U>
U untouched() {
  if constexpr (is_complex<U>::value)
    return U(untouched<typename U::value_type>(), untouched<typename U::value_type>());
  else
    return static_cast<U>(-77.25);
}

template <typename E>
std::string bits_of(const E& value) {
  std::array<unsigned char, sizeof(E)> bytes;
  std::memcpy(bytes.data(), &value, sizeof(E));
  std::string text;
  for (std::size_t i = bytes.size(); i-- > 0;) {
    constexpr const char* digits = "0123456789abcdef";
    text += {digits[bytes[i] / 16], digits[bytes[i] % 16]};
  }
  return text;
}

/// Applies a functor to element `i` of plain arguments.
template <typename Shape, typename T, typename U>
using scalar_call = void (*)(const std::array<T, Shape::inputs>&,
                             const std::array<T, Shape::constants>&,
                             std::array<U, Shape::outputs>&);

template <typename Functor, typename Shape, typename T, typename U>
void apply(const std::array<T, Shape::inputs>& x, const std::array<T, Shape::constants>& c,
           std::array<U, Shape::outputs>& y) {
  [&]<std::size_t... I, std::size_t... C, std::size_t... O>(
      std::index_sequence<I...>, std::index_sequence<C...>, std::index_sequence<O...>) {
    Functor::call(&x[I]..., c[C]..., &y[O]...);
  }
  (std::make_index_sequence<Shape::inputs>(), std::make_index_sequence<Shape::constants>(),
   std::make_index_sequence<Shape::outputs>());
}

/// Lays out `count` elements: whole arrays, or slices that go forwards, backwards and past gaps.
template <typename Shape, typename T, typename U>
operands<Shape, T, U> lay_out(std::size_t count, const form_of<Shape, T, U>& form) {
  const auto n = static_cast<std::int64_t>(count);
  const slice parts[] = {{2, n, 3}, {n - 1, n, -1}, {1, n, 2}, {2 * n, n, -2}};
  // Beyond the count of elements, where a span would count them.
  const std::size_t spare = form.where == memory::span ? 0 : 3;
  operands<Shape, T, U> o;
  o.n = n;
  const auto lay = [&](auto& array, std::size_t which) {
    array.part = form.sliced ? parts[which] : slice{0, n, 1};
    array.data.resize(form.sliced ? 3 * count + 5 : count + spare);
  };
  for (std::size_t k = 0; k < o.in.size(); ++k) {
    lay(o.in[k], k);
    for (T& element : o.in[k].data) element = T(1);
    for (std::size_t i = 0; i < count; ++i) o.in[k].data[o.in[k].index(i)] = argument<T>(i, k);
  }
  for (std::size_t c = 0; c < o.constants.size(); ++c)
    o.constants[c] = static_cast<T>(2.5) + static_cast<T>(static_cast<float>(c));
  for (std::size_t j = 0; j < o.out.size(); ++j) {
    lay(o.out[j], 2 + j);
    for (U& element : o.out[j].data) element = untouched<U>();
  }
  return o;
}

template <typename Shape, typename T, typename U>
std::array<std::vector<U>, Shape::outputs> expected_outputs(std::size_t count,
                                                            const operands<Shape, T, U>& o,
                                                            scalar_call<Shape, T, U> scalar) {
  std::array<std::vector<U>, Shape::outputs> expected;
  for (std::size_t j = 0; j < expected.size(); ++j) expected[j] = o.out[j].data;
  for (std::size_t i = 0; i < count; ++i) {
    std::array<T, Shape::inputs> x;
    std::array<U, Shape::outputs> y;
    for (std::size_t k = 0; k < x.size(); ++k) x[k] = o.in[k].data[o.in[k].index(i)];
    scalar(x, o.constants, y);
    for (std::size_t j = 0; j < y.size(); ++j) expected[j][o.out[j].index(i)] = y[j];
  }
  return expected;
}

/// Calls the function in one form and compares every element of its outputs.
template <typename Shape, typename T, typename U>
void check_form(const form_of<Shape, T, U>& form, scalar_call<Shape, T, U> scalar,
                sycl::queue& queue, vm::enums::mode mode) {
  constexpr std::size_t count = 111;
  operands<Shape, T, U> o = lay_out(count, form);
  const auto expected = expected_outputs(count, o, scalar);
  const auto bind = [](auto& arrays) {
    for (auto& array : arrays) {
      using E = std::remove_cvref_t<decltype(array.data[0])>;
      array.buffer = std::make_unique<sycl::buffer<E, 1>>(array.data.data(),
                                                          sycl::range<1>(array.data.size()));
    }
  };
  if (form.where == memory::buffer) bind(o.in), bind(o.out);
  form.call(queue, o, mode).wait_and_throw();
  for (auto& array : o.in) array.buffer.reset();
  for (auto& array : o.out) array.buffer.reset();  // writes the results to `data`
  int shown = 0;
  for (std::size_t j = 0; j < expected.size(); ++j) {
    for (std::size_t e = 0; e < expected[j].size() && shown < 5; ++e) {
      const std::string wanted = bits_of(expected[j][e]), got = bits_of(o.out[j].data[e]);
      if (wanted == got) continue;
      ++shown;
      ADD_FAILURE() << form.name << ", output " << j << ", array element " << e << ": " << got
                    << ", the functor gives " << wanted;
    }
  }
}

/// A functor and the way to compare the public function with it.
struct functor_case {
  std::string_view function, type, tier, label, functor;
  void (*check)(sycl::queue&, vm::enums::mode);

  bool cast() const { return functor.ends_with("_fp32cast"); }
};

template <typename Function, typename Shape, typename Functor>
void check_forms(sycl::queue& queue, vm::enums::mode mode) {
  // Functors know halves as patterns; the interface, as the runtime's numbers.
  constexpr bool is_half = sizeof(typename Functor::input_type) == sizeof(sycl::half);
  using T = std::conditional_t<is_half, sycl::half, typename Functor::input_type>;
  using U = std::conditional_t<is_half, sycl::half, typename Functor::output_type>;
  for (const form_of<Shape, T, U>& form : six_forms<Function, Shape, T, U>)
    check_form<Shape, T, U>(form, &apply<Functor, Shape, T, U>, queue, mode);
}

/// The functors of each element type, each list in a translation unit of its own.
std::vector<functor_case> half_cases();
std::vector<functor_case> float_cases();
std::vector<functor_case> double_cases();
std::vector<functor_case> complex_float_cases();
std::vector<functor_case> complex_double_cases();

}  // namespace arbor::lumen::tests

/// An entry of such a list.
#define LUMEN_FUNCTOR_CASE(function, shape_name, type, tier, label, functor) \
  {#function,                                                                \
   #type,                                                                    \
   #tier,                                                                    \
   #label,                                                                   \
   #functor,                                                                 \
   &check_forms<functions::function, shape::shape_name,                      \
                vm::detail::gpu::norvane::scalar::functor>},
