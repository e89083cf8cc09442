// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "host/executor.hpp"

#include <algorithm>
#include <complex>
#include <optional>
#include <stdexcept>
#include <string>
#include <type_traits>
#include <typeinfo>
#include <vector>

#include "call/queue_store.hpp"
#include "device/strided_args.hpp"
#include "host/usm_wrapper.hpp"

namespace arbor::lumen::vm::detail::cpu::norvane {
namespace {

using classic::input::linear;
using classic::input::strided;

template <typename Shape, typename T, typename U>
using stride_plan = device::strided_args<Shape::inputs, Shape::outputs>;

/// The buffers of a call as plain memory. Taking host accessors waits for the work pending on the
/// buffers. A buffer that is input and output at once gets one accessor for both.
template <typename Shape, typename T, typename U>
class accessed_arguments {
 public:
  explicit accessed_arguments(const input::typed_vxx<T, U>& record) {
    for (std::size_t j = 0; j < Shape::outputs; ++j) access_output(record, j);
    for (std::size_t k = 0; k < Shape::inputs; ++k) access_input(record, k);
    for (std::size_t c = 0; c < Shape::constants; ++c) args_.constants[c] = record.constant(c);
  }
  const arguments<Shape, T, U>& get() const { return args_; }

 private:
  void access_output(const input::typed_vxx<T, U>& record, std::size_t j) {
    for (std::size_t earlier = 0; earlier < j; ++earlier) {
      if (record.out_buffer(earlier) == record.out_buffer(j)) {
        args_.out[j] = args_.out[earlier];
        return;
      }
    }
    outputs_[j].emplace(record.out_buffer(j));
    args_.out[j] = outputs_[j]->get_pointer();
  }
  void access_input(const input::typed_vxx<T, U>& record, std::size_t k) {
    if constexpr (std::is_same_v<T, U>) {
      for (std::size_t j = 0; j < Shape::outputs; ++j) {
        if (record.in_buffer(k) == record.out_buffer(j)) {
          args_.in[k] = args_.out[j];
          return;
        }
      }
    }
    inputs_[k].emplace(record.in_buffer(k), sycl::read_only);
    args_.in[k] = inputs_[k]->get_pointer();
  }

  using input_accessor = sycl::host_accessor<T, 1, sycl::access_mode::read>;
  using output_accessor = sycl::host_accessor<U, 1, sycl::access_mode::read_write>;
  arguments<Shape, T, U> args_{};
  std::array<std::optional<input_accessor>, Shape::inputs> inputs_;
  std::array<std::optional<output_accessor>, Shape::outputs> outputs_;
};

/// The arrays of a pointer call as memory that the host can reach. Destroyed outputs first: that
/// writes their results back.
template <typename Shape, typename T, typename U>
class staged_arguments {
 public:
  template <typename InCount, typename OutCount>
  staged_arguments(const input::typed_vxx<T, U>& record, InCount in_count, OutCount out_count) {
    const host::staging_queue on(record.queue);
    for (std::size_t k = 0; k < Shape::inputs; ++k)
      args_.in[k] = inputs_[k].wrap(on, record.in_pointer(k), in_count(k));
    for (std::size_t j = 0; j < Shape::outputs; ++j)
      args_.out[j] = outputs_[j].wrap(on, record.out_pointer(j), out_count(j), true);
    for (std::size_t c = 0; c < Shape::constants; ++c) args_.constants[c] = record.constant(c);
  }
  const arguments<Shape, T, U>& get() const { return args_; }

 private:
  arguments<Shape, T, U> args_{};
  std::array<host::usm_wrapper<T>, Shape::inputs> inputs_;
  std::array<host::usm_wrapper<U>, Shape::outputs> outputs_;
};

/// The arguments of a strided call, without the arrays.
template <typename Shape, typename T, typename U>
strided<Shape, T, U> with_slices(const input::vxx& record, std::int64_t mode,
                                 const stride_plan<Shape, T, U>& plan) {
  strided<Shape, T, U> object(record.name, mode, plan.count, nullptr);
  object.cyclic = plan.cyclic;
  for (std::size_t k = 0; k < Shape::inputs; ++k) {
    object.i_starts.push_back(plan.in_start[k]);
    object.i_strides.push_back(plan.in_stride[k]);
    object.i_sizes.push_back(plan.in_size[k]);
    object.i_divisors.push_back(plan.divisor[k]);
  }
  for (std::size_t j = 0; j < Shape::outputs; ++j) {
    object.o_starts.push_back(plan.out_start[j]);
    object.o_strides.push_back(plan.out_stride[j]);
    object.o_sizes.push_back(plan.count);
  }
  return object;
}

/// Calls `run` with a handler for the call, of the class that its errors ask for. It is made
/// inactive, and nothing here makes it active: a host call reports no status.
template <typename T, typename U, typename Run>
void with_handler(const input::typed_vxx<T, U>& record, error_kind errors, Run&& run) {
  switch (errors) {
    case error_kind::none: {
      classic::error_handler_typed_var0<T, U> handler(record);
      return run(handler);
    }
    case error_kind::one_result: {
      classic::error_handler_typed_var1<T, U> handler(record);
      return run(handler);
    }
    case error_kind::two_results: {
      classic::error_handler_typed_var2<T, U> handler(record);
      return run(handler);
    }
  }
}

/// The record as `Record` if it is one. Records have final classes, so the types are compared,
/// which takes a fraction of a dynamic cast.
template <typename Record>
const Record* exactly(const input::vxx& record) {
  return typeid(record) == typeid(Record) ? static_cast<const Record*>(&record) : nullptr;
}

void wait_for(const std::vector<sycl::event>& depends) {
  if (!depends.empty()) sycl::event::wait_and_throw(depends);
}

}  // namespace

template <typename Shape, typename T, typename U>
sycl::event execute(const input::vxx& record, const host_entries<Shape, T, U>& entries,
                    call_kind kind) {
  const auto run = [&](const input::typed_vxx<T, U>& typed, auto& object, const auto& operands) {
    for (const T* in : operands.in) object.in_pointers.push_back(in);
    for (U* out : operands.out) object.out_pointers.push_back(out);
    const auto run_with = [&](classic::error_handler& handler) {
      object.handler = &handler;
      object.run(entries, operands.constants);
    };
    with_handler(typed, kind.errors, run_with);
  };
  const auto plan_of = device::describe<Shape::inputs, Shape::outputs>;
  if (const auto* arrays = exactly<input::usm::linear<Shape, T, U>>(record)) {
    wait_for(record.depends);
    const std::int64_t n = record.effective_count();
    const auto count = [n](std::size_t) { return n; };
    const staged_arguments<Shape, T, U> args(*arrays, count, count);
    linear<Shape, T, U> object(record.name, kind.mode, n, nullptr);
    run(*arrays, object, args.get());
  } else if (const auto* buffers = exactly<input::buffer::linear<Shape, T, U>>(record)) {
    const accessed_arguments<Shape, T, U> args(*buffers);
    linear<Shape, T, U> object(record.name, kind.mode, record.effective_count(), nullptr);
    run(*buffers, object, args.get());
  } else if (const auto* buffer_slices = exactly<input::buffer::strided<Shape, T, U>>(record)) {
    const auto plan = plan_of(record);
    const accessed_arguments<Shape, T, U> args(*buffer_slices);
    auto object = with_slices<Shape, T, U>(record, kind.mode, plan);
    run(*buffer_slices, object, args.get());
  } else if (const auto* slices = exactly<input::usm::strided<Shape, T, U>>(record)) {
    const auto plan = plan_of(record);
    wait_for(record.depends);
    const staged_arguments<Shape, T, U> args(
        *slices, [&](std::size_t k) { return plan.in_extent[k]; },
        [&](std::size_t j) { return plan.out_extent[j]; });
    auto object = with_slices<Shape, T, U>(record, kind.mode, plan);
    run(*slices, object, args.get());
  } else {
    throw std::runtime_error(std::string("vm::detail::cpu::norvane::") + Shape::name +
                             " function was called with incorrect argument types");
  }
  return queue_store::instance().default_event();
}

#define LUMEN_INSTANTIATE(Shape, T, U)              \
  template sycl::event execute<shape::Shape, T, U>( \
      const input::vxx&, const host_entries<shape::Shape, T, U>&, call_kind);
#define LUMEN_REAL(Shape)                \
  LUMEN_INSTANTIATE(Shape, float, float) \
  LUMEN_INSTANTIATE(Shape, double, double)
#define LUMEN_COMPLEX(Shape)                                         \
  LUMEN_INSTANTIATE(Shape, std::complex<float>, std::complex<float>) \
  LUMEN_INSTANTIATE(Shape, std::complex<double>, std::complex<double>)
LUMEN_REAL(v11)
LUMEN_COMPLEX(v11)
LUMEN_INSTANTIATE(v11, std::complex<float>, float)
LUMEN_INSTANTIATE(v11, std::complex<double>, double)
LUMEN_INSTANTIATE(v11, float, std::complex<float>)
LUMEN_INSTANTIATE(v11, double, std::complex<double>)
LUMEN_REAL(v12)
LUMEN_REAL(v21)
LUMEN_COMPLEX(v21)
LUMEN_REAL(v21c)
LUMEN_COMPLEX(v21c)
LUMEN_REAL(v61)
LUMEN_COMPLEX(v12)
LUMEN_REAL(v31)
LUMEN_COMPLEX(v31)
LUMEN_REAL(vc1)
LUMEN_COMPLEX(vc1)
LUMEN_REAL(vc2)
LUMEN_COMPLEX(vc2)
LUMEN_REAL(vi2c1)
LUMEN_COMPLEX(vi2c1)
#undef LUMEN_COMPLEX
#undef LUMEN_REAL
#undef LUMEN_INSTANTIATE

}  // namespace arbor::lumen::vm::detail::cpu::norvane
