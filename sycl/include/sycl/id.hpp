// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>

#include "range.hpp"

namespace sycl {

template <int Dimensions, bool WithOffset>
class item;

/// The coordinates of a work-item or of an element of a buffer.
template <int Dimensions = 1>
class id : public detail::index_vector<id<Dimensions>, Dimensions> {
  using base = detail::index_vector<id<Dimensions>, Dimensions>;

 public:
  /// The origin.
  constexpr id() noexcept = default;
  constexpr id(std::size_t dim0) noexcept requires(Dimensions == 1) : base(dim0) {}
  constexpr id(std::size_t dim0, std::size_t dim1) noexcept requires(Dimensions == 2)
      : base(dim0, dim1) {}
  constexpr id(std::size_t dim0, std::size_t dim1, std::size_t dim2) noexcept
      requires(Dimensions == 3)
      : base(dim0, dim1, dim2) {}
  constexpr id(const range<Dimensions>& extents) noexcept {
    for (int d = 0; d < Dimensions; ++d) (*this)[d] = extents[d];
  }
  template <bool WithOffset>
  constexpr id(const item<Dimensions, WithOffset>& work_item) noexcept : id(work_item.get_id()) {}

  constexpr operator std::size_t() const noexcept requires(Dimensions == 1) { return (*this)[0]; }

  /// Comparison of the one coordinate with an integer; without it, the conversions from and to
  /// std::size_t would be equally good.
  template <detail::index_integer T>
  requires(Dimensions == 1) friend constexpr bool operator==(const id& a, T b) noexcept {
    return a[0] == static_cast<std::size_t>(b);
  }
};

id(std::size_t)->id<1>;
id(std::size_t, std::size_t)->id<2>;
id(std::size_t, std::size_t, std::size_t)->id<3>;
template <int Dimensions, bool WithOffset>
id(item<Dimensions, WithOffset>) -> id<Dimensions>;

}  // namespace sycl
