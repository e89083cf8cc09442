// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "device/launch.hpp"

#include <complex>
#include <stdexcept>
#include <string>

#include "device/status_cell.hpp"
#include "device/usm_wrapper.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane {
namespace {

template <typename Shape>
[[noreturn]] void throw_wrong_record() {
  throw std::runtime_error(std::string("vm::detail::gpu::norvane::") + Shape::name +
                           " function was called with incorrect argument types");
}

template <typename Record>
bool is(const input::vxx& record) {
  return dynamic_cast<const Record*>(&record) != nullptr;
}

/// The operands of a pointer call, staged where the device cannot reach them. Destroyed in the
/// order status storage, outputs, inputs; the outputs wait for the kernel and copy back.
template <typename Shape, typename T, typename U>
class staged_arguments {
 public:
  using typed_record = input::typed_vxx<T, U>;

  void stage_input(const typed_record& record, std::size_t k, std::int64_t count) {
    args_.in[k] = inputs_[k].wrap(*record.queue, record.in_pointer(k), count);
  }
  void stage_output(const typed_record& record, std::size_t j, std::int64_t count) {
    args_.out[j] = outputs_[j].wrap(*record.queue, record.out_pointer(j), count, true);
  }
  void stage_rest(const typed_record& record) {
    for (std::size_t c = 0; c < args_.constants.size(); ++c)
      args_.constants[c] = record.constant(c);
    storage_ =
        status_.wrap(*record.queue, record.handler.status_array, record.handler.length, true);
  }

  const arguments<Shape, T, U>& arguments_on_device() const { return args_; }
  enums::status* status_storage() const { return storage_; }

  void set_event(const sycl::event& event) {
    for (auto& wrapper : inputs_) wrapper.set_event(event);
    for (auto& wrapper : outputs_) wrapper.set_event(event);
    status_.set_event(event);
  }

 private:
  arguments<Shape, T, U> args_{};
  enums::status* storage_ = nullptr;
  std::array<device::usm_wrapper<T>, Shape::inputs> inputs_;
  std::array<device::usm_wrapper<U>, Shape::outputs> outputs_;
  device::usm_wrapper<enums::status> status_;
};

template <typename Shape, typename T, typename U>
sycl::event run_usm_linear(const input::typed_vxx<T, U>& record,
                           const kernel_set<Shape, T, U>& kernels) {
  const std::int64_t count = record.effective_count();
  staged_arguments<Shape, T, U> staged;
  for (std::size_t k = 0; k < Shape::inputs; ++k) staged.stage_input(record, k, count);
  for (std::size_t j = 0; j < Shape::outputs; ++j) staged.stage_output(record, j, count);
  staged.stage_rest(record);
  sycl::event event =
      kernels.usm_linear(*record.queue, record.depends, staged.arguments_on_device(), count);
  staged.set_event(event);
  return event;
}

template <typename Shape, typename T, typename U>
strided_context<Shape, U> context_of(const input::typed_vxx<T, U>& record) {
  return {device::describe<Shape::inputs, Shape::outputs>(record), device::fixup_of(record.handler),
          nullptr};
}

bool reports_globally(const input::vxx& record) {
  return (record.mode & enums::global_status_report) != 0;
}

template <typename Shape, typename T, typename U>
sycl::event run_usm_strided(const input::typed_vxx<T, U>& record,
                            const kernel_set<Shape, T, U>& kernels) {
  strided_context<Shape, U> context = context_of<Shape>(record);
  device::status_cell cell(*record.queue, reports_globally(record));
  context.cell = cell.get();
  staged_arguments<Shape, T, U> staged;
  for (std::size_t k = 0; k < Shape::inputs; ++k)
    staged.stage_input(record, k, context.stride.in_extent[k]);
  for (std::size_t j = 0; j < Shape::outputs; ++j)
    staged.stage_output(record, j, context.stride.out_extent[j]);
  staged.stage_rest(record);
  sycl::event event =
      kernels.usm_strided(*record.queue, record.depends, staged.arguments_on_device(),
                          staged.status_storage(), context);
  staged.set_event(event);
  cell.collect(event);
  return event;
}

template <typename Shape, typename T, typename U>
sycl::event run_buffer(const input::typed_vxx<T, U>& record,
                       const kernel_set<Shape, T, U>& kernels) {
  buffer_call<Shape, T, U> call{record, {}, context_of<Shape>(record)};
  for (std::size_t c = 0; c < call.constants.size(); ++c) call.constants[c] = record.constant(c);
  device::status_cell cell(*record.queue, reports_globally(record));
  call.context.cell = cell.get();
  sycl::event event = kernels.buffer_strided(*record.queue, call);
  cell.collect(event);
  return event;
}

}  // namespace

void require_31_bits(std::int64_t count) {
  if (count >> 31 != 0)
    throw sycl::exception(sycl::make_error_code(sycl::errc::nd_range),
                          "Provided range is out of integer limits. Pass "
                          "`-fno-sycl-id-queries-fit-in-int' to disable range check.");
}

void depend_on(sycl::handler& group, const events& depends) {
  if (!depends.empty()) group.depends_on(depends);
}

template <typename Shape, typename T, typename U>
sycl::event launch(const input::vxx& record, const kernel_set<Shape, T, U>& kernels) {
  const auto* typed = dynamic_cast<const input::typed_vxx<T, U>*>(&record);
  if (typed == nullptr) throw_wrong_record<Shape>();
  const bool linear = is<input::usm::linear<Shape, T, U>>(record);
  if (linear && !typed->handler.enabled && !reports_globally(record))
    return run_usm_linear(*typed, kernels);
  if (is<input::buffer::strided<Shape, T, U>>(record) ||
      is<input::buffer::linear<Shape, T, U>>(record))
    return run_buffer(*typed, kernels);
  if (linear || is<input::usm::strided<Shape, T, U>>(record))
    return run_usm_strided(*typed, kernels);
  throw_wrong_record<Shape>();
}

#define LUMEN_INSTANTIATE(Shape, T, U)                               \
  template sycl::event launch<shape::Shape, T, U>(const input::vxx&, \
                                                  const kernel_set<shape::Shape, T, U>&);
#define LUMEN_V11(T, U) LUMEN_INSTANTIATE(v11, T, U)
LUMEN_FOR_EACH_PAIR(LUMEN_V11)
LUMEN_INSTANTIATE(v12, sycl::half, sycl::half)
LUMEN_INSTANTIATE(v12, float, float)
LUMEN_INSTANTIATE(v12, double, double)
LUMEN_INSTANTIATE(v21, sycl::half, sycl::half)
LUMEN_INSTANTIATE(v21, float, float)
LUMEN_INSTANTIATE(v21, double, double)
LUMEN_INSTANTIATE(v21, std::complex<float>, std::complex<float>)
LUMEN_INSTANTIATE(v21, std::complex<double>, std::complex<double>)
LUMEN_INSTANTIATE(v21c, sycl::half, sycl::half)
LUMEN_INSTANTIATE(v21c, float, float)
LUMEN_INSTANTIATE(v21c, double, double)
#define LUMEN_UTILITY(Shape)                                         \
  LUMEN_INSTANTIATE(Shape, float, float)                             \
  LUMEN_INSTANTIATE(Shape, double, double)                           \
  LUMEN_INSTANTIATE(Shape, std::complex<float>, std::complex<float>) \
  LUMEN_INSTANTIATE(Shape, std::complex<double>, std::complex<double>)
LUMEN_UTILITY(v31)
LUMEN_UTILITY(vc1)
LUMEN_UTILITY(vc2)
LUMEN_UTILITY(vi2c1)
#undef LUMEN_UTILITY
#undef LUMEN_V11
#undef LUMEN_INSTANTIATE

}  // namespace arbor::lumen::vm::detail::gpu::norvane
