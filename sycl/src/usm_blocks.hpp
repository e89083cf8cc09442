// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>

/// The memory behind USM allocations. The system hands out large blocks as fresh pages, whose first
/// touch costs several times a copy of them; a program that allocates per call, as staging of host
/// memory does, would pay that each time. So freed blocks above 32 KiB are kept for the next
/// allocation of about their size, up to 256 MiB in all. A process under AddressSanitizer or
/// ThreadSanitizer keeps none, so that these see every use of freed memory.
namespace sycl::detail::usm_blocks {

/// `bytes` > 0; `alignment` a power of two. Null if the system has no memory left.
void* take(std::size_t bytes, std::size_t alignment) noexcept;
/// `bytes` as in the call that took the block.
void give_back(void* block, std::size_t bytes) noexcept;

}  // namespace sycl::detail::usm_blocks
