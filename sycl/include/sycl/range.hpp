// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <type_traits>

namespace sycl {

namespace detail {

/// Integers that the index types combine with element by element. They are matched exactly, so
/// that `id<1>`, which converts to std::size_t, never competes with the built-in operators.
template <typename T>
concept index_integer = std::is_integral_v<T>;

/// One to three extents or coordinates with element-wise arithmetic; the common part of range
/// and id.
template <typename Derived, int Dimensions>
class index_vector {
  static_assert(Dimensions >= 1 && Dimensions <= 3, "one, two or three dimensions");

 public:
  static constexpr int dimensions = Dimensions;

  constexpr std::size_t get(int dimension) const noexcept { return values_[dimension]; }
  constexpr std::size_t& operator[](int dimension) noexcept { return values_[dimension]; }
  constexpr std::size_t operator[](int dimension) const noexcept { return values_[dimension]; }

  friend constexpr bool operator==(const Derived& a, const Derived& b) noexcept {
    for (int d = 0; d < Dimensions; ++d) {
      if (a[d] != b[d]) return false;
    }
    return true;
  }

// Relational and logical operators yield 0 or 1 per element, as the arithmetic ones yield values.
#define SYCL_DETAIL_INDEX_OPERATOR(op)                                                \
  friend constexpr Derived operator op(const Derived& a, const Derived& b) noexcept { \
    Derived r = a;                                                                    \
    for (int d = 0; d < Dimensions; ++d) r[d] = a[d] op b[d];                         \
    return r;                                                                         \
  }                                                                                   \
  template <index_integer T>                                                          \
  friend constexpr Derived operator op(const Derived& a, T b) noexcept {              \
    Derived r = a;                                                                    \
    for (int d = 0; d < Dimensions; ++d) r[d] = a[d] op static_cast<std::size_t>(b);  \
    return r;                                                                         \
  }                                                                                   \
  template <index_integer T>                                                          \
  friend constexpr Derived operator op(T a, const Derived& b) noexcept {              \
    Derived r = b;                                                                    \
    for (int d = 0; d < Dimensions; ++d) r[d] = static_cast<std::size_t>(a) op b[d];  \
    return r;                                                                         \
  }
  SYCL_DETAIL_INDEX_OPERATOR(+)
  SYCL_DETAIL_INDEX_OPERATOR(-)
  SYCL_DETAIL_INDEX_OPERATOR(*)
  SYCL_DETAIL_INDEX_OPERATOR(/)
  SYCL_DETAIL_INDEX_OPERATOR(%)
  SYCL_DETAIL_INDEX_OPERATOR(<<)
  SYCL_DETAIL_INDEX_OPERATOR(>>)
  SYCL_DETAIL_INDEX_OPERATOR(&)
  SYCL_DETAIL_INDEX_OPERATOR(|)
  SYCL_DETAIL_INDEX_OPERATOR(^)
  SYCL_DETAIL_INDEX_OPERATOR(&&)
  SYCL_DETAIL_INDEX_OPERATOR(||)
  SYCL_DETAIL_INDEX_OPERATOR(<)
  SYCL_DETAIL_INDEX_OPERATOR(>)
  SYCL_DETAIL_INDEX_OPERATOR(<=)
  SYCL_DETAIL_INDEX_OPERATOR(>=)
#undef SYCL_DETAIL_INDEX_OPERATOR

#define SYCL_DETAIL_INDEX_ASSIGNMENT(op)                                         \
  friend constexpr Derived& operator op(Derived& a, const Derived& b) noexcept { \
    for (int d = 0; d < Dimensions; ++d) a[d] op b[d];                           \
    return a;                                                                    \
  }                                                                              \
  template <index_integer T>                                                     \
  friend constexpr Derived& operator op(Derived& a, T b) noexcept {              \
    for (int d = 0; d < Dimensions; ++d) a[d] op static_cast<std::size_t>(b);    \
    return a;                                                                    \
  }
  SYCL_DETAIL_INDEX_ASSIGNMENT(+=)
  SYCL_DETAIL_INDEX_ASSIGNMENT(-=)
  SYCL_DETAIL_INDEX_ASSIGNMENT(*=)
  SYCL_DETAIL_INDEX_ASSIGNMENT(/=)
  SYCL_DETAIL_INDEX_ASSIGNMENT(%=)
  SYCL_DETAIL_INDEX_ASSIGNMENT(<<=)
  SYCL_DETAIL_INDEX_ASSIGNMENT(>>=)
  SYCL_DETAIL_INDEX_ASSIGNMENT(&=)
  SYCL_DETAIL_INDEX_ASSIGNMENT(|=)
  SYCL_DETAIL_INDEX_ASSIGNMENT(^=)
#undef SYCL_DETAIL_INDEX_ASSIGNMENT

  friend constexpr Derived operator+(const Derived& a) noexcept { return a; }
  friend constexpr Derived operator-(const Derived& a) noexcept {
    Derived r = a;
    for (int d = 0; d < Dimensions; ++d) r[d] = std::size_t{0} - a[d];
    return r;
  }
  friend constexpr Derived& operator++(Derived& a) noexcept { return a += std::size_t{1}; }
  friend constexpr Derived& operator--(Derived& a) noexcept { return a -= std::size_t{1}; }
  friend constexpr Derived operator++(Derived& a, int) noexcept {
    const Derived before = a;
    ++a;
    return before;
  }
  friend constexpr Derived operator--(Derived& a, int) noexcept {
    const Derived before = a;
    --a;
    return before;
  }

 protected:
  constexpr index_vector() noexcept = default;
  constexpr explicit index_vector(std::size_t v0) noexcept : values_{v0} {}
  constexpr index_vector(std::size_t v0, std::size_t v1) noexcept : values_{v0, v1} {}
  constexpr index_vector(std::size_t v0, std::size_t v1, std::size_t v2) noexcept
      : values_{v0, v1, v2} {}

 private:
  std::size_t values_[Dimensions] = {};
};

}  // namespace detail

/// The extents of an iteration space or of a buffer; the last dimension varies fastest.
template <int Dimensions = 1>
class range : public detail::index_vector<range<Dimensions>, Dimensions> {
  using base = detail::index_vector<range<Dimensions>, Dimensions>;

 public:
  constexpr range() noexcept = default;
  constexpr range(std::size_t dim0) noexcept requires(Dimensions == 1) : base(dim0) {}
  constexpr range(std::size_t dim0, std::size_t dim1) noexcept requires(Dimensions == 2)
      : base(dim0, dim1) {}
  constexpr range(std::size_t dim0, std::size_t dim1, std::size_t dim2) noexcept
      requires(Dimensions == 3)
      : base(dim0, dim1, dim2) {}

  /// The number of work-items: the product of the extents.
  constexpr std::size_t size() const noexcept {
    std::size_t product = 1;
    for (int d = 0; d < Dimensions; ++d) product *= (*this)[d];
    return product;
  }
};

range(std::size_t)->range<1>;
range(std::size_t, std::size_t)->range<2>;
range(std::size_t, std::size_t, std::size_t)->range<3>;

}  // namespace sycl
