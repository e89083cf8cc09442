// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Where the arrays lie that functions are timed on.
#pragma once

#include <sys/mman.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <map>
#include <memory>
#include <new>

namespace bench {

/// Two inputs and two outputs of one length, in the same memory for every implementation, so that
/// none of them is lucky with its pages. Huge pages keep address translation out of the times.
/// The arrays start in cache lines that are far apart modulo 4096: at equal distances a processor
/// takes the load of an element for a reader of the store before it and waits, which hits some
/// loops and spares others by chance.
template <typename T>
class arena {
 public:
  explicit arena(std::int64_t n) : n_(static_cast<std::size_t>(n)), memory_(allocate(bytes())) {
    place(memory_.get());
  }

  T* results() const { return results_; }
  T* input(int k) const { return inputs_[k]; }

  /// The one for arrays of `n` elements.
  static const arena& of(std::int64_t n) {
    static std::map<std::int64_t, arena> all;
    return all.try_emplace(n, n).first->second;
  }

 private:
  static constexpr std::size_t page = std::size_t{1} << 21;
  static constexpr std::size_t shift = 1024 + 64;

  struct release {
    void operator()(std::byte* p) const { std::free(p); }
  };

  /// An array's bytes, to a multiple of 4096.
  std::size_t stride(std::size_t elements) const {
    return (elements * sizeof(T) + 4095) / 4096 * 4096;
  }

  std::size_t bytes() const {
    const std::size_t all = stride(2 * n_) + 2 * (stride(n_) + shift);
    return (all + page - 1) / page * page;
  }

  static std::byte* allocate(std::size_t size) {
    auto* const p = static_cast<std::byte*>(std::aligned_alloc(page, size));
    if (p == nullptr) throw std::bad_alloc();
    madvise(p, size, MADV_HUGEPAGE);
    std::fill_n(p, size, std::byte{});
    return p;
  }

  void place(std::byte* p) {
    results_ = reinterpret_cast<T*>(p);
    p += stride(2 * n_) + shift;
    inputs_[0] = reinterpret_cast<T*>(p);
    inputs_[1] = reinterpret_cast<T*>(p + stride(n_) + shift);
  }

  std::size_t n_;
  std::unique_ptr<std::byte, release> memory_;
  T* results_;
  T* inputs_[2];
};

}  // namespace bench
