// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Scalar bodies over whole arrays, as a host kernel runs them: the main path vectorised over
/// blocks of 512 bytes, the rare path only for flagged elements of blocks that hold any.
#pragma once

#include <algorithm>
#include <cstdint>

#include "scalar/protocol.hpp"

namespace bench {

namespace scalar = arbor::lumen::vm::detail::gpu::norvane::scalar;

template <typename T>
inline constexpr std::int64_t block = 512 / sizeof(T);

/// How many vectors of a body are in flight at once: four hide the latency of the chains of fma,
/// unless the body says that so many do not fit into the registers.
template <typename Body>
constexpr int interleave() {
  if constexpr (requires { Body::interleave; }) return Body::interleave;
  return 4;
}

#if defined(__clang__)
#define LUMEN_BLOCK_LOOP _Pragma("clang loop interleave_count(in_flight)")
#else
#define LUMEN_BLOCK_LOOP
#endif

/// One input, one output.
template <typename Body, typename T>
struct loop_v11 {
  using element = T;
  static constexpr int inputs = 1;

  static void run(const T* const* in, T* y, std::int64_t n) {
    const T* const x = in[0];
    for (std::int64_t first = 0; first < n; first += block<T>) whole_block(x + first, y + first);
  }

 private:
  static void whole_block(const T* __restrict x, T* __restrict y) {
    [[maybe_unused]] constexpr int in_flight = interleave<Body>();
    scalar::uint_of<T> flags = 0;
    LUMEN_BLOCK_LOOP
    for (std::int64_t i = 0; i < block<T>; ++i) {
      const auto result = Body::main(x[i]);
      y[i] = result.value;
      flags |= result.rare;
    }
    if constexpr (requires(T a) { Body::rare(a, &a); }) {
      if (flags != 0) repair(x, y);
    }
  }

  [[gnu::noinline, gnu::cold]] static void repair(const T* __restrict x, T* __restrict y) requires
      requires(T a) {
    Body::rare(a, &a);
  }
  {
    scalar::uint_of<T> flags[block<T>];
    for (std::int64_t i = 0; i < block<T>; ++i) flags[i] = Body::main(x[i]).rare;
    for (std::int64_t i = 0; i < block<T>; ++i) {
      if (flags[i] != 0) Body::rare(x[i], y + i);
    }
  }
};

/// Two inputs, one output.
template <typename Body, typename T>
struct loop_v21 {
  using element = T;
  static constexpr int inputs = 2;

  static void run(const T* const* in, T* y, std::int64_t n) {
    for (std::int64_t first = 0; first < n; first += block<T>)
      whole_block(in[0] + first, in[1] + first, y + first);
  }

 private:
  static void whole_block(const T* __restrict a, const T* __restrict b, T* __restrict y) {
    [[maybe_unused]] constexpr int in_flight = interleave<Body>();
    scalar::uint_of<T> flags = 0;
    LUMEN_BLOCK_LOOP
    for (std::int64_t i = 0; i < block<T>; ++i) {
      const auto result = Body::main(a[i], b[i]);
      y[i] = result.value;
      flags |= result.rare;
    }
    if constexpr (requires(T x) { Body::rare(x, x, &x); }) {
      if (flags != 0) repair(a, b, y);
    }
  }

  [[gnu::noinline, gnu::cold]] static void repair(const T* __restrict a, const T* __restrict b,
                                                  T* __restrict y) requires requires(T x) {
    Body::rare(x, x, &x);
  }
  {
    scalar::uint_of<T> flags[block<T>];
    for (std::int64_t i = 0; i < block<T>; ++i) flags[i] = Body::main(a[i], b[i]).rare;
    for (std::int64_t i = 0; i < block<T>; ++i) {
      if (flags[i] != 0) Body::rare(a[i], b[i], y + i);
    }
  }
};

/// The loop of a functor by the base of its body, so that functors that share a body share a loop.
template <typename Body, typename T>
loop_v11<Body, T> loop_of(const scalar::scalar_v11<Body, T>*);
template <typename Body, typename T>
loop_v21<Body, T> loop_of(const scalar::scalar_v21<Body, T>*);
void loop_of(...);

template <typename F>
using loop = decltype(loop_of(static_cast<const F*>(nullptr)));

}  // namespace bench
