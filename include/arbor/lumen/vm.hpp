// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// @file
/// Arbor Lumen vector math: element-wise functions over whole arrays on a SYCL queue's device.
///
/// Every function comes in six forms: pointers, buffers and spans, each whole or through slices.
/// All return a `sycl::event`. See `arbor/lumen/vm/functions/` for one header per function.
#pragma once

#include "arbor/lumen/exception.hpp"
#include "arbor/lumen/slice.hpp"
#include "arbor/lumen/vm/enums.hpp"
#include "arbor/lumen/vm/error_handler.hpp"
#include "arbor/lumen/vm/functions.hpp"
#include "arbor/lumen/vm/queue_state.hpp"
