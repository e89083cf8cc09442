// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "module/state.hpp"

#include <utility>

namespace arbor::lumen::arr {

thread_state& state() {
  static thread_local thread_state of_this_thread;
  return of_this_thread;
}

}  // namespace arbor::lumen::arr

using arbor::lumen::arr::state;

std::int64_t lumen_arr_kernel_SetMode(std::int64_t mode) {
  return std::exchange(state().mode, mode);
}

std::int64_t lumen_arr_kernel_GetMode() { return state().mode; }

std::int32_t lumen_arr_kernel_SetErrStatus(std::int32_t status) {
  return std::exchange(state().status, status);
}

std::int32_t lumen_arr_kernel_GetErrStatus() { return state().status; }

std::int32_t lumen_arr_kernel_ClearErrStatus() {
  return lumen_arr_kernel_SetErrStatus(LUMEN_ARR_STATUS_OK);
}

lumen_arr_error_callback lumen_arr_kernel_SetErrorCallBack(lumen_arr_error_callback callback) {
  return std::exchange(state().callback, callback);
}
