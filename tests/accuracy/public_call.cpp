// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "public_call.hpp"

#include <complex>
#include <string>

#include "catalogue_lists.hpp"

namespace arbor::lumen::accuracy {

namespace {

using mode = vm::enums::mode;

template <typename T>
constexpr bool is_real =
    !std::is_same_v<T, std::complex<float>> && !std::is_same_v<T, std::complex<double>>;

// A call of each form that takes arrays alone; the others have none here.
#define LUMEN_CALL_v11(name, T, U)                                                              \
  {                                                                                             \
    1, 1, [](sycl::queue& q, const void* const* in, void* const* out, std::int64_t n, mode m) { \
      vm::name(q, n, static_cast<const T*>(in[0]), static_cast<U*>(out[0]), {}, m).wait();      \
    }                                                                                           \
  }
#define LUMEN_CALL_v12(name, T, U)                                                              \
  {                                                                                             \
    1, 2, [](sycl::queue& q, const void* const* in, void* const* out, std::int64_t n, mode m) { \
      vm::name(q, n, static_cast<const T*>(in[0]), static_cast<U*>(out[0]),                     \
               static_cast<U*>(out[1]), {}, m)                                                  \
          .wait();                                                                              \
    }                                                                                           \
  }
#define LUMEN_CALL_v21(name, T, U)                                                              \
  {                                                                                             \
    2, 1, [](sycl::queue& q, const void* const* in, void* const* out, std::int64_t n, mode m) { \
      vm::name(q, n, static_cast<const T*>(in[0]), static_cast<const T*>(in[1]),                \
               static_cast<U*>(out[0]), {}, m)                                                  \
          .wait();                                                                              \
    }                                                                                           \
  }
#define LUMEN_CALL_v21c(name, T, U) \
  { 0, 0, nullptr }
#define LUMEN_CALL_v61(name, T, U) \
  { 0, 0, nullptr }

struct form {
  std::size_t inputs, outputs;
  decltype(public_call::run) run;
};

constexpr public_call make(std::string_view function, char type, form f, bool real) {
  return {function, type, f.inputs, f.outputs, real ? f.run : nullptr};
}

const public_call all_calls[] = {
#define LUMEN_ROW(name, shape, letter, input, output, handler) \
  make(#name, #letter[0], form LUMEN_CALL_##shape(name, input, output), is_real<input>),
    LUMEN_OVERLOADS(LUMEN_ROW)
#undef LUMEN_ROW
};

}  // namespace

const public_call* find_public_call(std::string_view name) {
  for (const public_call& call : all_calls) {
    if (call.run != nullptr && name == std::string(call.function) + "_" + call.type) return &call;
  }
  return nullptr;
}

subject subject_of(const public_call& call, const sycl::queue& queue, vm::enums::mode mode) {
  return {std::string(call.function) + ", public call", &format_of(call.type), call.inputs,
          call.outputs,
          [run = call.run, queue = queue, mode](const void* const* in, void* const* out,
                                                std::size_t n) mutable {
            run(queue, in, out, static_cast<std::int64_t>(n), mode);
          }};
}

}  // namespace arbor::lumen::accuracy
