// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <sycl/sycl.hpp>
#include <vector>

#include "call/input.hpp"
#include "device/kernels.hpp"
#include "device/sycl_portability.hpp"
#include "device/tuning_info.hpp"

/// Launchers: one per shape and functor. A launcher moves host memory to the device, submits one
/// kernel over the elements of a call and returns its event.
///
/// Only the three submissions know the functor; everything around them is compiled once per shape
/// and pair of element types, in launch.cpp.
namespace arbor::lumen::vm::detail::gpu::norvane {

using events = std::vector<sycl::event>;

/// A call on buffers, as its submission needs it.
template <typename Shape, typename T, typename U>
struct buffer_call {
  const input::typed_vxx<T, U>& record;
  std::array<T, Shape::constants> constants;
  strided_context<Shape, U> context;
};

/// The submissions of the three kernels of one functor.
template <typename Shape, typename T, typename U>
struct kernel_set {
  sycl::event (*usm_linear)(sycl::queue&, const events&, const arguments<Shape, T, U>&,
                            std::int64_t count);
  sycl::event (*usm_strided)(sycl::queue&, const events&, const arguments<Shape, T, U>&,
                             enums::status* storage, const strided_context<Shape, U>&);
  sycl::event (*buffer_strided)(sycl::queue&, const buffer_call<Shape, T, U>&);
};

/// Runs a call on the kernels of a functor: the fast path for whole arrays without status, else the
/// path of its form.
/// @throws std::runtime_error if the record is not of this shape and these element types
/// @throws sycl::exception (errc::nd_range) for 2^31 elements or more, after staging
template <typename Shape, typename T, typename U>
sycl::event launch(const input::vxx& record, const kernel_set<Shape, T, U>& kernels);

/// Work items are numbered in 31 bits, so that index arithmetic in kernels stays cheap.
void require_31_bits(std::int64_t count);

/// Makes `group` wait for the events that the caller named.
void depend_on(sycl::handler& group, const events& depends);

template <typename Shape, typename T, typename U, typename Functor>
sycl::event submit_usm_linear(sycl::queue& queue, const events& depends,
                              const arguments<Shape, T, U>& args, std::int64_t count) {
  return queue.submit([&](sycl::handler& group) {
    depend_on(group, depends);
    require_31_bits(count);
    portability::parallel_for(group, count, usm::linear<false, Shape, T, U, Functor>(args));
  });
}

template <typename Shape, typename T, typename U, typename Functor>
sycl::event submit_usm_strided(sycl::queue& queue, const events& depends,
                               const arguments<Shape, T, U>& args, enums::status* storage,
                               const strided_context<Shape, U>& context) {
  return queue.submit([&](sycl::handler& group) {
    depend_on(group, depends);
    require_31_bits(context.stride.count);
    portability::parallel_for(group, context.stride.count,
                              usm::strided<true, Shape, T, U, Functor>(args, storage, context));
  });
}

template <typename Shape, typename T, typename U, typename Functor>
sycl::event submit_buffer_strided(sycl::queue& queue, const buffer_call<Shape, T, U>& call) {
  using kernel = buffer::strided<true, Shape, T, U, Functor>;
  return queue.submit([&](sycl::handler& group) {
    const auto inputs = [&]<std::size_t... I>(std::index_sequence<I...>) {
      return std::array<typename kernel::input, Shape::inputs>{
          typename kernel::input(call.record.in_buffer(I), group, sycl::read_only)...};
    }
    (input_indices<Shape>{});
    const auto outputs = [&]<std::size_t... O>(std::index_sequence<O...>) {
      return std::array<typename kernel::output, Shape::outputs>{
          typename kernel::output(call.record.out_buffer(O), group, sycl::write_only)...};
    }
    (output_indices<Shape>{});
    auto status_buffer = call.record.handler.status_buffer;
    const typename kernel::status storage(status_buffer, group, sycl::write_only);
    require_31_bits(call.context.stride.count);
    portability::parallel_for(group, call.context.stride.count,
                              kernel(inputs, call.constants, outputs, storage, call.context));
  });
}

template <typename Shape, typename T, typename U, typename Functor>
inline constexpr kernel_set<Shape, T, U> kernels_of{&submit_usm_linear<Shape, T, U, Functor>,
                                                    &submit_usm_strided<Shape, T, U, Functor>,
                                                    &submit_buffer_strided<Shape, T, U, Functor>};

/// The launcher of a functor, as family tables hold it, on arrays of `T` and `U`.
template <typename Shape, typename Functor, typename T = typename Functor::input_type,
          typename U = typename Functor::output_type>
sycl::event launcher(const input::vxx& record, TuningInfo) {
  return launch<Shape, T, U>(record, kernels_of<Shape, T, U, Functor>);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane
