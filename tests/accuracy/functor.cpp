// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "functor.hpp"

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

constexpr functor all_functors[] = {
#define LUMEN_ROW(function, form, type, tier, label, name) \
  {#name, #function, #form, #type[0], #tier, #label, &run<scalar::name, shape::form>},
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
