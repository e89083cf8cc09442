// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// How the library reaches the kernels of the array-math module: by name, at run time, on first
/// use. Nothing here throws or allocates; bad arguments go to the reporter of the services and into
/// the status of the array-math layer.
#pragma once

#include <atomic>
#include <complex>
#include <cstdint>
#include <type_traits>

#include "lumen_arr.h"
#include "lumen_serv.h"

namespace arbor::lumen::vm::detail::cpu::binding {

/// The module's state functions, found once.
struct arr_functions {
  decltype(&lumen_arr_kernel_SetMode) set_mode;
  decltype(&lumen_arr_kernel_GetMode) get_mode;
  decltype(&lumen_arr_kernel_SetErrStatus) set_status;
  decltype(&lumen_arr_kernel_GetErrStatus) get_status;
  decltype(&lumen_arr_kernel_ClearErrStatus) clear_status;
  decltype(&lumen_arr_kernel_SetErrorCallBack) set_callback;
};
const arr_functions& arr_state();

/// The handle of the module. Ends the process with code 2 if it cannot be loaded.
void* arr_module();

/// A symbol of the module. Ends the process with code 2 if it is missing.
void* find_symbol(const char* name);

/// The type of this machine's processor for the module's tables, worked out once. The environment
/// variable LUMEN_ARR_DEBUG_CPU_TYPE, a number from 0 to 9 but not 8, decides if it is set.
std::int32_t processor_type();

/// One kernel with its name in messages. Its entries in the tables are found on first use, without
/// a lock: every thread would store the same ones.
struct kernel_binding {
  const char* name;
  const char* ttab_name;
  const char* ctab_name;
  std::atomic<lumen_arr_kernel> kernel{nullptr};  ///< set last
  std::atomic<float> cost{0};

  /// The kernel for this processor.
  lumen_arr_kernel resolved() {
    const lumen_arr_kernel found = kernel.load(std::memory_order_acquire);
    return found != nullptr ? found : resolve();
  }
  lumen_arr_kernel resolve();
  /// Reports a negative number of elements.
  void reject_length() const;
  /// Reports a null pointer at `position`.
  void reject_null(std::int64_t position) const;
};

/// The mode of the array-math layer for the span of a call.
class scoped_mode {
 public:
  explicit scoped_mode(std::int64_t mode) : previous_(arr_state().set_mode(mode)) {}
  scoped_mode(const scoped_mode&) = delete;
  scoped_mode& operator=(const scoped_mode&) = delete;
  ~scoped_mode() { arr_state().set_mode(previous_); }

 private:
  std::int64_t previous_;
};

/// Operands as the C interface takes them.
template <typename T>
T foreign(T operand) {
  return operand;
}
inline const _LUMEN_Complex8* foreign(const std::complex<float>* p) {
  return reinterpret_cast<const _LUMEN_Complex8*>(p);
}
inline const _LUMEN_Complex16* foreign(const std::complex<double>* p) {
  return reinterpret_cast<const _LUMEN_Complex16*>(p);
}
inline _LUMEN_Complex8* foreign(std::complex<float>* p) {
  return reinterpret_cast<_LUMEN_Complex8*>(p);
}
inline _LUMEN_Complex16* foreign(std::complex<double>* p) {
  return reinterpret_cast<_LUMEN_Complex16*>(p);
}
inline _LUMEN_Complex8 foreign(std::complex<float> c) { return {c.real(), c.imag()}; }
inline _LUMEN_Complex16 foreign(std::complex<double> c) { return {c.real(), c.imag()}; }

/// The position of the first null pointer among the operands; the first operand's is 2. 0 if there
/// is none.
template <typename... Operands>
std::int64_t null_position(Operands... operands) {
  std::int64_t position = 1, found = 0;
  const auto visit = [&](auto operand) {
    ++position;
    if constexpr (std::is_pointer_v<decltype(operand)>) {
      if (operand == nullptr && found == 0) found = position;
    }
  };
  (visit(operands), ...);
  return found;
}

/// Arrays from their element `distance` on; increments and constants as they are.
template <typename T>
T advanced(T operand, [[maybe_unused]] std::int64_t distance) {
  if constexpr (std::is_pointer_v<T>)
    return operand + distance;
  else
    return operand;
}

template <typename Function>
struct first_parameter;
template <typename R, typename First, typename... Rest>
struct first_parameter<R(First, Rest...)> {
  using type = First;
};

/// Runs a kernel through a threader at the accuracy of `mode`. Threaders count with 31 bits, so
/// very long arrays go in parts. With increments too a part begins as many elements behind the one
/// before as that has elements, whatever the increments.
template <typename Threader, typename... Operands>
void run(kernel_binding& binding, Threader* threader, std::int64_t n, std::int64_t mode,
         Operands... operands) {
  if (n < 0) return binding.reject_length();
  if (n == 0) return;
  if (const std::int64_t position = null_position(operands...); position != 0)
    return binding.reject_null(position);
  using entry = typename first_parameter<Threader>::type;
  const auto kernel = reinterpret_cast<entry>(binding.resolved());
  const float cost = binding.cost.load(std::memory_order_relaxed);
  void* const module = arr_module();
  const scoped_mode guard(mode);
  constexpr std::int64_t longest = 0x7fffffff;
  std::int64_t done = 0;
  for (; n - done > longest; done += longest)
    threader(kernel, longest, foreign(advanced(operands, done))..., cost, module);
  threader(kernel, static_cast<std::int32_t>(n - done), foreign(advanced(operands, done))..., cost,
           module);
}

}  // namespace arbor::lumen::vm::detail::cpu::binding
