// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <dlfcn.h>
#include <gtest/gtest.h>

#include <stdexcept>
#include <string>

#include "lumen_arr.h"
#include "lumen_serv.h"
#include "processor_class.hpp"

namespace arbor::lumen::tests {

/// A symbol of the array-math module.
template <typename T>
T arr_symbol(const std::string& name) {
  void* const module = lumen_serv_load_arr();
  if (module == nullptr) throw std::runtime_error("the module cannot be loaded");
  void* const symbol = lumen_serv_find_symbol(module, name.c_str());
  if (symbol == nullptr) throw std::runtime_error("the module has no " + name);
  return reinterpret_cast<T>(symbol);
}

inline const lumen_arr_kernel* ttab(const std::string& kernel) {
  return arr_symbol<const lumen_arr_kernel*>("lumen_arr_kernel_" + kernel + "_ttab");
}

/// The state of the calling thread in the module.
struct arr_state {
  decltype(&lumen_arr_kernel_SetMode) set_mode =
      arr_symbol<decltype(set_mode)>("lumen_arr_kernel_SetMode");
  decltype(&lumen_arr_kernel_GetMode) get_mode =
      arr_symbol<decltype(get_mode)>("lumen_arr_kernel_GetMode");
  decltype(&lumen_arr_kernel_SetErrStatus) set_status =
      arr_symbol<decltype(set_status)>("lumen_arr_kernel_SetErrStatus");
  decltype(&lumen_arr_kernel_GetErrStatus) get_status =
      arr_symbol<decltype(get_status)>("lumen_arr_kernel_GetErrStatus");
  decltype(&lumen_arr_kernel_ClearErrStatus) clear_status =
      arr_symbol<decltype(clear_status)>("lumen_arr_kernel_ClearErrStatus");
  decltype(&lumen_arr_kernel_SetErrorCallBack) set_callback =
      arr_symbol<decltype(set_callback)>("lumen_arr_kernel_SetErrorCallBack");
  decltype(&lumen_arr_kernel_GetTTableIndex) table_index =
      arr_symbol<decltype(table_index)>("lumen_arr_kernel_GetTTableIndex");
};

}  // namespace arbor::lumen::tests
