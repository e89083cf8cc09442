// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <sycl/sycl.hpp>
#include <type_traits>
#include <utility>

#include "call/arguments.hpp"
#include "call/input.hpp"
#include "device/fixup.hpp"
#include "device/strided_args.hpp"
#include "scalar/block_loop.hpp"

/// The three kernels of every functor. Kernels do no mathematics: they find the elements of one
/// work item, call the functor and deal with the status that it returns.
namespace arbor::lumen::vm::detail::gpu::norvane {

/// A kernel that computes in double says so, so that a device without double refuses it instead of
/// failing in it.
struct needs_fp64 {
  static constexpr std::array required_aspects{sycl::aspect::fp64};
};
struct needs_nothing {};
template <typename Functor>
using requirements = std::conditional_t<Functor::needs_fp64, needs_fp64, needs_nothing>;

/// A functor on halves, in arrays of `T`, that has a loop over blocks.
template <typename Functor, typename T, typename U>
concept has_half_loop = scalar::half_element<T> && std::is_same_v<T, U> &&
    !std::is_void_v<scalar::half_block_loop_of<Functor, T>>;

namespace usm {

/// Contiguous elements, status dropped: no branch but the functor's own.
template <bool WithStatus, typename Shape, typename T, typename U, typename Functor>
struct linear : requirements<Functor> {
  static_assert(!WithStatus, "calls with status run the strided kernel with unit strides");
  explicit linear(const arguments<Shape, T, U>& args) : args_(args) {}

  void operator()(sycl::id<1> item) const {
    run(item[0], input_indices<Shape>{}, output_indices<Shape>{});
  }

  /// The embedded runtime runs stretches of items by this where it is offered: halves in blocks,
  /// whose conversions are vectorised.
  void lumen_run_items(std::size_t begin,
                       std::size_t end) const requires has_half_loop<Functor, T, U> {
    run_blocks(begin, end, input_indices<Shape>{}, output_indices<Shape>{});
  }

 private:
  template <std::size_t... I, std::size_t... O>
  void run_blocks(std::size_t begin, std::size_t end, std::index_sequence<I...>,
                  std::index_sequence<O...>) const {
    scalar::half_block_loop_of<Functor, T>::run(static_cast<std::int64_t>(end - begin),
                                                {args_.in[I] + begin...},
                                                {args_.out[O] + begin...});
  }

  template <std::size_t... I, std::size_t... O>
  void run(std::size_t i, std::index_sequence<I...>, std::index_sequence<O...>) const {
    call_functor<Shape, Functor, T, U>({&args_.in[I][i]...}, args_.constants.data(), i,
                                       {&args_.out[O][i]...});
  }
  arguments<Shape, T, U> args_;
};

}  // namespace usm

/// What a work item with status needs besides its operands.
template <typename Shape, typename U>
struct strided_context {
  device::strided_args<Shape::inputs, Shape::outputs> stride;
  device::fixup_args<U> fixup;
  std::uint32_t* cell;
};

/// One work item of the kernels with strides and status.
template <typename Shape, typename T, typename U, typename Functor, std::size_t... I,
          std::size_t... O>
inline void run_strided(std::int64_t i, [[maybe_unused]] const T* const* in, const T* constants,
                        U* const* out, enums::status* storage,
                        const strided_context<Shape, U>& context, std::index_sequence<I...>,
                        std::index_sequence<O...>) {
  const auto& stride = context.stride;
  const std::array<const T*, sizeof...(I)> a{
      in[I] + ((i / stride.divisor[I]) % stride.in_size[I]) * stride.in_stride[I] +
      stride.in_start[I]...};
  const std::array<U*, sizeof...(O)> y{out[O] + stride.out_stride[O] * i + stride.out_start[O]...};
  const auto index = static_cast<std::size_t>(i);
  if constexpr (sizeof...(I) == 0) {
    call_functor<Shape, Functor, T, U>(a, constants, index, y);
  } else {
    const T first = *a[0];  // in place, the output overwrites it
    const std::uint32_t status = call_functor<Shape, Functor, T, U>(a, constants, index, y);
    if (status == 0) return;
    const auto& fixup = context.fixup;
    device::report(status, context.cell, storage, fixup.length,
                   stride.out_stride[0] * i + stride.out_start[0]);
    if ((fixup.status_to_fix & status) == 0) return;
    *y[0] = fixup.copy_sign ? device::with_sign(fixup.value, first) : fixup.value;
    if constexpr (sizeof...(O) > 1) *y[1] = fixup.second_value;
  }
}

namespace usm {

template <bool WithStatus, typename Shape, typename T, typename U, typename Functor>
struct strided : requirements<Functor> {
  strided(const arguments<Shape, T, U>& args, enums::status* storage,
          const strided_context<Shape, U>& context)
      : args_(args), storage_(storage), context_(context) {}

  void operator()(sycl::id<1> item) const {
    run_strided<Shape, T, U, Functor>(static_cast<std::int64_t>(item[0]), args_.in.data(),
                                      args_.constants.data(), args_.out.data(), storage_, context_,
                                      input_indices<Shape>{}, output_indices<Shape>{});
  }

 private:
  arguments<Shape, T, U> args_;
  enums::status* storage_;
  strided_context<Shape, U> context_;
};

}  // namespace usm

namespace buffer {

/// The same over accessors, which order the command groups and move the data.
template <bool WithStatus, typename Shape, typename T, typename U, typename Functor>
struct strided : requirements<Functor> {
  using input = sycl::accessor<T, 1, sycl::access_mode::read>;
  using output = sycl::accessor<U, 1, sycl::access_mode::write>;
  using status = sycl::accessor<enums::status, 1, sycl::access_mode::write>;

  strided(const std::array<input, Shape::inputs>& in,
          const std::array<T, Shape::constants>& constants,
          const std::array<output, Shape::outputs>& out, const status& storage,
          const strided_context<Shape, U>& context)
      : in_(in), constants_(constants), out_(out), storage_(storage), context_(context) {}

  void operator()(sycl::id<1> item) const {
    run(static_cast<std::int64_t>(item[0]), input_indices<Shape>{}, output_indices<Shape>{});
  }

 private:
  template <std::size_t... I, std::size_t... O>
  void run(std::int64_t i, std::index_sequence<I...> inputs,
           std::index_sequence<O...> outputs) const {
    const std::array<const T*, Shape::inputs> in{in_[I].get_pointer()...};
    const std::array<U*, Shape::outputs> out{out_[O].get_pointer()...};
    run_strided<Shape, T, U, Functor>(i, in.data(), constants_.data(), out.data(),
                                      storage_.get_pointer(), context_, inputs, outputs);
  }

  std::array<input, Shape::inputs> in_;
  std::array<T, Shape::constants> constants_;
  std::array<output, Shape::outputs> out_;
  status storage_;
  strided_context<Shape, U> context_;
};

}  // namespace buffer
}  // namespace arbor::lumen::vm::detail::gpu::norvane
