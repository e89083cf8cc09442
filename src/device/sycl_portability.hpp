// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <sycl/sycl.hpp>

/// The places where SYCL implementations differ and the library must not.
namespace arbor::lumen::vm::detail::portability {

/// Submits `kernel` over `count` work items as the one action of a command group. An empty range
/// becomes an empty task where the implementation cannot launch one.
template <typename Kernel>
void parallel_for(sycl::handler& group, std::int64_t count, const Kernel& kernel) {
#if defined(ARBORLUMEN_SYCL_ADAPTIVECPP)
  if (count == 0) {
    group.single_task([] {});
    return;
  }
#endif
  group.parallel_for(sycl::range<1>(static_cast<std::size_t>(count)), kernel);
}

inline bool is_complete(const sycl::event& event) {
  return event.get_info<sycl::info::event::command_execution_status>() ==
         sycl::info::event_command_status::complete;
}

/// Frees memory whose last user is `last_use`, without waiting for it: freeing what a kernel still
/// reads is undefined, so the free becomes a command after it. Waits where there are no host tasks.
inline void free_after(sycl::event last_use, void* pointer, sycl::queue& queue) {
  if (!is_complete(last_use)) {
#if defined(ARBORLUMEN_SYCL_ADAPTIVECPP)
    last_use.wait();
#else
    queue.submit([&](sycl::handler& group) {
      group.depends_on(last_use);
      group.host_task([pointer, context = queue.get_context()] { sycl::free(pointer, context); });
    });
    return;
#endif
  }
  sycl::free(pointer, queue);
}

}  // namespace arbor::lumen::vm::detail::portability
