// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <type_traits>

#include "id.hpp"
#include "range.hpp"

namespace sycl {

namespace detail {
struct item_factory;
}

/// One instance of a kernel over a range: its coordinates, the range, and the offset of the
/// range's first coordinate where the kernel was submitted with one.
template <int Dimensions = 1, bool WithOffset = true>
class item {
 public:
  static constexpr int dimensions = Dimensions;

  item() = delete;

  constexpr id<Dimensions> get_id() const noexcept { return id_; }
  constexpr std::size_t get_id(int dimension) const noexcept { return id_[dimension]; }
  constexpr std::size_t operator[](int dimension) const noexcept { return id_[dimension]; }
  constexpr operator std::size_t() const noexcept requires(Dimensions == 1) { return id_[0]; }

  constexpr range<Dimensions> get_range() const noexcept { return range_; }
  constexpr std::size_t get_range(int dimension) const noexcept { return range_[dimension]; }

  constexpr id<Dimensions> get_offset() const noexcept requires WithOffset { return offset_; }

  constexpr operator item<Dimensions, true>() const noexcept requires(!WithOffset) {
    return item<Dimensions, true>(range_, id_, id<Dimensions>());
  }

  /// The position in the range, row-major, counted from the first work-item: in [0, size).
  constexpr std::size_t get_linear_id() const noexcept {
    std::size_t linear = 0;
    for (int d = 0; d < Dimensions; ++d) {
      std::size_t coordinate = id_[d];
      if constexpr (WithOffset) coordinate -= offset_[d];
      linear = linear * range_[d] + coordinate;
    }
    return linear;
  }

  friend constexpr bool operator==(const item& a, const item& b) noexcept {
    if constexpr (WithOffset) {
      if (!(a.offset_ == b.offset_)) return false;
    }
    return a.id_ == b.id_ && a.range_ == b.range_;
  }

 private:
  friend struct detail::item_factory;
  template <int OtherDimensions, bool OtherOffset>
  friend class item;

  struct no_offset {};
  using offset_type = std::conditional_t<WithOffset, id<Dimensions>, no_offset>;

  constexpr item(const range<Dimensions>& extents, const id<Dimensions>& index,
                 offset_type offset) noexcept
      : id_(index), range_(extents), offset_(offset) {}

  id<Dimensions> id_;
  range<Dimensions> range_;
  [[no_unique_address]] offset_type offset_;
};

namespace detail {

struct item_factory {
  template <int Dimensions>
  static constexpr item<Dimensions, false> make(const range<Dimensions>& extents,
                                                const id<Dimensions>& index) noexcept {
    return item<Dimensions, false>(extents, index, {});
  }
  template <int Dimensions>
  static constexpr item<Dimensions, true> make(const range<Dimensions>& extents,
                                               const id<Dimensions>& index,
                                               const id<Dimensions>& offset) noexcept {
    return item<Dimensions, true>(extents, index, offset);
  }
};

/// The item of a kernel without an offset; for the code that runs kernels.
template <int Dimensions>
constexpr item<Dimensions, false> make_item(const range<Dimensions>& extents,
                                            const id<Dimensions>& index) noexcept {
  return item_factory::make(extents, index);
}

/// The item of a kernel with an offset; `index` includes the offset.
template <int Dimensions>
constexpr item<Dimensions, true> make_item(const range<Dimensions>& extents,
                                           const id<Dimensions>& index,
                                           const id<Dimensions>& offset) noexcept {
  return item_factory::make(extents, index, offset);
}

}  // namespace detail

}  // namespace sycl
