// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <ostream>
#include <sycl/sycl.hpp>
#include <vector>

namespace arbor::lumen::tests {

/// The memory that a caller can hand to a call.
enum class memory { device, shared, host, plain };

inline constexpr memory all_memories[] = {memory::device, memory::shared, memory::host,
                                          memory::plain};

/// Whether a launcher has to make a device copy.
inline bool is_staged(memory kind) { return kind == memory::host || kind == memory::plain; }

inline const char* name_of(memory kind) {
  constexpr const char* names[] = {"device", "shared", "host", "plain"};
  return names[static_cast<int>(kind)];
}
inline std::ostream& operator<<(std::ostream& out, memory kind) { return out << name_of(kind); }

/// An array in memory of one kind.
template <typename T>
class array {
 public:
  array(sycl::queue& queue, memory kind, const std::vector<T>& contents)
      : queue_(queue), kind_(kind), size_(contents.size()) {
    switch (kind) {
      case memory::device:
        data_ = sycl::malloc_device<T>(size_, queue_);
        break;
      case memory::shared:
        data_ = sycl::malloc_shared<T>(size_, queue_);
        break;
      case memory::host:
        data_ = sycl::malloc_host<T>(size_, queue_);
        break;
      case memory::plain:
        data_ = new T[size_];
        break;
    }
    write(contents);
  }
  array(sycl::queue& queue, memory kind, std::size_t size, T value)
      : array(queue, kind, std::vector<T>(size, value)) {}
  array(const array&) = delete;
  array& operator=(const array&) = delete;
  ~array() {
    if (kind_ == memory::plain)
      delete[] data_;
    else
      sycl::free(data_, queue_);
  }

  T* data() { return data_; }
  operator T*() { return data_; }

  void write(const std::vector<T>& contents) {
    queue_.memcpy(data_, contents.data(), contents.size() * sizeof(T)).wait();
  }
  std::vector<T> read() {
    std::vector<T> contents(size_);
    queue_.memcpy(contents.data(), data_, size_ * sizeof(T)).wait();
    return contents;
  }

 private:
  sycl::queue queue_;
  memory kind_;
  std::size_t size_;
  T* data_ = nullptr;
};

/// What the runtime knows of a pointer.
inline sycl::usm::alloc pointer_type(const void* pointer, const sycl::queue& queue) {
  return sycl::get_pointer_type(pointer, queue.get_context());
}

}  // namespace arbor::lumen::tests
