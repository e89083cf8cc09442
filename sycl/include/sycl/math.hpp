// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <bit>
#include <climits>
#include <cmath>
#include <cstdint>
#include <limits>
#include <numbers>
#include <type_traits>

#include "bit_cast.hpp"
#include "half.hpp"

// The scalar built-in functions. A floating-point function is three plain overloads, so that
// arguments convert as they do for any function: pow(x, 2) is a float where x is one. At half,
// functions are evaluated in float and rounded once, unless that would round twice.

namespace sycl {

namespace detail {

/// An integer type of the built-ins: any but bool.
template <typename T>
concept geninteger = std::is_integral_v<T> && !std::is_same_v<T, bool>;

template <typename T>
concept genfloat = std::is_same_v<T, float> || std::is_same_v<T, double> || std::is_same_v<T, half>;

template <typename T>
concept genscalar = genfloat<T> || geninteger<T>;

/// x reduced exactly to a quarter of a turn and a rest of at most an eighth of one, for sin(πx)
/// and cos(πx).
struct half_turns {
  explicit half_turns(double x) {
    const double turn = std::fmod(std::fabs(x), 2.0);
    const double nearest = std::rint(2 * turn);
    quarter = static_cast<int>(nearest) & 3;
    rest = std::numbers::pi * (turn - nearest / 2);
  }
  /// sin(π|x|); its zeros are positive.
  double sine() const {
    const double s = (quarter & 1) != 0 ? std::cos(rest) : std::sin(rest);
    return (quarter & 2) != 0 ? 0.0 - s : s;
  }
  /// cos(πx); its zeros are positive.
  double cosine() const {
    const double c = (quarter & 1) != 0 ? std::sin(rest) : std::cos(rest);
    return quarter == 1 || quarter == 2 ? 0.0 - c : c;
  }
  int quarter;
  double rest;
};

inline double sinpi(double x) {
  if (!std::isfinite(x)) return x - x;
  return std::copysign(1.0, x) * half_turns(x).sine();
}
inline double cospi(double x) { return std::isfinite(x) ? half_turns(x).cosine() : x - x; }
inline double tanpi(double x) {
  if (!std::isfinite(x)) return x - x;
  const half_turns turns(x);
  return std::copysign(1.0, x) * turns.sine() / turns.cosine();
}

/// One Newton step on the C library's result, which may be four units in the last place off
/// where two are allowed.
inline double cbrt(double x) {
  if (x == 0 || !std::isfinite(x)) return x;
  const bool tiny = std::fabs(x) < 0x1p-800;  // y^3 - x must not underflow
  if (tiny) x *= 0x1p300;
  double y = std::cbrt(x);
  const double square = y * y;
  const double residual = std::fma(square, y, -x) + std::fma(y, y, -square) * y;
  y -= residual / (3 * square);
  return tiny ? y * 0x1p-100 : y;
}

/// x^y by exp(y log x): undefined for negative x, and wherever that product is 0 * infinity.
template <typename T>
T powr(T x, T y) {
  const bool invalid = std::isnan(x) || std::isnan(y) || x < 0 ||
                       (y == 0 && (x == 0 || std::isinf(x))) || (x == 1 && std::isinf(y));
  return invalid ? std::numeric_limits<T>::quiet_NaN() : std::pow(std::fabs(x), y);
}

/// The real n-th root. Wide is precise enough that the rounding of 1/n does not show.
template <typename Wide, typename T>
T rootn(T x, int n) {
  const bool odd = (n & 1) != 0;
  if (n == 0 || (x < 0 && !odd)) return std::numeric_limits<T>::quiet_NaN();
  const Wide root = std::pow(static_cast<Wide>(std::fabs(x)), 1 / static_cast<Wide>(n));
  return static_cast<T>(odd ? std::copysign(root, static_cast<Wide>(x)) : root);
}

}  // namespace detail

// Functions that the C++ library has under the same name.
#define SYCL_DETAIL_STD_1(name)                                  \
  inline float name(float x) noexcept { return std::name(x); }   \
  inline double name(double x) noexcept { return std::name(x); } \
  inline half name(half x) noexcept { return half(std::name(static_cast<float>(x))); }
#define SYCL_DETAIL_STD_2(name)                                               \
  inline float name(float x, float y) noexcept { return std::name(x, y); }    \
  inline double name(double x, double y) noexcept { return std::name(x, y); } \
  inline half name(half x, half y) noexcept {                                 \
    return half(std::name(static_cast<float>(x), static_cast<float>(y)));     \
  }
// Functions of one or two values by an expression in double, rounded once at float and half.
#define SYCL_DETAIL_VIA_DOUBLE_1(name, expression)                                                 \
  inline double name(double x) noexcept { return expression; }                                     \
  inline float name(float x) noexcept { return static_cast<float>(name(static_cast<double>(x))); } \
  inline half name(half x) noexcept { return half(name(static_cast<double>(x))); }
#define SYCL_DETAIL_VIA_DOUBLE_2(name, expression)                                   \
  inline double name(double x, double y) noexcept { return expression; }             \
  inline float name(float x, float y) noexcept {                                     \
    return static_cast<float>(name(static_cast<double>(x), static_cast<double>(y))); \
  }                                                                                  \
  inline half name(half x, half y) noexcept {                                        \
    return half(name(static_cast<double>(x), static_cast<double>(y)));               \
  }
#define SYCL_DETAIL_RELATION_1(name, float_expression, half_expression) \
  inline bool name(float x) noexcept { return float_expression; }       \
  inline bool name(double x) noexcept { return float_expression; }      \
  inline bool name(half x) noexcept {                                   \
    const unsigned pattern = bit_cast<std::uint16_t>(x);                \
    return half_expression;                                             \
  }
#define SYCL_DETAIL_RELATION_2(name, expression)                       \
  inline bool name(float x, float y) noexcept { return expression; }   \
  inline bool name(double x, double y) noexcept { return expression; } \
  inline bool name(half x, half y) noexcept { return expression; }

// Classes and comparisons. Halves are told by their patterns: their denormals are normal floats.
SYCL_DETAIL_RELATION_1(isnan, std::isnan(x), (pattern & 0x7FFFU) > 0x7C00U)
SYCL_DETAIL_RELATION_1(isinf, std::isinf(x), (pattern & 0x7FFFU) == 0x7C00U)
SYCL_DETAIL_RELATION_1(isfinite, std::isfinite(x), (pattern & 0x7FFFU) < 0x7C00U)
SYCL_DETAIL_RELATION_1(isnormal, std::isnormal(x),
                       (pattern & 0x7FFFU) - 0x0400U < 0x7C00U - 0x0400U)
SYCL_DETAIL_RELATION_1(signbit, std::signbit(x), (pattern & 0x8000U) != 0)
SYCL_DETAIL_RELATION_2(isequal, x == y)
SYCL_DETAIL_RELATION_2(isnotequal, x != y)
SYCL_DETAIL_RELATION_2(isgreater, std::isgreater(x, y))
SYCL_DETAIL_RELATION_2(isgreaterequal, std::isgreaterequal(x, y))
SYCL_DETAIL_RELATION_2(isless, std::isless(x, y))
SYCL_DETAIL_RELATION_2(islessequal, std::islessequal(x, y))
SYCL_DETAIL_RELATION_2(islessgreater, std::islessgreater(x, y))
SYCL_DETAIL_RELATION_2(isordered, !isnan(x) && !isnan(y))
SYCL_DETAIL_RELATION_2(isunordered, isnan(x) || isnan(y))

// Exponentials, logarithms, powers.
SYCL_DETAIL_STD_1(exp)
SYCL_DETAIL_STD_1(exp2)
SYCL_DETAIL_STD_1(expm1)
SYCL_DETAIL_VIA_DOUBLE_1(exp10, std::pow(10.0, x))
SYCL_DETAIL_STD_1(log)
SYCL_DETAIL_STD_1(log2)
SYCL_DETAIL_STD_1(log10)
SYCL_DETAIL_STD_1(log1p)
SYCL_DETAIL_STD_1(logb)
SYCL_DETAIL_STD_1(sqrt)
inline float cbrt(float x) noexcept { return std::cbrt(x); }
inline double cbrt(double x) noexcept { return detail::cbrt(x); }
inline half cbrt(half x) noexcept { return half(std::cbrt(static_cast<float>(x))); }
SYCL_DETAIL_VIA_DOUBLE_1(rsqrt, 1.0 / std::sqrt(x))
SYCL_DETAIL_STD_2(pow)
SYCL_DETAIL_STD_2(hypot)
inline float powr(float x, float y) noexcept { return detail::powr(x, y); }
inline double powr(double x, double y) noexcept { return detail::powr(x, y); }
inline half powr(half x, half y) noexcept {
  return half(powr(static_cast<float>(x), static_cast<float>(y)));
}
inline double pown(double x, int n) noexcept { return std::pow(x, static_cast<double>(n)); }
inline float pown(float x, int n) noexcept {
  return static_cast<float>(pown(static_cast<double>(x), n));
}
inline half pown(half x, int n) noexcept { return half(pown(static_cast<double>(x), n)); }
inline double rootn(double x, int n) noexcept { return detail::rootn<long double>(x, n); }
inline float rootn(float x, int n) noexcept { return detail::rootn<double>(x, n); }
inline half rootn(half x, int n) noexcept { return half(rootn(static_cast<float>(x), n)); }

// Trigonometric and hyperbolic functions and their inverses.
SYCL_DETAIL_STD_1(sin)
SYCL_DETAIL_STD_1(cos)
SYCL_DETAIL_STD_1(tan)
SYCL_DETAIL_STD_1(asin)
SYCL_DETAIL_STD_1(acos)
SYCL_DETAIL_STD_1(atan)
SYCL_DETAIL_STD_2(atan2)
SYCL_DETAIL_STD_1(sinh)
SYCL_DETAIL_STD_1(cosh)
SYCL_DETAIL_STD_1(tanh)
SYCL_DETAIL_STD_1(asinh)
SYCL_DETAIL_STD_1(acosh)
SYCL_DETAIL_STD_1(atanh)
SYCL_DETAIL_VIA_DOUBLE_1(sinpi, detail::sinpi(x))
SYCL_DETAIL_VIA_DOUBLE_1(cospi, detail::cospi(x))
SYCL_DETAIL_VIA_DOUBLE_1(tanpi, detail::tanpi(x))
SYCL_DETAIL_VIA_DOUBLE_1(asinpi, std::asin(x) / std::numbers::pi)
SYCL_DETAIL_VIA_DOUBLE_1(acospi, std::acos(x) / std::numbers::pi)
SYCL_DETAIL_VIA_DOUBLE_1(atanpi, std::atan(x) / std::numbers::pi)
SYCL_DETAIL_VIA_DOUBLE_2(atan2pi, std::atan2(x, y) / std::numbers::pi)
template <detail::genfloat T>
T sincos(T x, T* cosine) noexcept {
  *cosine = sycl::cos(x);
  return sycl::sin(x);
}

// Special functions.
SYCL_DETAIL_STD_1(erf)
SYCL_DETAIL_STD_1(erfc)
SYCL_DETAIL_STD_1(tgamma)
// std::lgamma leaves the sign in a global variable, where concurrent kernels would race for it.
inline float lgamma_r(float x, int* sign) noexcept { return ::lgammaf_r(x, sign); }
inline double lgamma_r(double x, int* sign) noexcept { return ::lgamma_r(x, sign); }
inline half lgamma_r(half x, int* sign) noexcept {
  return half(::lgammaf_r(static_cast<float>(x), sign));
}
#define SYCL_DETAIL_LGAMMA(T)     \
  inline T lgamma(T x) noexcept { \
    int sign = 0;                 \
    return lgamma_r(x, &sign);    \
  }
SYCL_DETAIL_LGAMMA(float)
SYCL_DETAIL_LGAMMA(double)
SYCL_DETAIL_LGAMMA(half)

// Rounding and remainders; all of these are exact.
SYCL_DETAIL_STD_1(ceil)
SYCL_DETAIL_STD_1(floor)
SYCL_DETAIL_STD_1(rint)
SYCL_DETAIL_STD_1(round)
SYCL_DETAIL_STD_1(trunc)
SYCL_DETAIL_STD_2(fmod)
SYCL_DETAIL_STD_2(remainder)
inline float remquo(float x, float y, int* quotient) noexcept {
  return std::remquo(x, y, quotient);
}
inline double remquo(double x, double y, int* quotient) noexcept {
  return std::remquo(x, y, quotient);
}
inline half remquo(half x, half y, int* quotient) noexcept {
  return half(std::remquo(static_cast<float>(x), static_cast<float>(y), quotient));
}

/// a * b + c, rounded once.
inline float fma(float a, float b, float c) noexcept { return std::fma(a, b, c); }
inline double fma(double a, double b, double c) noexcept { return std::fma(a, b, c); }
inline half fma(half a, half b, half c) noexcept {
  // The product has 22 bits. Where the sum exceeds double's 53, one term is so much smaller that
  // it cannot reach the nearest midpoint of halves, so that only the last rounding matters.
  return half(static_cast<double>(a) * static_cast<double>(b) + static_cast<double>(c));
}
/// Fused here, so that results are the same on every processor.
inline float mad(float a, float b, float c) noexcept { return fma(a, b, c); }
inline double mad(double a, double b, double c) noexcept { return fma(a, b, c); }
inline half mad(half a, half b, half c) noexcept { return fma(a, b, c); }

// Parts of the representation.
inline float fabs(float x) noexcept { return std::fabs(x); }
inline double fabs(double x) noexcept { return std::fabs(x); }
inline half fabs(half x) noexcept {
  return bit_cast<half>(static_cast<std::uint16_t>(bit_cast<std::uint16_t>(x) & 0x7FFFU));
}
inline float copysign(float x, float y) noexcept { return std::copysign(x, y); }
inline double copysign(double x, double y) noexcept { return std::copysign(x, y); }
inline half copysign(half x, half y) noexcept {
  return bit_cast<half>(static_cast<std::uint16_t>((bit_cast<std::uint16_t>(x) & 0x7FFFU) |
                                                   (bit_cast<std::uint16_t>(y) & 0x8000U)));
}
inline float ldexp(float x, int k) noexcept { return std::ldexp(x, k); }
inline double ldexp(double x, int k) noexcept { return std::ldexp(x, k); }
inline half ldexp(half x, int k) noexcept {
  // Beyond 100 either way the result is zero or infinite; within, double is exact.
  return half(std::ldexp(static_cast<double>(x), k < -100 ? -100 : (k > 100 ? 100 : k)));
}
inline int ilogb(float x) noexcept { return std::ilogb(x); }
inline int ilogb(double x) noexcept { return std::ilogb(x); }
inline int ilogb(half x) noexcept { return std::ilogb(static_cast<float>(x)); }
inline float frexp(float x, int* exponent) noexcept { return std::frexp(x, exponent); }
inline double frexp(double x, int* exponent) noexcept { return std::frexp(x, exponent); }
inline half frexp(half x, int* exponent) noexcept {
  return half(std::frexp(static_cast<float>(x), exponent));
}
inline float modf(float x, float* integral) noexcept { return std::modf(x, integral); }
inline double modf(double x, double* integral) noexcept { return std::modf(x, integral); }
inline half modf(half x, half* integral) noexcept {
  float part = 0;
  const half fraction(std::modf(static_cast<float>(x), &part));
  *integral = half(part);
  return fraction;
}
inline float nextafter(float x, float y) noexcept { return std::nextafter(x, y); }
inline double nextafter(double x, double y) noexcept { return std::nextafter(x, y); }
inline half nextafter(half x, half y) noexcept {
  if (isunordered(x, y)) return x + y;
  if (x == y) return y;
  const auto pattern = bit_cast<std::uint16_t>(x);
  if ((pattern & 0x7FFFU) == 0) {
    return copysign(std::numeric_limits<half>::denorm_min(), y);
  }
  const bool away_from_zero = (x < y) == (pattern < 0x8000U);
  return bit_cast<half>(static_cast<std::uint16_t>(away_from_zero ? pattern + 1U : pattern - 1U));
}
/// A quiet NaN with the low bits of `code` as its payload.
inline float nan(std::uint32_t code) noexcept {
  return bit_cast<float>(0x7FC00000U | (code & 0x003FFFFFU));
}
inline double nan(std::uint64_t code) noexcept {
  return bit_cast<double>(0x7FF8000000000000U | (code & 0x0007FFFFFFFFFFFFU));
}
inline half nan(std::uint16_t code) noexcept {
  return bit_cast<half>(static_cast<std::uint16_t>(0x7E00U | (code & 0x01FFU)));
}

// Minima, maxima, differences.
SYCL_DETAIL_STD_2(fmin)
SYCL_DETAIL_STD_2(fmax)
SYCL_DETAIL_STD_2(fdim)
template <detail::genfloat T>
T maxmag(T x, T y) noexcept {
  const T a = sycl::fabs(x);
  const T b = sycl::fabs(y);
  return a > b ? x : (b > a ? y : sycl::fmax(x, y));
}
template <detail::genfloat T>
T minmag(T x, T y) noexcept {
  const T a = sycl::fabs(x);
  const T b = sycl::fabs(y);
  return a < b ? x : (b < a ? y : sycl::fmin(x, y));
}
/// x - floor(x), below 1 also where that would round to 1; the floor goes to `integral`.
template <detail::genfloat T>
T fract(T x, T* integral) noexcept {
  *integral = sycl::floor(x);
  if (isnan(x)) return x;
  if (isinf(x)) return sycl::copysign(T(0), x);
  const T below_one = sycl::nextafter(T(1), T(0));
  const T fraction = x - *integral;
  return sycl::copysign(fraction < below_one ? fraction : below_one, x == T(0) ? x : T(1));
}

// Common functions.
#define SYCL_DETAIL_COMMON(T)                                                    \
  inline T min(T x, T y) noexcept { return y < x ? y : x; }                      \
  inline T max(T x, T y) noexcept { return x < y ? y : x; }                      \
  inline T clamp(T x, T low, T high) noexcept { return min(max(x, low), high); } \
  inline T step(T edge, T x) noexcept { return T(x < edge ? 0 : 1); }            \
  inline T sign(T x) noexcept { return x > 0 ? T(1) : (x < 0 ? T(-1) : (x == 0 ? x : T(0))); }
SYCL_DETAIL_COMMON(float)
SYCL_DETAIL_COMMON(double)
SYCL_DETAIL_COMMON(half)

#define SYCL_DETAIL_BLEND(T)                                                            \
  inline T degrees(T x) noexcept { return static_cast<T>(180 / std::numbers::pi) * x; } \
  inline T radians(T x) noexcept { return static_cast<T>(std::numbers::pi / 180) * x; } \
  inline T mix(T x, T y, T a) noexcept { return x + (y - x) * a; }                      \
  inline T smoothstep(T edge0, T edge1, T x) noexcept {                                 \
    const T t = clamp((x - edge0) / (edge1 - edge0), T(0), T(1));                       \
    return t * t * (3 - 2 * t);                                                         \
  }
SYCL_DETAIL_BLEND(float)
SYCL_DETAIL_BLEND(double)
inline half degrees(half x) noexcept { return half(degrees(static_cast<float>(x))); }
inline half radians(half x) noexcept { return half(radians(static_cast<float>(x))); }
inline half mix(half x, half y, half a) noexcept {
  return half(mix(static_cast<float>(x), static_cast<float>(y), static_cast<float>(a)));
}
inline half smoothstep(half edge0, half edge1, half x) noexcept {
  return half(
      smoothstep(static_cast<float>(edge0), static_cast<float>(edge1), static_cast<float>(x)));
}

#undef SYCL_DETAIL_STD_1
#undef SYCL_DETAIL_STD_2
#undef SYCL_DETAIL_VIA_DOUBLE_1
#undef SYCL_DETAIL_VIA_DOUBLE_2
#undef SYCL_DETAIL_RELATION_1
#undef SYCL_DETAIL_RELATION_2
#undef SYCL_DETAIL_LGAMMA
#undef SYCL_DETAIL_COMMON
#undef SYCL_DETAIL_BLEND

/// b where the condition holds, otherwise a.
template <detail::genscalar T, typename Condition>
requires std::is_integral_v<Condition>
constexpr T select(T a, T b, Condition c) noexcept { return c ? b : a; }

// Integer functions; those that can overflow without saturating wrap around.

namespace detail {

template <geninteger T>
inline constexpr int bit_width = CHAR_BIT * sizeof(T);

__extension__ typedef __int128 int128;
__extension__ typedef unsigned __int128 uint128;

/// An integer that holds a product of two T and one T more.
template <geninteger T>
using product_t = std::conditional_t<std::is_signed_v<T>,
                                     std::conditional_t<(sizeof(T) < 8), std::int64_t, int128>,
                                     std::conditional_t<(sizeof(T) < 8), std::uint64_t, uint128>>;

template <geninteger T>
constexpr std::make_unsigned_t<T> to_unsigned(T x) noexcept {
  return static_cast<std::make_unsigned_t<T>>(x);
}

}  // namespace detail

template <detail::geninteger T>
constexpr T min(T x, T y) noexcept {
  return y < x ? y : x;
}
template <detail::geninteger T>
constexpr T max(T x, T y) noexcept {
  return x < y ? y : x;
}
template <detail::geninteger T>
constexpr T clamp(T x, T low, T high) noexcept {
  return min(max(x, low), high);
}
template <detail::geninteger T>
constexpr T abs(T x) noexcept {
  return x < 0 ? static_cast<T>(0 - detail::to_unsigned(x)) : x;
}
template <detail::geninteger T>
constexpr T abs_diff(T x, T y) noexcept {
  const auto a = detail::to_unsigned(x);
  const auto b = detail::to_unsigned(y);
  return static_cast<T>(x < y ? b - a : a - b);
}
template <detail::geninteger T>
constexpr T add_sat(T x, T y) noexcept {
  T sum = 0;
  if (!__builtin_add_overflow(x, y, &sum)) return sum;
  return x < 0 ? std::numeric_limits<T>::min() : std::numeric_limits<T>::max();
}
template <detail::geninteger T>
constexpr T sub_sat(T x, T y) noexcept {
  T difference = 0;
  if (!__builtin_sub_overflow(x, y, &difference)) return difference;
  return std::is_unsigned_v<T> || x < 0 ? std::numeric_limits<T>::min()
                                        : std::numeric_limits<T>::max();
}
/// (x + y) / 2, rounded down.
template <detail::geninteger T>
constexpr T hadd(T x, T y) noexcept {
  return static_cast<T>((x & y) + ((x ^ y) >> 1));
}
/// (x + y) / 2, rounded up.
template <detail::geninteger T>
constexpr T rhadd(T x, T y) noexcept {
  return static_cast<T>((x | y) - ((x ^ y) >> 1));
}
/// The upper half of the product.
template <detail::geninteger T>
constexpr T mul_hi(T x, T y) noexcept {
  using wide = detail::product_t<T>;
  return static_cast<T>((static_cast<wide>(x) * static_cast<wide>(y)) >> detail::bit_width<T>);
}
template <detail::geninteger T>
constexpr T mad_hi(T a, T b, T c) noexcept {
  return static_cast<T>(detail::to_unsigned(mul_hi(a, b)) + detail::to_unsigned(c));
}
template <detail::geninteger T>
constexpr T mad_sat(T a, T b, T c) noexcept {
  using wide = detail::product_t<T>;
  using limits = std::numeric_limits<T>;
  const wide sum = static_cast<wide>(a) * static_cast<wide>(b) + static_cast<wide>(c);
  if (sum < static_cast<wide>(limits::min())) return limits::min();
  return sum > static_cast<wide>(limits::max()) ? limits::max() : static_cast<T>(sum);
}
/// The number of leading zeros; the width for 0.
template <detail::geninteger T>
constexpr T clz(T x) noexcept {
  return static_cast<T>(std::countl_zero(detail::to_unsigned(x)));
}
/// The number of trailing zeros; the width for 0.
template <detail::geninteger T>
constexpr T ctz(T x) noexcept {
  return static_cast<T>(std::countr_zero(detail::to_unsigned(x)));
}
template <detail::geninteger T>
constexpr T popcount(T x) noexcept {
  return static_cast<T>(std::popcount(detail::to_unsigned(x)));
}
/// Rotates to the left by `count` modulo the width.
template <detail::geninteger T>
constexpr T rotate(T x, T count) noexcept {
  const auto bits = static_cast<int>(detail::to_unsigned(count) % detail::bit_width<T>);
  return static_cast<T>(std::rotl(detail::to_unsigned(x), bits));
}

/// Each bit of b where c has a one, of a where it has a zero.
template <detail::geninteger T>
constexpr T bitselect(T a, T b, T c) noexcept {
  return static_cast<T>((a & ~c) | (b & c));
}
inline float bitselect(float a, float b, float c) noexcept {
  return bit_cast<float>(bitselect(bit_cast<std::uint32_t>(a), bit_cast<std::uint32_t>(b),
                                   bit_cast<std::uint32_t>(c)));
}
inline double bitselect(double a, double b, double c) noexcept {
  return bit_cast<double>(bitselect(bit_cast<std::uint64_t>(a), bit_cast<std::uint64_t>(b),
                                    bit_cast<std::uint64_t>(c)));
}
inline half bitselect(half a, half b, half c) noexcept {
  return bit_cast<half>(bitselect(bit_cast<std::uint16_t>(a), bit_cast<std::uint16_t>(b),
                                  bit_cast<std::uint16_t>(c)));
}

/// Functions whose precision an implementation may choose: here that of the precise ones.
namespace native {

inline float cos(float x) noexcept { return sycl::cos(x); }
inline float divide(float x, float y) noexcept { return x / y; }
inline float exp(float x) noexcept { return sycl::exp(x); }
inline float exp2(float x) noexcept { return sycl::exp2(x); }
inline float exp10(float x) noexcept { return sycl::exp10(x); }
inline float log(float x) noexcept { return sycl::log(x); }
inline float log2(float x) noexcept { return sycl::log2(x); }
inline float log10(float x) noexcept { return sycl::log10(x); }
inline float powr(float x, float y) noexcept { return sycl::powr(x, y); }
inline float recip(float x) noexcept { return 1.0F / x; }
inline float rsqrt(float x) noexcept { return sycl::rsqrt(x); }
inline float sin(float x) noexcept { return sycl::sin(x); }
inline float sqrt(float x) noexcept { return sycl::sqrt(x); }
inline float tan(float x) noexcept { return sycl::tan(x); }

}  // namespace native

/// The same functions at no less than half's precision.
namespace half_precision = native;

}  // namespace sycl
