// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>

#include "call/arguments.hpp"
#include "call/operand_list.hpp"
#include "host/error_handler.hpp"

/// The arguments of a host call as plain memory: what an executor makes of a record of a call, and
/// runs. It lives for the span of that.
namespace arbor::lumen::vm::detail::classic::input {

/// What every host call has.
class vxx {
 public:
  vxx(std::string_view name_, std::int64_t mode_, std::int64_t n_, error_handler* handler_)
      : name(name_), handler(handler_), mode(mode_), n(n_) {}
  virtual ~vxx();

  /// Whether the number of elements can be worked on.
  /// @throws invalid_argument if it is negative and `throw_on_error` is set; else returns false
  virtual bool check(bool throw_on_error) const;
  virtual bool has_slices() const { return false; }

  std::string_view name;
  void* interop = nullptr;  ///< the interop object of an offload entry; null for SYCL calls
  error_handler* handler;   ///< null if there is none
  std::int64_t mode;        ///< accuracy for the array-math layer
  std::int64_t n;

 protected:
  [[noreturn]] void reject_index(const char* message) const;
};

template <typename T, typename U>
class typed_vxx : public vxx {
 public:
  using vxx::vxx;

  const T* ptr_in(std::size_t i) const {
    return at(in_pointers, i, "ptr_in: index of input is too large");
  }
  U* ptr_out(std::size_t i) const {
    return at(out_pointers, i, "ptr_out: index of output is too large");
  }

  operand_list<const T*> in_pointers;
  operand_list<U*> out_pointers;

 protected:
  template <typename V>
  V at(const operand_list<V>& list, std::size_t i, const char* message) const {
    if (i >= list.size()) reject_index(message);
    return list[i];
  }
};

/// What computes `n` elements, whole arrays or with increments.
template <typename Shape, typename T, typename U>
struct host_entries {
  using operands = arguments<Shape, T, U>;
  void (*linear)(std::int64_t n, const operands&, std::int64_t mode);
  void (*strided)(std::int64_t n, const operands&, const increments<Shape>&, std::int64_t mode);
};

/// The bit of the mode that makes kernels report errors.
inline constexpr std::int64_t reports_errors = LUMEN_ARR_CALLBACK;

/// Whole arrays.
template <typename Shape, typename T, typename U>
class linear final : public typed_vxx<T, U> {
 public:
  using typed_vxx<T, U>::typed_vxx;
  void run(const host_entries<Shape, T, U>& entries, const std::array<T, Shape::constants>& c) {
    arguments<Shape, T, U> args{};
    args.constants = c;
    for (std::size_t k = 0; k < Shape::inputs; ++k) args.in[k] = this->ptr_in(k);
    for (std::size_t j = 0; j < Shape::outputs; ++j) args.out[j] = this->ptr_out(j);
    const std::int64_t count = std::max<std::int64_t>(this->n, 0);
    if (this->handler == nullptr || !this->handler->active)
      return entries.linear(count, args, this->mode);
    const installed_handler installed(*this->handler);
    entries.linear(count, args, this->mode | reports_errors);
  }
};

/// Slices. A short input is read again from its start until the output is full: a run is one pass
/// over the last input, over which every operand has one increment. Under the cyclic policy the
/// earlier inputs stand still meanwhile. A call ends with the run that the last input is too long
/// for; it is empty where the passes fill the output exactly.
template <typename Shape, typename T, typename U>
class strided final : public typed_vxx<T, U> {
 public:
  using typed_vxx<T, U>::typed_vxx;
  bool has_slices() const override { return !i_sizes.empty() || !o_sizes.empty(); }

  std::int64_t i_start(std::size_t i) const {
    return this->at(i_starts, i, "i_start: index of input is too large");
  }
  std::int64_t i_stride(std::size_t i) const {
    return this->at(i_strides, i, "i_stride: index of input is too large");
  }
  std::int64_t i_size(std::size_t i) const {
    return this->at(i_sizes, i, "i_size: index of input is too large");
  }
  std::int64_t o_start(std::size_t i) const {
    return this->at(o_starts, i, "o_start: index of input is too large");
  }
  std::int64_t o_stride(std::size_t i) const {
    return this->at(o_strides, i, "o_stride: index of input is too large");
  }
  std::int64_t o_size(std::size_t i) const {
    return this->at(o_sizes, i, "o_size: index of input is too large");
  }

  void run(const host_entries<Shape, T, U>& entries, const std::array<T, Shape::constants>& c) {
    std::optional<installed_handler> installed;
    std::int64_t entry_mode = this->mode;
    if (this->handler != nullptr && this->handler->active) {
      installed.emplace(*this->handler);
      entry_mode |= reports_errors;
    }
    constexpr std::size_t last = Shape::inputs > 0 ? Shape::inputs - 1 : 0;
    arguments<Shape, T, U> args{};
    args.constants = c;
    increments<Shape> inc{};
    for (std::size_t j = 0; j < Shape::outputs; ++j) inc.out[j] = o_stride(j);
    for (std::size_t k = 0; k < Shape::inputs; ++k)
      inc.in[k] = cyclic && k != last ? 0 : i_stride(k);

    const std::int64_t count = std::max<std::int64_t>(this->n, 0);
    std::int64_t pass = std::max<std::int64_t>(count, 1);
    if constexpr (Shape::inputs > 0) {
      if (count > 0) pass = i_size(last);
    }
    for (std::int64_t done = 0; done <= count; done += pass) {
      for (std::size_t k = 0; k < Shape::inputs; ++k) {
        const std::int64_t element = count > 0 ? (done / i_divisors[k]) % i_size(k) : 0;
        args.in[k] = this->ptr_in(k) + i_start(k) + element * i_stride(k);
      }
      for (std::size_t j = 0; j < Shape::outputs; ++j)
        args.out[j] = this->ptr_out(j) + o_start(j) + done * o_stride(j);
      entries.strided(std::min(pass, count - done), args, inc, entry_mode);
    }
  }

  operand_list<std::int64_t> i_starts, i_strides, i_sizes, o_starts, o_strides, o_sizes;
  operand_list<std::int64_t> i_divisors;  ///< how many runs in a row begin at the same element
  bool cyclic = false;
};

}  // namespace arbor::lumen::vm::detail::classic::input
