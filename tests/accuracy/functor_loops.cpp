// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "functor_loops.hpp"

#include "scalar/block_loop.hpp"
#include "scalar/functors.hpp"
#include "scalar/generated/list.hpp"

namespace arbor::lumen::accuracy {

namespace {

namespace scalar = vm::detail::gpu::norvane::scalar;

template <typename Loop>
void run_loop(const void* const* in, void* const* out, std::size_t n) {
  using T = typename Loop::input_type;
  using U = typename Loop::output_type;
  const T* a[Loop::inputs];
  U* y[Loop::outputs];
  for (int k = 0; k < Loop::inputs; ++k) a[k] = static_cast<const T*>(in[k]);
  for (int k = 0; k < Loop::outputs; ++k) y[k] = static_cast<U*>(out[k]);
  Loop::run(static_cast<std::int64_t>(n), a, y);
}

template <typename F>
constexpr decltype(functor::run_loop) loop_of() {
  using T = typename F::input_type;
  if constexpr (std::is_same_v<T, scalar::binary16>) {
    using loop = scalar::half_block_loop_of<F, T>;
    if constexpr (!std::is_void_v<loop>) return &run_loop<loop>;
  } else {
    using loop = scalar::block_loop_of<F>;
    if constexpr (!std::is_void_v<loop>) return &run_loop<loop>;
  }
  return nullptr;
}

constexpr decltype(functor::run_loop) all_loops[] = {
#define LUMEN_ROW(function, form, type, tier, label, name) loop_of<scalar::name>(),
    LUMEN_FUNCTORS(LUMEN_ROW)
#undef LUMEN_ROW
};

}  // namespace

std::span<const decltype(functor::run_loop)> functor_loops() { return all_loops; }

}  // namespace arbor::lumen::accuracy
