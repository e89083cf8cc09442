// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Calls of the utilities in the six forms, on arrays laid out in several ways.
#pragma once

#include <gtest/gtest.h>

#include <arbor/lumen/slice.hpp>
#include <array>
#include <complex>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <limits>
#include <memory>
#include <span>
#include <string>
#include <sycl/sycl.hpp>
#include <tuple>
#include <type_traits>
#include <utility>
#include <vector>

#include "utilities/utilities.hpp"

namespace arbor::lumen::tests::utilities {

enum class memory { pointer, buffer, span };

/// An array of a call: its storage and the part that the call works on.
template <typename T>
struct operand {
  std::vector<T> data;
  slice part{0, 0, 1};
  std::shared_ptr<sycl::buffer<T, 1>> buffer;

  T& at(std::size_t i) {
    return data[static_cast<std::size_t>(part.start + static_cast<std::int64_t>(i) * part.stride)];
  }
};

template <typename Shape, typename T>
struct operands {
  std::int64_t n = 0;
  std::array<operand<T>, Shape::inputs> in;
  std::array<T, Shape::constants> constants;
  std::array<operand<T>, Shape::outputs> out;

  template <typename Action>
  void for_each_array(Action action) {
    for (operand<T>& array : in) action(array);
    for (operand<T>& array : out) action(array);
  }
};

template <memory M, bool Sliced, typename T>
auto arguments_for(operand<T>& array) {
  const auto with_slice = [&](auto argument) {
    if constexpr (Sliced)
      return std::tuple_cat(argument, std::tuple(array.part));
    else
      return argument;
  };
  if constexpr (M == memory::pointer)
    return with_slice(std::tuple(array.data.data()));
  else if constexpr (M == memory::buffer)
    return with_slice(std::tuple<sycl::buffer<T, 1>&>(*array.buffer));
  else
    return with_slice(std::tuple(std::span<T>(array.data)));
}

/// All arguments of one form up to the mode; what follows is `rest`.
template <memory M, bool Sliced, typename Shape, typename T, typename... Rest>
auto argument_list(sycl::queue& queue, operands<Shape, T>& o, vm::enums::mode mode, Rest... rest) {
  const auto count = [&] {
    if constexpr (Sliced || M == memory::span)
      return std::tuple();
    else
      return std::tuple(o.n);
  };
  const auto depends = [] {
    if constexpr (M == memory::buffer)
      return std::tuple();
    else
      return std::tuple(std::vector<sycl::event>());
  };
  const auto arrays = [](auto& list) {
    return std::apply(
        [](auto&... array) { return std::tuple_cat(arguments_for<M, Sliced>(array)...); }, list);
  };
  return std::tuple_cat(std::tuple<sycl::queue&>(queue), count(), arrays(o.in), o.constants,
                        arrays(o.out), depends(), std::tuple(mode, rest...));
}

template <typename Shape, typename T>
struct form_of {
  const char* name;
  memory where;
  bool sliced;
  sycl::event (*call)(sycl::queue&, operands<Shape, T>&, vm::enums::mode);
};

template <typename Utility, memory M, bool Sliced, typename T>
sycl::event call_form(sycl::queue& queue, operands<typename Utility::shape, T>& o,
                      vm::enums::mode mode) {
  return std::apply(Utility(), argument_list<M, Sliced>(queue, o, mode));
}

template <typename Utility, typename T>
inline constexpr std::array<form_of<typename Utility::shape, T>, 6> six_forms{{
    {"pointer", memory::pointer, false, &call_form<Utility, memory::pointer, false, T>},
    {"pointer with slices", memory::pointer, true, &call_form<Utility, memory::pointer, true, T>},
    {"buffer", memory::buffer, false, &call_form<Utility, memory::buffer, false, T>},
    {"buffer with slices", memory::buffer, true, &call_form<Utility, memory::buffer, true, T>},
    {"span", memory::span, false, &call_form<Utility, memory::span, false, T>},
    {"span with slices", memory::span, true, &call_form<Utility, memory::span, true, T>},
}};

/// What an output holds before a call.
template <typename T>
T untouched() {
  if constexpr (is_complex<T>)
    return T(-77.25, 19.5);
  else
    return static_cast<T>(-77.25);
}

/// Element `i` of input `k`: the inputs go through the values at different speeds, so that they
/// meet in many pairs. Sums and products of complex ones are exact.
template <typename Utility, typename T>
T argument(std::size_t i, std::size_t k) {
  if constexpr (is_complex<T>) {
    using R = typename T::value_type;
    return T(argument<Utility, R>(i, k), argument<Utility, R>(3 * i + 1, k + 1));
  } else {
    using limits = std::numeric_limits<T>;
    constexpr bool computes = std::is_same_v<Utility, faa> || std::is_same_v<Utility, fmm>;
    constexpr auto values = [] {
      if constexpr (computes)
        return std::array<T, 9>{1, -2.5, 3, 0.25, -7, 12.5, 2.5, -101, 88.5};
      else
        return std::array<T, 11>{1,
                                 -2.5,
                                 0,
                                 -T(0),
                                 7.25,
                                 limits::infinity(),
                                 2.5,
                                 -limits::infinity(),
                                 -T(0.5),
                                 limits::denorm_min(),
                                 limits::quiet_NaN()};
    }();
    return values[(i * (2 * k + 1) + 5 * k) % values.size()];
  }
}

/// How the arrays of a call lie.
enum class layout {
  one_size,  ///< whole arrays, or slices of one size that go forwards, backwards and past gaps
  cyclic     ///< inputs of different sizes, all shorter than the outputs
};

/// How many elements input `k` has.
inline std::size_t input_size(layout how, std::size_t k, std::size_t count) {
  constexpr std::size_t sizes[] = {4, 3, 2};
  return how == layout::cyclic ? sizes[k] : count;
}

/// Which element of input `k` belongs to element `i` of the outputs: under the cyclic policy the
/// last input turns fastest.
template <typename Shape>
std::size_t input_element(layout how, std::size_t k, std::size_t i, std::size_t count) {
  if (how == layout::one_size) return i;
  std::size_t divisor = 1;
  for (std::size_t later = k + 1; later < Shape::inputs; ++later)
    divisor *= input_size(how, later, count);
  return i / divisor % input_size(how, k, count);
}

template <typename Utility, typename T>
auto lay_out(const form_of<typename Utility::shape, T>& form, layout how, std::size_t count) {
  const auto part = [&](std::size_t which, std::size_t elements) {
    const auto n = static_cast<std::int64_t>(elements);
    const slice parts[] = {{2, n, 3}, {n - 1, n, -1}, {1, n, 2}, {2 * n, n, -2}, {0, n, 1}};
    return form.sliced ? parts[which] : slice{0, n, 1};
  };
  // Beyond the count, where a span would count them.
  const std::size_t spare = form.where == memory::span ? 0 : 3;
  operands<typename Utility::shape, T> o;
  o.n = static_cast<std::int64_t>(count);
  for (std::size_t k = 0; k < o.in.size(); ++k) {
    const std::size_t size = input_size(how, k, count);
    o.in[k].part = part(k, size);
    o.in[k].data.assign(form.sliced ? 3 * size + 5 : size + spare, T(1));
    for (std::size_t i = 0; i < size; ++i) o.in[k].at(i) = argument<Utility, T>(i, k);
  }
  for (std::size_t c = 0; c < o.constants.size(); ++c) {
    if constexpr (is_complex<T>)
      o.constants[c] = c == 0 ? T(2.5, -1) : T(-4, 9);
    else
      o.constants[c] = static_cast<T>(c == 0 ? 2.5 : -4);
  }
  for (std::size_t j = 0; j < o.out.size(); ++j) {
    o.out[j].part = part(3 + j, count);
    o.out[j].data.assign(form.sliced ? 3 * count + 5 : count + spare, untouched<T>());
  }
  return o;
}

/// What the outputs hold after a call.
template <typename Utility, typename T>
auto expected_outputs(operands<typename Utility::shape, T> o, layout how, std::size_t count) {
  using shape = typename Utility::shape;
  for (std::size_t i = 0; i < count; ++i) {
    one_element<shape, T> e{i, {}, o.constants, {}};
    for (std::size_t k = 0; k < o.in.size(); ++k)
      e.in[k] = o.in[k].at(input_element<shape>(how, k, i, count));
    for (std::size_t j = 0; j < o.out.size(); ++j) e.out[j] = o.out[j].at(i);
    Utility::compute(e);
    for (std::size_t j = 0; j < o.out.size(); ++j) o.out[j].at(i) = e.out[j];
  }
  return o.out;
}

/// Runs a call; buffers, where it works on them, exist only meanwhile.
template <typename Shape, typename T>
void run(const form_of<Shape, T>& form, sycl::queue& queue, operands<Shape, T>& o,
         vm::enums::mode mode) {
  if (form.where == memory::buffer) {
    o.for_each_array([](operand<T>& array) {
      array.buffer = std::make_shared<sycl::buffer<T, 1>>(array.data.data(),
                                                          sycl::range<1>(array.data.size()));
    });
  }
  form.call(queue, o, mode).wait_and_throw();
  o.for_each_array([](operand<T>& array) { array.buffer.reset(); });  // writes back to `data`
}

template <typename T>
bool same_bits(const T& a, const T& b) {
  return std::memcmp(&a, &b, sizeof(T)) == 0;
}

/// Compares bit by bit, the elements that the call leaves alone included.
template <typename Outputs>
void expect_outputs(const Outputs& expected, const Outputs& got) {
  int shown = 0;
  for (std::size_t j = 0; j < expected.size(); ++j) {
    ASSERT_EQ(expected[j].data.size(), got[j].data.size());
    for (std::size_t e = 0; e < expected[j].data.size() && shown < 5; ++e) {
      if (same_bits(expected[j].data[e], got[j].data[e])) continue;
      ++shown;
      ADD_FAILURE() << "output " << j << ", array element " << e << ": " << got[j].data[e]
                    << ", expected " << expected[j].data[e];
    }
  }
}

}  // namespace arbor::lumen::tests::utilities
