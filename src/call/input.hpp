// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <algorithm>
#include <complex>
#include <cstddef>
#include <cstdint>
#include <string_view>
#include <sycl/sycl.hpp>
#include <vector>

#include "arbor/lumen/slice.hpp"
#include "arbor/lumen/vm/error_handler.hpp"
#include "call/operand_list.hpp"
#include "call/queue_key.hpp"
#include "call/shape.hpp"

/// The argument record of one call: built on the caller's stack by the exported function, read by
/// the dispatcher and by the launcher that it chose, gone when the function returns.
namespace arbor::lumen::vm::detail {

/// The precision field of a dispatch key for an element type.
template <typename T>
inline constexpr std::uint64_t precision_of = 0xff00000000;
template <>
inline constexpr std::uint64_t precision_of<sycl::half> = 0x100000000;
template <>
inline constexpr std::uint64_t precision_of<float> = 0x400000000;
template <>
inline constexpr std::uint64_t precision_of<double> = 0x800000000;
template <>
inline constexpr std::uint64_t precision_of<std::complex<float>> = 0x1000000000;
template <>
inline constexpr std::uint64_t precision_of<std::complex<double>> = 0x1800000000;

/// The key of a pair of input and output elements: the complex one's where the two differ.
template <typename T, typename U>
inline constexpr std::uint64_t precision_of_pair =
    precision_of<T> < precision_of<U> ? precision_of<U> : precision_of<T>;

/// A caller's error handler as a call keeps it: a copy, so that no reference to the caller's object
/// outlives the exported function's argument list. Of one that is not enabled nothing is taken: it
/// does nothing, and to share its buffer would cost every call.
template <typename T>
class error_handler_x final : public error_handler<T> {
 public:
  /// Does nothing. Kernels on buffers write to the handler's buffer also where it reports nothing,
  /// so that every call needs one of its own.
  error_handler_x() = default;
  explicit error_handler_x(const error_handler<T>& handler) { *this = handler; }
  error_handler_x& operator=(const error_handler<T>& handler) {
    if (handler.enabled) {
      error_handler<T>::operator=(handler);
    } else {
      this->enabled = false;
    }
    return *this;
  }
};

namespace input {

/// What every call has, whatever its element types.
class vxx {
 public:
  virtual ~vxx();

  /// Whether the arguments can be worked on: a queue, a count that is not negative and not beyond
  /// the shortest array of known length.
  /// @throws std::logic_error for a null queue, always
  /// @throws invalid_argument for any other defect, if `throw_on_error` is set; else returns false
  virtual bool check(bool throw_on_error) const;

  /// The precision field of the keys that can serve the call.
  virtual std::uint64_t precision() const;

  /// The element count of a call without slices: `n`, or the length of the shortest array where `n`
  /// is 0 (spans). With slices it is 0 here, and the slices decide.
  std::int64_t effective_count() const;

  bool has_slices() const { return !in_slices.empty() || !out_slices.empty(); }

  std::string_view name;   ///< the public function's name, for messages
  keyed_queue queue;       ///< the caller's queue
  std::int64_t n = 0;      ///< element count; 0 where the form has none
  std::uint32_t mode = 0;  ///< the merged mode word
  std::vector<sycl::event> depends;
  operand_list<slice> in_slices;
  operand_list<slice> out_slices;
  operand_list<std::int64_t> in_lengths;   ///< of spans and buffers
  operand_list<std::int64_t> out_lengths;  ///< of spans and buffers

 protected:
  [[noreturn]] void reject_index(const char* message) const;

 private:
  std::int64_t shortest_length() const;
};

/// Throws `std::logic_error` for the function `name`: a defect of the library or of its caller that
/// no mode makes quiet.
[[noreturn]] void throw_logic_error(std::string_view name, const char* message);

/// The arguments of a call with inputs of `T` and outputs of `U`.
template <typename T, typename U>
class typed_vxx : public vxx {
 public:
  typed_vxx() = default;
  /// The handler is copied.
  explicit typed_vxx(const error_handler<U>& callers) : handler(callers) {}

  bool check(bool throw_on_error) const override;
  std::uint64_t precision() const override { return precision_of_pair<T, U>; }

  const T* in_pointer(std::size_t i) const {
    return at(in_pointers, i, "usm: index of input is too large");
  }
  U* out_pointer(std::size_t i) const {
    return at(out_pointers, i, "usm: index of input is too large");
  }
  sycl::buffer<T, 1>& in_buffer(std::size_t i) const {
    return *at(in_buffers, i, "buffer: index of input is too large");
  }
  sycl::buffer<U, 1>& out_buffer(std::size_t i) const {
    return *at(out_buffers, i, "buffer: index of output is too large");
  }
  T constant(std::size_t i) const { return at(constants, i, "index of constant is too large"); }

  operand_list<sycl::buffer<T, 1>*> in_buffers;
  operand_list<const T*> in_pointers;
  operand_list<T> constants;
  operand_list<sycl::buffer<U, 1>*> out_buffers;
  operand_list<U*> out_pointers;
  error_handler_x<U> handler;

 private:
  template <typename V>
  V at(const operand_list<V>& values, std::size_t i, const char* message) const {
    if (i >= values.size()) reject_index(message);
    return values[i];
  }
};

/// The forms a call can take. A record's type tells its form and its shape.
enum class form { usm_linear, usm_strided, buffer_linear, buffer_strided };

template <form Form, typename Shape, typename T, typename U>
class record final : public typed_vxx<T, U> {
  static_assert(std::max({Shape::inputs, Shape::constants, Shape::outputs}) <=
                static_cast<int>(operand_list<T>::capacity));

 public:
  using typed_vxx<T, U>::typed_vxx;
};

namespace usm {
template <typename Shape, typename T, typename U>
using linear = record<form::usm_linear, Shape, T, U>;
template <typename Shape, typename T, typename U>
using strided = record<form::usm_strided, Shape, T, U>;
}  // namespace usm
namespace buffer {
template <typename Shape, typename T, typename U>
using linear = record<form::buffer_linear, Shape, T, U>;
template <typename Shape, typename T, typename U>
using strided = record<form::buffer_strided, Shape, T, U>;
}  // namespace buffer

}  // namespace input

/// The pairs of element types that calls have: `LUMEN_FOR_EACH_PAIR(M)` is M(T, U) for each.
#define LUMEN_FOR_EACH_PAIR(M)                  \
  M(sycl::half, sycl::half)                     \
  M(float, float)                               \
  M(double, double)                             \
  M(std::complex<float>, std::complex<float>)   \
  M(std::complex<double>, std::complex<double>) \
  M(std::complex<float>, float)                 \
  M(std::complex<double>, double)               \
  M(float, std::complex<float>)                 \
  M(double, std::complex<double>)

}  // namespace arbor::lumen::vm::detail
