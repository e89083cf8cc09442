// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <compare>
#include <cstddef>
#include <cstdint>
#include <iterator>
#include <limits>
#include <type_traits>

#include "../access.hpp"
#include "../id.hpp"
#include "../range.hpp"
#include "region.hpp"

namespace sycl::detail {

template <int Dimensions>
constexpr std::size_t row_major(const range<Dimensions>& shape, const id<Dimensions>& index) {
  std::size_t linear = index[0];
  for (int d = 1; d < Dimensions; ++d) linear = linear * shape[d] + index[d];
  return linear;
}

/// Goes through the elements of a box inside an array of two or three dimensions, row by row.
template <typename T, int Dimensions>
class box_iterator {
 public:
  using iterator_category = std::random_access_iterator_tag;
  using value_type = std::remove_cv_t<T>;
  using difference_type = std::ptrdiff_t;
  using pointer = T*;
  using reference = T&;

  constexpr box_iterator() noexcept = default;
  constexpr box_iterator(T* data, const range<Dimensions>& memory, const range<Dimensions>& box,
                         difference_type position) noexcept
      : data_(data), memory_(memory), box_(box), position_(position) {}

  constexpr reference operator*() const noexcept {
    auto rest = static_cast<std::size_t>(position_);
    id<Dimensions> index;
    for (int d = Dimensions - 1; d > 0; --d) {
      index[d] = rest % box_[d];
      rest /= box_[d];
    }
    index[0] = rest;
    return data_[row_major(memory_, index)];
  }
  constexpr pointer operator->() const noexcept { return &**this; }
  constexpr reference operator[](difference_type n) const noexcept { return *(*this + n); }

  constexpr box_iterator& operator+=(difference_type n) noexcept {
    position_ += n;
    return *this;
  }
  constexpr box_iterator& operator-=(difference_type n) noexcept { return *this += -n; }
  constexpr box_iterator& operator++() noexcept { return *this += 1; }
  constexpr box_iterator& operator--() noexcept { return *this -= 1; }
  constexpr box_iterator operator++(int) noexcept {
    const box_iterator before = *this;
    ++*this;
    return before;
  }
  constexpr box_iterator operator--(int) noexcept {
    const box_iterator before = *this;
    --*this;
    return before;
  }
  friend constexpr box_iterator operator+(box_iterator a, difference_type n) noexcept {
    return a += n;
  }
  friend constexpr box_iterator operator+(difference_type n, box_iterator a) noexcept {
    return a += n;
  }
  friend constexpr box_iterator operator-(box_iterator a, difference_type n) noexcept {
    return a -= n;
  }
  friend constexpr difference_type operator-(const box_iterator& a,
                                             const box_iterator& b) noexcept {
    return a.position_ - b.position_;
  }
  friend constexpr bool operator==(const box_iterator& a, const box_iterator& b) noexcept {
    return a.position_ == b.position_;
  }
  friend constexpr auto operator<=>(const box_iterator& a, const box_iterator& b) noexcept {
    return a.position_ <=> b.position_;
  }

 private:
  T* data_ = nullptr;
  range<Dimensions> memory_{};
  range<Dimensions> box_{};
  difference_type position_ = 0;
};

/// Two subscripts short of an element of three dimensions, or one of two.
template <typename T, int Dimensions>
class subscript {
 public:
  constexpr subscript(T* data, const range<Dimensions>& memory, std::size_t index) noexcept
      : data_(data), memory_(memory), linear_(index) {}
  constexpr decltype(auto) operator[](std::size_t index) const noexcept {
    if constexpr (Dimensions == 2) {
      return (data_[linear_ * memory_[1] + index]);
    } else {
      const range<2> rest(memory_[1], memory_[2]);
      return subscript<T, 2>(data_, rest, linear_ * memory_[1] + index);
    }
  }

 private:
  T* data_;
  range<Dimensions> memory_;
  std::size_t linear_;
};

/// What accessors of both kinds are: a typed window on a region. Holds no resources, so that
/// kernels that use it stay trivially copyable.
template <typename DataT, int Dimensions, access_mode Mode>
class accessor_base {
 protected:
  static constexpr int rank = rank_v<Dimensions>;

 public:
  using value_type = std::conditional_t<Mode == access_mode::read, const DataT, DataT>;
  using reference = value_type&;
  using const_reference = const DataT&;
  using iterator = std::conditional_t<rank == 1, value_type*, box_iterator<value_type, rank>>;
  using const_iterator =
      std::conditional_t<rank == 1, const DataT*, box_iterator<const DataT, rank>>;
  using reverse_iterator = std::reverse_iterator<iterator>;
  using const_reverse_iterator = std::reverse_iterator<const_iterator>;
  using difference_type = typename std::iterator_traits<iterator>::difference_type;
  using size_type = std::size_t;
  static constexpr int dimensions = Dimensions;

  std::size_t byte_size() const noexcept { return size() * sizeof(DataT); }
  std::size_t size() const noexcept { return box_.size(); }
  std::size_t max_size() const noexcept {
    return std::numeric_limits<std::ptrdiff_t>::max() / sizeof(DataT);
  }
  /// The deprecated name of size().
  std::size_t get_count() const noexcept { return size(); }
  bool empty() const noexcept { return size() == 0; }
  range<rank> get_range() const noexcept requires(Dimensions > 0) { return box_; }
  id<rank> get_offset() const noexcept requires(Dimensions > 0) { return offset_; }

  reference operator[](id<rank> index) const noexcept requires(Dimensions > 0) {
    return data_[row_major(memory_, index)];
  }
  subscript<value_type, rank> operator[](std::size_t index) const noexcept
      requires(Dimensions > 1) {
    return {data_, memory_, index};
  }
  operator reference() const noexcept requires(Dimensions == 0) { return *data_; }

  /// The first element of the region.
  std::add_pointer_t<value_type> get_pointer() const noexcept { return data_; }

  iterator begin() const noexcept { return at<iterator>(0); }
  iterator end() const noexcept { return at<iterator>(size()); }
  const_iterator cbegin() const noexcept { return at<const_iterator>(0); }
  const_iterator cend() const noexcept { return at<const_iterator>(size()); }
  reverse_iterator rbegin() const noexcept { return reverse_iterator(end()); }
  reverse_iterator rend() const noexcept { return reverse_iterator(begin()); }
  const_reverse_iterator crbegin() const noexcept { return const_reverse_iterator(cend()); }
  const_reverse_iterator crend() const noexcept { return const_reverse_iterator(cbegin()); }

  /// The bytes of the buffer to which the accessor belongs, for the runtime.
  const region& bytes() const noexcept { return bytes_; }
  std::uint64_t number() const noexcept { return number_; }

 protected:
  accessor_base() noexcept = default;
  accessor_base(const region& bytes, const range<rank>& memory, const range<rank>& box,
                const id<rank>& offset, const property_list& properties)
      : memory_(memory), box_(box), offset_(offset), bytes_(bytes), number_(new_accessor_number()) {
    check_access(Mode, properties);
    for (int d = 0; d < rank; ++d) check_access_range(memory[d], offset[d], box[d]);
    data_ = static_cast<value_type*>(region_data(bytes)) + row_major(memory, offset);
  }
  template <typename OtherT, access_mode OtherMode>
  explicit accessor_base(const accessor_base<OtherT, Dimensions, OtherMode>& other) noexcept
      : data_(other.data_),
        memory_(other.memory_),
        box_(other.box_),
        offset_(other.offset_),
        bytes_(other.bytes_),
        number_(other.number_) {}

 private:
  template <typename, int, access_mode>
  friend class accessor_base;

  template <typename Iterator>
  Iterator at(std::size_t position) const noexcept {
    if constexpr (rank == 1) {
      return data_ + position;
    } else {
      return {data_, memory_, box_, static_cast<std::ptrdiff_t>(position)};
    }
  }

  static constexpr range<rank> nothing() noexcept {
    if constexpr (rank == 1)
      return range<1>(0);
    else if constexpr (rank == 2)
      return range<2>(0, 0);
    else
      return range<3>(0, 0, 0);
  }

  value_type* data_ = nullptr;
  range<rank> memory_ = nothing();
  range<rank> box_ = nothing();
  id<rank> offset_{};
  region bytes_{};
  std::uint64_t number_ = 0;
};

}  // namespace sycl::detail
