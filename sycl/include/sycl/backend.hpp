// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstdint>

namespace sycl {

/// What stands under a device: the host itself, or one of two simulated driver interfaces.
enum class backend : int { host = 0, opencl = 1, stratum = 2 };

namespace detail {
/// The address of the runtime's implementation object, for every class that has native handles.
using native_handle = std::uintptr_t;
}  // namespace detail

template <backend Backend>
class backend_traits {
 public:
  template <typename SyclObject>
  using input_type = detail::native_handle;
  template <typename SyclObject>
  using return_type = detail::native_handle;
};
template <backend Backend, typename SyclObject>
using backend_input_t = typename backend_traits<Backend>::template input_type<SyclObject>;
template <backend Backend, typename SyclObject>
using backend_return_t = typename backend_traits<Backend>::template return_type<SyclObject>;

}  // namespace sycl
