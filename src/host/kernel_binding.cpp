// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "host/kernel_binding.hpp"

#include <cstring>

namespace arbor::lumen::vm::detail::cpu::binding {
namespace {

/// Longest name of a routine in a report.
constexpr std::size_t longest_name = 25;

constexpr std::int32_t message_no_module = 771;
constexpr std::int32_t message_no_symbol = 772;
constexpr std::int32_t exit_code = 2;

template <typename F>
F find_function(const char* name) {
  return reinterpret_cast<F>(find_symbol(name));
}

void report(const char* routine, std::int64_t position, std::int32_t status) {
  lumen_serv_set_xerbla_interface(sizeof position);
  lumen_serv_xerbla(routine, &position, static_cast<std::int32_t>(strnlen(routine, longest_name)));
  arr_state().set_status(status);
}

bool is_digit(char c) { return c >= '0' && c <= '9'; }

/// The type that the environment asks for; -1 if it asks for none.
std::int32_t forced_type() {
  char text[32];
  const std::int32_t length = lumen_serv_getenv("LUMEN_ARR_DEBUG_CPU_TYPE", text, sizeof text);
  if (!is_digit(text[0])) return -1;
  std::int32_t value = text[0] - '0';
  if (length == 2 && is_digit(text[1])) value = 10 * value + (text[1] - '0');
  return value < 10 && value != 8 ? value : -1;
}

/// The type of a class of processors as the services number them.
std::int32_t type_of_class(std::int32_t detected) {
  constexpr std::int32_t types[] = {0, 1, 0, 0, 0, 2, 2, 3, 4, 5};
  return detected > 9 ? detected : types[detected];
}

}  // namespace

void* arr_module() {
  static std::atomic<void*> module{nullptr};
  void* handle = module.load(std::memory_order_acquire);
  if (handle != nullptr) return handle;
  handle = lumen_serv_load_arr();
  if (handle == nullptr) {
    lumen_serv_print(1, message_no_module, 0);
    lumen_serv_exit(exit_code);
  }
  module.store(handle, std::memory_order_release);
  return handle;
}

void* find_symbol(const char* name) {
  void* const address = lumen_serv_find_symbol(arr_module(), name);
  if (address == nullptr) {
    lumen_serv_print(1, message_no_symbol, 1, name);
    lumen_serv_exit(exit_code);
  }
  return address;
}

const arr_functions& arr_state() {
  static const arr_functions functions{
      find_function<decltype(arr_functions::set_mode)>("lumen_arr_kernel_SetMode"),
      find_function<decltype(arr_functions::get_mode)>("lumen_arr_kernel_GetMode"),
      find_function<decltype(arr_functions::set_status)>("lumen_arr_kernel_SetErrStatus"),
      find_function<decltype(arr_functions::get_status)>("lumen_arr_kernel_GetErrStatus"),
      find_function<decltype(arr_functions::clear_status)>("lumen_arr_kernel_ClearErrStatus"),
      find_function<decltype(arr_functions::set_callback)>("lumen_arr_kernel_SetErrorCallBack")};
  return functions;
}

std::int32_t processor_type() {
  constexpr std::int32_t unknown = -1;
  static std::atomic<std::int32_t> cached{unknown};
  std::int32_t type = cached.load(std::memory_order_relaxed);
  if (type != unknown) return type;
  type = forced_type();
  if (type == unknown) type = type_of_class(lumen_serv_arr_cpu_detect());
  cached.store(type, std::memory_order_relaxed);
  return type;
}

lumen_arr_kernel kernel_binding::resolve() {
  const auto* const ttab = static_cast<const lumen_arr_kernel*>(find_symbol(ttab_name));
  const auto* const ctab = static_cast<const float*>(find_symbol(ctab_name));
  const auto index_of =
      find_function<decltype(&lumen_arr_kernel_GetTTableIndex)>("lumen_arr_kernel_GetTTableIndex");
  const std::int32_t index = index_of(processor_type());
  cost.store(ctab[index], std::memory_order_relaxed);
  kernel.store(ttab[index], std::memory_order_release);
  return ttab[index];
}

void kernel_binding::reject_length() const {
  char routine[longest_name + 1] = {};
  std::strncpy(routine, name, longest_name - 3);
  std::strcat(routine, "_64");
  report(routine, 1, LUMEN_ARR_STATUS_BADSIZE);
}

void kernel_binding::reject_null(std::int64_t position) const {
  report(name, position, LUMEN_ARR_STATUS_NULLPTR);
}

}  // namespace arbor::lumen::vm::detail::cpu::binding
