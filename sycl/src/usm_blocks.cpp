// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "usm_blocks.hpp"

#include <sys/mman.h>

#include <algorithm>
#include <bit>
#include <cstdlib>
#include <iterator>
#include <mutex>

namespace sycl::detail::usm_blocks {

namespace {

constexpr std::size_t page = 4096;
constexpr std::size_t huge_page = std::size_t{2} << 20;
/// The system's allocator keeps smaller blocks itself.
constexpr std::size_t largest_small = std::size_t{32} << 10;
constexpr std::size_t most_kept_bytes = std::size_t{256} << 20;
constexpr std::size_t most_kept_blocks = 64;

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
constexpr bool keeps = false;
#elif defined(__has_feature)
#if __has_feature(address_sanitizer) || __has_feature(thread_sanitizer)
constexpr bool keeps = false;
#else
constexpr bool keeps = true;
#endif
#else
constexpr bool keeps = true;
#endif

bool is_kept(std::size_t bytes) noexcept {
  return keeps && bytes > largest_small && bytes <= most_kept_bytes;
}

/// The size of the block for an allocation that may be kept: in steps of an eighth of its power of
/// two, so that sizes that differ a little share blocks.
std::size_t capacity(std::size_t bytes) noexcept {
  const std::size_t step = std::max(page, std::bit_floor(bytes) / 8);
  return (bytes + step - 1) / step * step;
}

/// Large blocks start on a boundary of huge pages, which cost one fault each.
void* fresh(std::size_t bytes, std::size_t alignment) noexcept {
  const bool huge = bytes >= 2 * huge_page;
  void* block = nullptr;
  if (posix_memalign(&block, huge ? std::max(alignment, huge_page) : alignment, bytes) != 0) {
    return nullptr;
  }
  if (huge) madvise(block, bytes & ~(huge_page - 1), MADV_HUGEPAGE);
  return block;
}

/// The kept blocks, the one freed last at the end.
class store {
 public:
  void* take(std::size_t size) noexcept {
    const std::lock_guard lock(mutex_);
    const auto last = std::make_reverse_iterator(kept_ + count_);
    const auto found =
        std::find_if(last, std::rend(kept_), [size](const entry& e) { return e.size == size; });
    if (found == std::rend(kept_)) return nullptr;
    void* const block = found->block;
    remove(found.base() - 1);
    return block;
  }

  /// Makes room by freeing the blocks that have lain longest.
  void keep(void* block, std::size_t size) noexcept {
    const std::lock_guard lock(mutex_);
    while (count_ == most_kept_blocks || (count_ > 0 && bytes_ + size > most_kept_bytes)) {
      std::free(kept_[0].block);
      remove(kept_);
    }
    kept_[count_++] = {block, size};
    bytes_ += size;
  }

 private:
  struct entry {
    void* block;
    std::size_t size;
  };

  void remove(entry* e) noexcept {
    bytes_ -= e->size;
    std::copy(e + 1, kept_ + count_, e);
    --count_;
  }

  std::mutex mutex_;
  entry kept_[most_kept_blocks];
  std::size_t count_ = 0;
  std::size_t bytes_ = 0;
};

/// Never destroyed: static objects may free memory.
store& blocks() {
  static store& instance = *new store;
  return instance;
}

}  // namespace

void* take(std::size_t bytes, std::size_t alignment) noexcept {
  if (!is_kept(bytes)) return fresh(bytes, alignment);
  const std::size_t size = capacity(bytes);
  if (alignment <= page) {
    if (void* const block = blocks().take(size)) return block;
  }
  return fresh(size, std::max(alignment, page));
}

void give_back(void* block, std::size_t bytes) noexcept {
  if (is_kept(bytes)) {
    blocks().keep(block, capacity(bytes));
  } else {
    std::free(block);
  }
}

}  // namespace sycl::detail::usm_blocks
