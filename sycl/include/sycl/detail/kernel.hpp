// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <type_traits>

#include "../item.hpp"

namespace sycl::detail {

/// Runs the work-items [begin, end), counted in row-major order, of a kernel over `extents`.
using kernel_function = void (*)(const void* closure, const std::size_t* extents, std::size_t begin,
                                 std::size_t end);

/// A kernel's closure in the form in which its loop is fastest: a local copy, which no store of
/// the kernel can change, where copying costs nothing but bytes.
template <typename Kernel>
using kernel_view =
    std::conditional_t<std::is_trivially_copyable_v<Kernel> && sizeof(Kernel) <= 1024, const Kernel,
                       const Kernel&>;

template <typename Kernel>
void run_task(const void* closure, const std::size_t*, std::size_t, std::size_t) {
  (*static_cast<const Kernel*>(closure))();
}

template <typename Kernel, int Dimensions>
void run_range(const void* closure, const std::size_t* extents, std::size_t begin,
               std::size_t end) {
  kernel_view<Kernel> kernel = *static_cast<const Kernel*>(closure);
  if constexpr (Dimensions == 1 && requires { kernel.lumen_run_items(begin, end); }) {
    kernel.lumen_run_items(begin, end);
  } else if constexpr (Dimensions == 1) {
    const range<1> shape(extents[0]);
    for (std::size_t i = begin; i < end; ++i) kernel(make_item<1>(shape, id<1>(i)));
  } else {
    const std::size_t columns = extents[Dimensions - 1];
    std::size_t row = begin / columns;
    std::size_t column = begin % columns;
    while (begin < end) {
      const std::size_t last = end - begin < columns - column ? column + (end - begin) : columns;
      begin += last - column;
      if constexpr (Dimensions == 2) {
        const range<2> shape(extents[0], columns);
        for (; column < last; ++column) kernel(make_item<2>(shape, id<2>(row, column)));
      } else {
        const range<3> shape(extents[0], extents[1], columns);
        const std::size_t plane = row / extents[1];
        const std::size_t line = row % extents[1];
        for (; column < last; ++column) kernel(make_item<3>(shape, id<3>(plane, line, column)));
      }
      column = 0;
      ++row;
    }
  }
}

template <typename Closure>
void destroy_closure(void* closure) noexcept {
  static_cast<Closure*>(closure)->~Closure();
}

/// What destroys a closure; null if there is nothing to do.
template <typename Closure>
constexpr auto closure_destructor() noexcept -> void (*)(void*) noexcept {
  if constexpr (std::is_trivially_destructible_v<Closure>) {
    return nullptr;
  } else {
    return &destroy_closure<Closure>;
  }
}

/// The default of the kernel-name template parameters.
class unnamed_kernel;

}  // namespace sycl::detail
