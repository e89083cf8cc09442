// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <bit>
#include <cmath>
#include <complex>
#include <cstdint>
#include <sycl/sycl.hpp>

#include "arbor/lumen/vm/error_handler.hpp"

/// What a kernel does with the status of an element: report it and, if asked to, replace the
/// results.
namespace arbor::lumen::vm::detail::device {

/// The reporting and repairing half of a handler, copied by value into the kernel.
template <typename U>
struct fixup_args {
  U value;
  U second_value;  ///< for a second output: completes `value` to the unit circle, sqrt(1 - value^2)
  std::uint32_t status_to_fix;
  bool copy_sign;
  std::int64_t length;
};

inline double complement_on_circle(double value) { return std::sqrt(1.0 - value * value); }
inline std::complex<double> complement_on_circle(std::complex<double> value) {
  return std::sqrt(1.0 - value * value);
}

template <typename U>
U second_value_of(U value) {
  return static_cast<U>(complement_on_circle(static_cast<double>(value)));
}
template <typename R>
std::complex<R> second_value_of(std::complex<R> value) {
  return std::complex<R>(complement_on_circle(std::complex<double>(value)));
}

/// A handler that is not enabled reports and replaces nothing.
template <typename U>
fixup_args<U> fixup_of(const error_handler<U>& handler) {
  if (!handler.enabled) return {};
  return {handler.fixup_value, second_value_of(handler.fixup_value), handler.status_to_fix,
          handler.copy_sign, handler.length};
}

/// |magnitude| with the sign bit of `sign`, on patterns, so that NaNs and zeros have signs too.
inline float with_sign(float magnitude, float sign) { return std::copysign(magnitude, sign); }
inline double with_sign(double magnitude, double sign) { return std::copysign(magnitude, sign); }
inline sycl::half with_sign(sycl::half magnitude, sycl::half sign) {
  const auto m = std::bit_cast<std::uint16_t>(magnitude);
  const auto s = std::bit_cast<std::uint16_t>(sign);
  return std::bit_cast<sycl::half>(static_cast<std::uint16_t>((m & 0x7fff) | (s & 0x8000)));
}
template <typename R>
std::complex<R> with_sign(std::complex<R> magnitude, std::complex<R> sign) {
  return {with_sign(magnitude.real(), sign.real()), with_sign(magnitude.imag(), sign.imag())};
}
/// A real input has an imaginary part of +0.
template <typename R>
std::complex<R> with_sign(std::complex<R> magnitude, R sign) {
  return with_sign(magnitude, std::complex<R>(sign, R(0)));
}
/// The sign of a complex input is that of its real part where the result is real.
template <typename R>
R with_sign(R magnitude, std::complex<R> sign) {
  return with_sign(magnitude, sign.real());
}

/// Ors `status` into a word that other work items may hit at the same time.
inline void or_into(std::uint32_t* word, std::uint32_t status) {
  sycl::atomic_ref<std::uint32_t, sycl::memory_order::relaxed, sycl::memory_scope::device>(*word)
      .fetch_or(status);
}

/// Reports a status that is not 0: into the queue's cell, if there is one, and into the handler's
/// storage. `element` is the index of the first output; storage beyond one cell is indexed by it.
inline void report(std::uint32_t status, std::uint32_t* cell, enums::status* storage,
                   std::int64_t length, std::int64_t element) {
  if (cell != nullptr) or_into(cell, status);
  if (length == 1)
    or_into(reinterpret_cast<std::uint32_t*>(storage), status);
  else if (length > 1)
    storage[element] = static_cast<enums::status>(status);
}

}  // namespace arbor::lumen::vm::detail::device
