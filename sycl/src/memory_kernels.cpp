// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "memory_kernels.hpp"

#include <cstdint>
#include <cstring>

#if defined(__x86_64__)
#include <emmintrin.h>
#endif

namespace sycl::detail {

namespace {

void copy_bytes(const void* closure, const std::size_t*, std::size_t begin, std::size_t end) {
  const auto& c = *static_cast<const copy_closure*>(closure);
  std::memcpy(c.dest + begin, c.src + begin, end - begin);
}

void set_bytes(const void* closure, const std::size_t*, std::size_t begin, std::size_t end) {
  const auto& c = *static_cast<const set_closure*>(closure);
  std::memset(c.dest + begin, c.value, end - begin);
}

#if defined(__x86_64__)
/// Copies past the caches, which saves reading the destination. The C library does so only for
/// sizes near that of the last-level cache, of which one copy rarely has the whole.
void stream_bytes(const void* closure, const std::size_t*, std::size_t begin, std::size_t end) {
  const auto& c = *static_cast<const copy_closure*>(closure);
  unsigned char* dest = c.dest + begin;
  const unsigned char* src = c.src + begin;
  std::size_t left = end - begin;
  const std::size_t head = (0 - reinterpret_cast<std::uintptr_t>(dest)) % 64;
  if (left < head + 64) {
    std::memcpy(dest, src, left);
    return;
  }
  std::memcpy(dest, src, head);
  for (dest += head, src += head, left -= head; left >= 64; dest += 64, src += 64, left -= 64) {
    const auto* const from = reinterpret_cast<const __m128i*>(src);
    auto* const to = reinterpret_cast<__m128i*>(dest);
    const __m128i line[4] = {_mm_loadu_si128(from), _mm_loadu_si128(from + 1),
                             _mm_loadu_si128(from + 2), _mm_loadu_si128(from + 3)};
    _mm_stream_si128(to, line[0]);
    _mm_stream_si128(to + 1, line[1]);
    _mm_stream_si128(to + 2, line[2]);
    _mm_stream_si128(to + 3, line[3]);
  }
  _mm_sfence();
  std::memcpy(dest, src, left);
}

constexpr std::size_t streaming_bytes = std::size_t{16} << 20;
#endif

}  // namespace

kernel_function copy_kernel([[maybe_unused]] std::size_t bytes) noexcept {
#if defined(__x86_64__)
  if (bytes >= streaming_bytes) return &stream_bytes;
#endif
  return &copy_bytes;
}

kernel_function set_kernel() noexcept { return &set_bytes; }

}  // namespace sycl::detail
