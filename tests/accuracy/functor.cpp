// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "functor.hpp"

#include "scalar/block_loop.hpp"
#include "scalar/functors.hpp"
#include "scalar/generated/list.hpp"

namespace arbor::lumen::accuracy {

namespace {

namespace scalar = vm::detail::gpu::norvane::scalar;

enum class shape { v11, v12, v21, v21c };

template <typename F, shape S>
void run(const void* const* in, void* const* out, std::uint32_t* status, std::size_t n) {
  using T = typename F::input_type;
  using U = typename F::output_type;
  const T* a = static_cast<const T*>(in[0]);
  U* y = static_cast<U*>(out[0]);
  for (std::size_t i = 0; i < n; ++i) {
    if constexpr (S == shape::v11) {
      status[i] = F::call(a + i, y + i);
    } else if constexpr (S == shape::v12) {
      status[i] = F::call(a + i, y + i, static_cast<U*>(out[1]) + i);
    } else if constexpr (S == shape::v21) {
      status[i] = F::call(a + i, static_cast<const T*>(in[1]) + i, y + i);
    } else {
      status[i] = F::call(a + i, static_cast<const T*>(in[1])[i], y + i);
    }
  }
}

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

constexpr functor all_functors[] = {
#define LUMEN_ROW(function, form, type, tier, label, name) \
  {#name,                                                  \
   #function,                                              \
   #form,                                                  \
   #type[0],                                               \
   #tier,                                                  \
   #label,                                                 \
   &run<scalar::name, shape::form>,                        \
   loop_of<scalar::name>()},
    LUMEN_FUNCTORS(LUMEN_ROW)
#undef LUMEN_ROW
};

}  // namespace

std::span<const functor> functors() { return all_functors; }

const functor* find_functor(std::string_view name) {
  for (const functor& f : all_functors) {
    if (f.name == name) return &f;
  }
  return nullptr;
}

}  // namespace arbor::lumen::accuracy
