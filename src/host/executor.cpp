// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "host/executor.hpp"

#include <algorithm>
#include <complex>
#include <optional>
#include <stdexcept>
#include <string>
#include <type_traits>
#include <vector>

#include "call/queue_store.hpp"
#include "device/strided_args.hpp"
#include "host/usm_wrapper.hpp"

namespace arbor::lumen::vm::detail::cpu::norvane {
namespace {

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
    for (std::size_t k = 0; k < Shape::inputs; ++k)
      args_.in[k] = inputs_[k].wrap(*record.queue, record.in_pointer(k), in_count(k));
    for (std::size_t j = 0; j < Shape::outputs; ++j)
      args_.out[j] = outputs_[j].wrap(*record.queue, record.out_pointer(j), out_count(j), true);
    for (std::size_t c = 0; c < Shape::constants; ++c) args_.constants[c] = record.constant(c);
  }
  const arguments<Shape, T, U>& get() const { return args_; }

 private:
  arguments<Shape, T, U> args_{};
  std::array<host::usm_wrapper<T>, Shape::inputs> inputs_;
  std::array<host::usm_wrapper<U>, Shape::outputs> outputs_;
};

/// Computes a strided call in runs over which every operand has one increment. A run is one pass
/// over the last input: a short input is read again from its start until the output is full. Under
/// the cyclic policy the earlier inputs stand still meanwhile. A call ends with the run that the
/// last input is too long for; it is empty where the passes fill the output exactly.
template <typename Shape, typename T, typename U>
void run_strided(arguments<Shape, T, U> args, const stride_plan<Shape, T, U>& plan,
                 const host_entries<Shape, T, U>& entries) {
  constexpr std::size_t last = Shape::inputs > 0 ? Shape::inputs - 1 : 0;
  const auto base = args;
  increments<Shape> inc{};
  for (std::size_t j = 0; j < Shape::outputs; ++j) inc.out[j] = plan.out_stride[j];
  for (std::size_t k = 0; k < Shape::inputs; ++k)
    inc.in[k] = plan.cyclic && k != last ? 0 : plan.in_stride[k];

  const std::int64_t count = std::max<std::int64_t>(plan.count, 0);
  const std::int64_t whole = std::max<std::int64_t>(count, 1);
  const std::int64_t pass = Shape::inputs > 0 && count > 0 ? plan.in_size[last] : whole;
  for (std::int64_t done = 0; done <= count; done += pass) {
    for (std::size_t k = 0; k < Shape::inputs; ++k) {
      const std::int64_t element = count > 0 ? (done / plan.divisor[k]) % plan.in_size[k] : 0;
      args.in[k] = base.in[k] + plan.in_start[k] + element * plan.in_stride[k];
    }
    for (std::size_t j = 0; j < Shape::outputs; ++j)
      args.out[j] = base.out[j] + plan.out_start[j] + done * plan.out_stride[j];
    entries.strided(std::min(pass, count - done), args, inc);
  }
}

void wait_for(const std::vector<sycl::event>& depends) {
  if (!depends.empty()) sycl::event::wait_and_throw(depends);
}

}  // namespace

template <typename Shape, typename T, typename U>
sycl::event execute(const input::vxx& record, const host_entries<Shape, T, U>& entries) {
  const auto plan_of = device::describe<Shape::inputs, Shape::outputs>;
  if (const auto* buffers = dynamic_cast<const input::buffer::linear<Shape, T, U>*>(&record)) {
    const accessed_arguments<Shape, T, U> args(*buffers);
    entries.linear(record.effective_count(), args.get());
  } else if (const auto* arrays = dynamic_cast<const input::usm::linear<Shape, T, U>*>(&record)) {
    wait_for(record.depends);
    const std::int64_t n = record.effective_count();
    const auto count = [n](std::size_t) { return n; };
    const staged_arguments<Shape, T, U> args(*arrays, count, count);
    entries.linear(n, args.get());
  } else if (const auto* buffer_slices =
                 dynamic_cast<const input::buffer::strided<Shape, T, U>*>(&record)) {
    const auto plan = plan_of(record);
    const accessed_arguments<Shape, T, U> args(*buffer_slices);
    run_strided(args.get(), plan, entries);
  } else if (const auto* slices = dynamic_cast<const input::usm::strided<Shape, T, U>*>(&record)) {
    const auto plan = plan_of(record);
    wait_for(record.depends);
    const staged_arguments<Shape, T, U> args(
        *slices, [&](std::size_t k) { return plan.in_extent[k]; },
        [&](std::size_t j) { return plan.out_extent[j]; });
    run_strided(args.get(), plan, entries);
  } else {
    throw std::runtime_error(std::string("vm::detail::cpu::norvane::") + Shape::name +
                             " function was called with incorrect argument types");
  }
  return queue_store::instance().default_event();
}

#define LUMEN_INSTANTIATE(Shape, T, U)                                \
  template sycl::event execute<shape::Shape, T, U>(const input::vxx&, \
                                                   const host_entries<shape::Shape, T, U>&);
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
