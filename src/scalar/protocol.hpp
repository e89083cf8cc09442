// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// What all scalar functors share: how they are called and what they return.
///
/// A body is written in two parts. `main` is branch-free arithmetic computed for every element,
/// arguments that it cannot serve included; beside the value it says whether the rare path holds.
/// `rare` recomputes such an element from the beginning and assigns the status. Without a `rare`
/// the flag is the status mask itself, 0 where there is none. The split is what makes one source
/// fast everywhere: on a GPU the rare path is a branch that lanes seldom take, on a CPU the
/// compiler vectorises `main` by itself. A body whose rare path many arguments in a row may take
/// adds `beyond`, which is for flagged arguments what `main` is for all: the same results as `rare`
/// without a branch, or a flag. It returns a `main_result` if what it serves has status 0, else a
/// `rare_result`. A body that a processor computes faster in another way, such as
/// floats in doubles, adds `block` for a number of elements at once: the same results and status 0,
/// or false, after which `main` computes them. Only loops over arrays use these two.
///
/// The bases below turn the two parts into the call that kernels use: a static `call` that takes
/// pointers to operands (constants by value) and to results, reads each operand once, writes every
/// result on every path, and returns the status mask.
#pragma once

#include <complex>
#include <cstdint>
#include <type_traits>

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The accuracy tiers, from the most accurate to the fastest.
enum class tier { ha, la, ep };

/// The small code that a body holds while it runs. At most one condition holds for one element.
enum class code : std::uint32_t {
  none = 0,
  domain = 1,    ///< argument outside the domain, result NaN
  pole = 2,      ///< pole, result an infinity
  overflow = 3,  ///< result too large, an infinity
  underflow = 4  ///< result zero or denormal
};

/// The status mask of a code: 0, 1, 2, 4, 8.
LUMEN_DEVICE constexpr std::uint32_t mask(code c) {
  return (1u << static_cast<std::uint32_t>(c)) >> 1;
}

/// The integer that flags the rare path: as wide as the element (as a component, for complex
/// elements), since a narrower one costs shuffles in a vectorised loop.
template <typename T>
struct rare_flag {
  using type = uint_of<T>;
};
template <typename R>
struct rare_flag<std::complex<R>> {
  using type = uint_of<R>;
};

/// The flag for elements of type `T`: set if any of the conditions holds. All of them are
/// evaluated; the flag is computed without a branch.
template <typename T, typename... Conditions>
LUMEN_DEVICE constexpr typename rare_flag<T>::type flag_if(Conditions... conditions) {
  using flag = typename rare_flag<T>::type;
  return (static_cast<flag>(conditions) | ...);
}

/// A flag as loops over elements of type `T` or it together: vectors with mask registers keep it
/// there.
template <typename T>
using loop_flag = std::conditional_t<wide_vectors, bool, typename rare_flag<T>::type>;

/// The value of a main path, and whether the rare path holds instead (non-zero: it does); without a
/// rare path the status mask.
template <typename U>
struct main_result {
  U value;
  typename rare_flag<U>::type rare = 0;
};

/// The same for functions with two results.
template <typename U>
struct main_result2 {
  U first;
  U second;
  typename rare_flag<U>::type rare = 0;
};

/// What `beyond` gives for an argument that may have a status: the value, whether `rare` is needed
/// all the same, and the status mask.
template <typename U>
struct rare_result {
  U value;
  typename rare_flag<U>::type rare = 0;
  typename rare_flag<U>::type status = 0;
};

/// For a `rare` that is no more than its `beyond`.
template <typename U>
LUMEN_DEVICE inline std::uint32_t assign(const rare_result<U>& result, U* y) {
  *y = result.value;
  return static_cast<std::uint32_t>(result.status);
}

/// How a loop reads and writes elements: a complex one by its parts. Copied as a whole, a complex
/// float is one 64-bit value to the compiler, which then does not vectorise the loop.
template <typename T>
LUMEN_DEVICE inline T load(const T* a) {
  return *a;
}
template <typename R>
LUMEN_DEVICE inline std::complex<R> load(const std::complex<R>* a) {
  return {a->real(), a->imag()};
}
template <typename T>
LUMEN_DEVICE inline void store(T* y, T value) {
  *y = value;
}
template <typename R>
LUMEN_DEVICE inline void store(std::complex<R>* y, std::complex<R> value) {
  *y = std::complex<R>(value.real(), value.imag());
}

/// One input, one output: `main(x)`, `rare(x, y)`.
template <typename Body, typename T, typename U = T>
struct scalar_v11 {
  using input_type = T;
  using output_type = U;
  LUMEN_DEVICE static inline std::uint32_t call(const T* a, U* y) {
    const T x = load(a);
    const main_result<U> result = Body::main(x);
    store(y, result.value);
    if constexpr (requires { Body::rare(x, y); }) {
      if (result.rare) [[unlikely]]
        return Body::rare(x, y);
      return 0;
    }
    return static_cast<std::uint32_t>(result.rare);
  }
};

/// One input, two outputs: `main(x)`, `rare(x, y1, y2)`.
template <typename Body, typename T, typename U = T>
struct scalar_v12 {
  using input_type = T;
  using output_type = U;
  LUMEN_DEVICE static inline std::uint32_t call(const T* a, U* y1, U* y2) {
    const T x = load(a);
    const main_result2<U> result = Body::main(x);
    store(y1, result.first);
    store(y2, result.second);
    if constexpr (requires { Body::rare(x, y1, y2); }) {
      if (result.rare) [[unlikely]]
        return Body::rare(x, y1, y2);
      return 0;
    }
    return static_cast<std::uint32_t>(result.rare);
  }
};

/// Two inputs, one output: `main(x, y)`, `rare(x, y, r)`.
template <typename Body, typename T, typename U = T>
struct scalar_v21 {
  using input_type = T;
  using output_type = U;
  LUMEN_DEVICE static inline std::uint32_t call(const T* a, const T* b, U* r) {
    const T x = load(a);
    const T y = load(b);
    const main_result<U> result = Body::main(x, y);
    store(r, result.value);
    if constexpr (requires { Body::rare(x, y, r); }) {
      if (result.rare) [[unlikely]]
        return Body::rare(x, y, r);
      return 0;
    }
    return static_cast<std::uint32_t>(result.rare);
  }
};

/// One input, one constant by value, one output: `main(x, c)`, `rare(x, c, r)`.
template <typename Body, typename T, typename U = T>
struct scalar_v21c {
  using input_type = T;
  using output_type = U;
  LUMEN_DEVICE static inline std::uint32_t call(const T* a, T c, U* r) {
    const T x = load(a);
    const main_result<U> result = Body::main(x, c);
    store(r, result.value);
    if constexpr (requires { Body::rare(x, c, r); }) {
      if (result.rare) [[unlikely]]
        return Body::rare(x, c, r);
      return 0;
    }
    return static_cast<std::uint32_t>(result.rare);
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
