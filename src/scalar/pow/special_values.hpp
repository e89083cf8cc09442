// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The powers of and by zeros, infinities, NaNs, and of negative numbers: what the rare paths sort
/// out before they compute |x|^y.
#pragma once

#include <cstdint>

#include "scalar/pow/parity.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The result, if the operands are special; otherwise the sign of the result, as a bit.
template <typename T>
struct special_power {
  bool found;
  T value;
  code status;
  uint_of<T> sign;

  LUMEN_DEVICE static constexpr special_power of(T value, code status = code::none) {
    return {true, value, status, 0};
  }
  LUMEN_DEVICE static constexpr special_power none(uint_of<T> sign) {
    return {false, T(0), code::none, sign};
  }
};

/// x to an infinite power, x no NaN; only its magnitude counts. Under -infinity zero is outside the
/// domain.
template <typename T>
LUMEN_DEVICE constexpr special_power<T> power_by_infinity(T x, T y) {
  using s = special_power<T>;
  const uint_of<T> ax = bits(x) & format<T>::magnitude;
  if (ax == format<T>::one) return s::of(T(1));
  if ((ax > format<T>::one) == (y > 0))
    return s::of(value(format<T>::special), ax == 0 ? code::domain : code::none);
  return s::of(T(0));
}

/// pow at float. Zero to a negative power is an argument outside the domain and no pole, and -0 to
/// an odd positive power is +0. A NaN result is the negative one without a payload.
struct signed_specials_s {
  LUMEN_DEVICE static special_power<float> of(float x, float y) {
    using s = special_power<float>;
    const float infinity = value(format<float>::special);
    const float nan = value(format<float>::sign | format<float>::nan);
    if (y == 0) return s::of(1.0f);
    if (is_nan(y)) return s::of(x == 1 ? 1.0f : nan);
    if (is_infinite(y)) return is_nan(x) ? s::of(nan) : power_by_infinity(x, y);
    if (x == infinity) return s::of(y < 0 ? 0.0f : infinity);
    if (is_nan(x)) return s::of(nan);
    const parity kind = parity_of(y);
    const std::uint32_t sign = kind == parity::odd ? sign_bit(x) : 0;
    if (x == 0) {
      if (y > 0) return s::of(0.0f);
      return s::of(value(format<float>::special | sign), code::domain);
    }
    if (is_infinite(x)) return s::of(value((y < 0 ? 0 : format<float>::special) | sign));
    if (x < 0 && kind == parity::fraction) return s::of(nan, code::domain);
    if (x == -1) return s::of(value(format<float>::one | sign));
    return s::none(sign);
  }
};

/// pow at double. Zero to a negative power is an argument outside the domain and no pole. A zero
/// keeps its sign under an odd positive power, but a negative power of -infinity is +0.
struct signed_specials_d {
  LUMEN_DEVICE static special_power<double> of(double x, double y) {
    using s = special_power<double>;
    if (x == 1 || y == 0) return s::of(1.0);
    if (is_nan(x) || is_nan(y)) return s::of(x + y);
    const parity kind = parity_of(y);
    const std::uint64_t sign = kind == parity::odd ? sign_bit(x) : 0;
    const std::uint64_t infinity = format<double>::special;
    if (x == 0) {
      if (y > 0) return s::of(value(sign));
      return s::of(value(infinity | sign), code::domain);
    }
    if (x == -1 && kind != parity::fraction) return s::of(value(format<double>::one | sign));
    if (is_infinite(x) || is_infinite(y)) {
      if (fabs(x) < 1) return s::of(y > 0 ? 0.0 : value(infinity));
      return s::of(y > 0 ? value(infinity | sign) : 0.0);
    }
    if (x < 0 && kind == parity::fraction) return s::of(value(format<double>::nan), code::domain);
    return s::none(sign);
  }
};

/// powr. A base with its sign bit set, NaNs included and -0 not, is outside the domain, as is 0^0,
/// the NaN of which has the signs' exclusive or. A NaN to the power 0 is a NaN; 1 to an infinite
/// power is 1.
template <typename T>
struct nonnegative_specials {
  LUMEN_DEVICE static special_power<T> of(T x, T y) {
    using s = special_power<T>;
    using f = format<T>;
    if (bits(x) > f::sign) return s::of(value(f::nan), code::domain);
    if (y == 0) {
      if (x == 0) return s::of(value((bits(x) ^ bits(y)) | f::magnitude), code::domain);
      return is_nan(x) ? s::of(x + x) : s::of(T(1));
    }
    if (is_nan(y)) return s::of(fabs(y));
    if (is_nan(x)) return s::of(value(f::sign | f::nan));
    if (x == 1) return s::of(T(1));
    if (is_infinite(y)) return power_by_infinity(x, y);
    if (is_infinite(x)) return s::of(y < 0 ? T(0) : x);
    if (x == 0) {
      if (y > 0) return s::of(T(0));
      return s::of(value(f::special), code::domain);
    }
    return s::none(0);
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
