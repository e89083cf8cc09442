// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "functor.hpp"

#include <vector>

#include "functor_loops.hpp"
#include "scalar/functors.hpp"
#include "scalar/generated/list.hpp"

namespace arbor::lumen::accuracy {

namespace {

namespace scalar = vm::detail::gpu::norvane::scalar;

enum class shape { v11, v12, v21, v21c };

/// The base of a functor that its call comes from, so that functors with one body are compiled
/// once; a functor with a call of its own is its own base.
template <typename F>
struct called {
  template <typename Body, typename T, typename U>
  static scalar::scalar_v11<Body, T, U> find(const scalar::scalar_v11<Body, T, U>*);
  template <typename Body, typename T, typename U>
  static scalar::scalar_v12<Body, T, U> find(const scalar::scalar_v12<Body, T, U>*);
  template <typename Body, typename T, typename U>
  static scalar::scalar_v21<Body, T, U> find(const scalar::scalar_v21<Body, T, U>*);
  template <typename Body, typename T, typename U>
  static scalar::scalar_v21c<Body, T, U> find(const scalar::scalar_v21c<Body, T, U>*);
  template <typename Body>
  static scalar::half_v11<Body> find(const scalar::half_v11<Body>*);
  template <typename Body>
  static scalar::half_v12<Body> find(const scalar::half_v12<Body>*);
  template <typename Body>
  static scalar::half_v21<Body> find(const scalar::half_v21<Body>*);
  template <typename Body>
  static scalar::half_v21c<Body> find(const scalar::half_v21c<Body>*);
  static F find(...);
  using base = decltype(find(static_cast<const F*>(nullptr)));
};

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

std::vector<functor> make_functors() {
  std::vector<functor> list = {
#define LUMEN_ROW(function, form, type, tier, label, name) \
  {                                                        \
      #name,                                               \
      #function,                                           \
      #form,                                               \
      #type[0],                                            \
      #tier,                                               \
      #label,                                              \
      &run<called<scalar::name>::base, shape::form>,       \
      nullptr},
      LUMEN_FUNCTORS(LUMEN_ROW)
#undef LUMEN_ROW
  };
  for (std::size_t i = 0; i < list.size(); ++i) list[i].run_loop = functor_loops()[i];
  return list;
}

}  // namespace

std::span<const functor> functors() {
  static const std::vector<functor> list = make_functors();
  return list;
}

const functor* find_functor(std::string_view name) {
  for (const functor& f : functors()) {
    if (f.name == name) return &f;
  }
  return nullptr;
}

}  // namespace arbor::lumen::accuracy
