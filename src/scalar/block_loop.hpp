// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Bodies over whole arrays on a processor: the main path vectorised over blocks of 512 bytes, the
/// rare path only for the flagged elements of blocks that hold any. Results are those of the
/// functor's `call`, element by element.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <type_traits>
#include <utility>

#include "scalar/half.hpp"
#include "scalar/half_conversion.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// How many vectors of a body are in flight at once: with two, most bodies fit into the registers;
/// one that is a single long chain of fma says that it needs four to hide their latency.
template <typename Body>
constexpr int interleave() {
  if constexpr (requires { Body::interleave; }) return Body::interleave;
  return 2;
}

#if defined(__clang__)
#define LUMEN_BLOCK_LOOP _Pragma("clang loop interleave_count(in_flight)")
#else
#define LUMEN_BLOCK_LOOP
#endif

/// Of one or two inputs and one or two outputs. Every function returns the status masks of all
/// elements ored.
template <typename Body, typename T, typename U, int Inputs, int Outputs>
class block_loop {
 public:
  using input_type = T;
  using output_type = U;
  static constexpr int inputs = Inputs;
  static constexpr int outputs = Outputs;
  static constexpr std::int64_t length = 512 / std::max(sizeof(T), sizeof(U));

  /// Computes `n` elements of whole arrays. An output may be the same array as an input.
  static std::uint32_t run(std::int64_t n, const T* const (&in)[Inputs], U* const (&out)[Outputs]) {
    std::int64_t first = 0;
    std::uint32_t status = 0;
    if (are_apart(n, in, out)) {
      status |= whole_blocks<length>(first, n, in, out);
      status |= whole_blocks<piece>(first, n, in, out);
    } else {
      for (; n - first >= length; first += length)
        status |= copied_block<length>(length, first, in, unit, out, unit);
    }
    for (; first < n; first += piece) {
      const std::int64_t count = std::min(piece, n - first);
      status |= copied_block<piece>(count, first, in, unit, out, unit);
    }
    return status;
  }

  /// The same with the distances between the elements of each operand, zero and negative ones
  /// included.
  static std::uint32_t run_strided(std::int64_t n, const T* const (&in)[Inputs],
                                   const std::int64_t* in_increments, U* const (&out)[Outputs],
                                   const std::int64_t* out_increments) {
    std::int64_t first = 0;
    std::uint32_t status = 0;
    for (; n - first >= length; first += length)
      status |= copied_block<length>(length, first, in, in_increments, out, out_increments);
    for (; first < n; first += piece) {
      const std::int64_t count = std::min(piece, n - first);
      status |= copied_block<piece>(count, first, in, in_increments, out, out_increments);
    }
    return status;
  }

 private:
  using flag = typename rare_flag<U>::type;

  /// The length of the blocks behind the last whole one: a vector or a few.
  static constexpr std::int64_t piece = length / 8;
  static constexpr std::int64_t unit[] = {1, 1};

  [[gnu::always_inline]] static inline auto main(const T* a, [[maybe_unused]] const T* b,
                                                 std::int64_t i) {
    if constexpr (Inputs == 1)
      return Body::main(load(a + i));
    else
      return Body::main(load(a + i), load(b + i));
  }

  static constexpr bool has_rare = requires(T x, U* y) { Body::rare(x, y); }
  || requires(T x, U* y) { Body::rare(x, y, y); }
  || requires(T x, U* y) { Body::rare(x, x, y); };

  static constexpr bool has_beyond = requires(T x) { Body::beyond(x); }
  || requires(T x) { Body::beyond(x, x); };

  static std::uint32_t rare(const T* a, [[maybe_unused]] const T* b, U* y, [[maybe_unused]] U* z,
                            std::int64_t i) {
    const T x = load(a + i);
    if constexpr (Inputs == 2)
      return Body::rare(x, load(b + i), y + i);
    else if constexpr (Outputs == 2)
      return Body::rare(x, y + i, z + i);
    else
      return Body::rare(x, y + i);
  }

  /// `b` and `z` are null where there is one input, or one output.
  template <std::int64_t Length>
  [[gnu::always_inline]] static inline std::uint32_t block(const T* __restrict a,
                                                           const T* __restrict b, U* __restrict y,
                                                           [[maybe_unused]] U* __restrict z) {
    if constexpr (has_fma && Length == length && requires { Body::template block<Length>(a, y); }) {
      if (Body::template block<Length>(a, y)) [[likely]]
        return 0;
    }
    [[maybe_unused]] constexpr int in_flight = Length == length ? interleave<Body>() : 1;
    // Without a rare path the flags are the status.
    using flags_type = std::conditional_t<has_rare, loop_flag<U>, flag>;
    flags_type flags = 0;
    LUMEN_BLOCK_LOOP
    for (std::int64_t i = 0; i < Length; ++i) {
      const auto result = main(a, b, i);
      if constexpr (Outputs == 1) {
        store(y + i, result.value);
      } else {
        store(y + i, result.first);
        store(z + i, result.second);
      }
      flags |= static_cast<flags_type>(result.rare);
    }
    if constexpr (has_rare) {
      if (flags != 0) [[unlikely]]
        return repair(Length, a, b, y, z);
      return 0;
    }
    return static_cast<std::uint32_t>(flags);
  }

  /// As many blocks as there are from `first` on, which is advanced.
  template <std::int64_t Length>
  static std::uint32_t whole_blocks(std::int64_t& first, std::int64_t n,
                                    const T* const (&in)[Inputs], U* const (&out)[Outputs]) {
    std::uint32_t status = 0;
    for (; n - first >= Length; first += Length)
      status |= block<Length>(in[0] + first, second(in, first), out[0] + first, second(out, first));
    return status;
  }

  /// The second array from its element `first` on; null where there is one array.
  template <typename E, int N>
  static E* second([[maybe_unused]] E* const (&arrays)[N], [[maybe_unused]] std::int64_t first) {
    if constexpr (N == 2)
      return arrays[1] + first;
    else
      return nullptr;
  }

  /// The flags alone, once more, and the rare path where one is set. Where the body has a main path
  /// for arguments beyond the first one's reach, and many of a whole block are flagged, that one
  /// goes before.
  [[gnu::noinline, gnu::cold]] static std::uint32_t repair(std::int64_t count,
                                                           const T* __restrict a,
                                                           const T* __restrict b, U* __restrict y,
                                                           U* __restrict z) {
    flag flags[length];
    std::uint32_t status = 0;
    for (std::int64_t i = 0; i < count; ++i) flags[i] = main(a, b, i).rare;
    if constexpr (has_beyond) {
      if (count == length && length - std::count(flags, flags + length, 0) > length / 8)
        status |= beyond(a, b, y, flags);
    }
    for (std::int64_t i = 0; i < count; ++i) {
      if (flags[i] != 0) status |= rare(a, b, y, z, i);
    }
    return status;
  }

  /// The second main path for the flagged elements; leaves the flags of those it does not serve.
  [[gnu::noinline]] static std::uint32_t beyond(const T* __restrict a,
                                                [[maybe_unused]] const T* __restrict b,
                                                U* __restrict y, flag* __restrict flags) {
    [[maybe_unused]] constexpr int in_flight = 2;
    flag status = 0;
    LUMEN_BLOCK_LOOP
    for (std::int64_t i = 0; i < length; ++i) {
      const auto result = [&] {
        if constexpr (Inputs == 2)
          return Body::beyond(load(a + i), load(b + i));
        else
          return Body::beyond(load(a + i));
      }();
      const bool served = flags[i] == 0;
      store(y + i, select(served, load(y + i), result.value));
      flags[i] = select(served, flag{0}, result.rare);
      if constexpr (requires { result.status; })
        status |= select(served || result.rare != 0, flag{0}, result.status);
    }
    return static_cast<std::uint32_t>(status);
  }

  /// Elements that are apart, fewer than a block, or written over an input: through local blocks.
  /// What a short block lacks is filled with its first element.
  template <std::int64_t Length>
  static std::uint32_t copied_block(std::int64_t count, std::int64_t first,
                                    const T* const (&in)[Inputs], const std::int64_t* in_increments,
                                    U* const (&out)[Outputs], const std::int64_t* out_increments) {
    T a[Inputs][Length];
    U y[Outputs][Length];
    for (int k = 0; k < Inputs; ++k) {
      std::fill_n(a[k], Length, in[k][first * in_increments[k]]);
      copy(count, in[k] + first * in_increments[k], in_increments[k], a[k], 1);
    }
    const std::uint32_t status = block<Length>(a[0], Inputs == 2 ? a[Inputs - 1] : nullptr, y[0],
                                               Outputs == 2 ? y[Outputs - 1] : nullptr);
    for (int k = 0; k < Outputs; ++k)
      copy(count, y[k], 1, out[k] + first * out_increments[k], out_increments[k]);
    return status;
  }

  template <typename E>
  static void copy(std::int64_t count, const E* from, std::int64_t from_increment, E* to,
                   std::int64_t to_increment) {
    if (from_increment == 1 && to_increment == 1) {
      std::copy_n(from, count, to);
      return;
    }
    for (std::int64_t i = 0; i < count; ++i) to[i * to_increment] = from[i * from_increment];
  }

  static bool are_apart(std::int64_t n, const T* const (&in)[Inputs], U* const (&out)[Outputs]) {
    const auto begin = [](const auto* p) { return reinterpret_cast<std::uintptr_t>(p); };
    bool apart = true;
    for (const T* a : in) {
      for (const U* y : out)
        apart = apart && (begin(a + n) <= begin(y) || begin(y + n) <= begin(a));
    }
    return apart;
  }
};

/// The loop of a functor, by the base of its body, so that functors with one body share a loop;
/// void for one that has no main path of this form.
template <typename Body, typename T, typename U>
block_loop<Body, T, U, 1, 1> block_loop_by_base(const scalar_v11<Body, T, U>*);
template <typename Body, typename T, typename U>
block_loop<Body, T, U, 1, 2> block_loop_by_base(const scalar_v12<Body, T, U>*);
template <typename Body, typename T, typename U>
block_loop<Body, T, U, 2, 1> block_loop_by_base(const scalar_v21<Body, T, U>*);
template <typename Body, typename T, typename U>
block_loop<Body, T, U, 2, 1> block_loop_by_base(const scalar_v21c<Body, T, U>*);
void block_loop_by_base(...);

template <typename Functor>
using block_loop_of = decltype(block_loop_by_base(static_cast<const Functor*>(nullptr)));

/// Halves by a body on floats: whole blocks are widened, computed and narrowed.
template <typename Body, half_element Element, int Inputs, int Outputs>
class half_block_loop {
 public:
  using input_type = Element;
  using output_type = Element;
  static constexpr int inputs = Inputs;
  static constexpr int outputs = Outputs;

  static std::uint32_t run(std::int64_t n, const Element* const (&in)[Inputs],
                           Element* const (&out)[Outputs]) {
    return run(n, in, out, std::make_index_sequence<Inputs>{}, std::make_index_sequence<Outputs>{});
  }

 private:
  using float_loop = block_loop<Body, float, float, Inputs, Outputs>;
  static constexpr std::int64_t length = 4 * float_loop::length;

  template <std::size_t... I, std::size_t... O>
  static std::uint32_t run(std::int64_t n, const Element* const (&in)[Inputs],
                           Element* const (&out)[Outputs], std::index_sequence<I...>,
                           std::index_sequence<O...>) {
    float a[Inputs][length];
    float y[Outputs][length];
    std::uint32_t status = 0;
    for (std::int64_t first = 0; first < n; first += length) {
      const std::int64_t count = std::min(length, n - first);
      (widen_block(in[I] + first, a[I], count), ...);
      status |= float_loop::run(count, {a[I]...}, {y[O]...});
      (narrow_block(y[O], out[O] + first, count), ...);
    }
    return status;
  }
};

/// The same for functors on halves, in arrays of `Element`.
template <typename Element, typename Body>
half_block_loop<Body, Element, 1, 1> half_block_loop_by_base(const half_v11<Body>*);
template <typename Element, typename Body>
half_block_loop<Body, Element, 1, 2> half_block_loop_by_base(const half_v12<Body>*);
template <typename Element, typename Body>
half_block_loop<Body, Element, 2, 1> half_block_loop_by_base(const half_v21<Body>*);
template <typename Element>
void half_block_loop_by_base(...);

template <typename Functor, typename Element>
using half_block_loop_of =
    decltype(half_block_loop_by_base<Element>(static_cast<const Functor*>(nullptr)));

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
