// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <sycl/sycl.hpp>

namespace bench {

/// The GPU on which the device path is measured. scripts/bench simulates one where there is none:
/// it computes on the CPU's threads, so its figures are those of the CPU behind it.
inline sycl::device first_gpu() { return sycl::device(sycl::gpu_selector_v); }

}  // namespace bench
