// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "lumen_arr.h"

namespace arbor::lumen::arr {

/// What each thread has of its own.
struct thread_state {
  std::int64_t mode = LUMEN_ARR_HA;
  std::int32_t status = LUMEN_ARR_STATUS_OK;
  lumen_arr_error_callback callback = nullptr;
};

/// Of the calling thread.
thread_state& state();

}  // namespace arbor::lumen::arr
