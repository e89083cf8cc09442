// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <memory>

#include "../property.hpp"
#include "export.hpp"
#include "region.hpp"

namespace sycl::detail {

/// Where a buffer's own memory comes from.
class ARBOR_LUMEN_SYCL_API buffer_memory {
 public:
  virtual ~buffer_memory();
  virtual void* allocate(std::size_t elements) = 0;
  virtual void release(void* memory, std::size_t elements) noexcept = 0;
  /// Whether it is the default allocator's, so that nobody sees when none is asked for.
  virtual bool is_default() const noexcept = 0;
};

/// Where a buffer's contents go in the end.
class ARBOR_LUMEN_SYCL_API final_destination {
 public:
  virtual ~final_destination();
  virtual void write(const void* data, std::size_t elements) = 0;
};

struct buffer_description {
  std::size_t elements = 0;
  std::size_t element_size = 0;
  /// Initial contents, if any.
  const void* initial = nullptr;
  /// `initial` may be written to, and gets the final contents.
  bool write_back = false;
  /// The buffer works in `initial` itself if nothing speaks against it.
  bool in_place = false;
  /// Owner of `initial`.
  std::shared_ptr<const void> keep_alive;
};

class buffer_core;

/// A buffer, a sub-buffer or a reinterpretation: a region of a storage that they share.
class ARBOR_LUMEN_SYCL_API buffer_view {
 public:
  buffer_view(buffer_description description, std::unique_ptr<buffer_memory> memory,
              const property_list& properties);
  /// A part of `parent`, which starts `offset` bytes into it.
  buffer_view(const buffer_view& parent, std::size_t offset, std::size_t bytes);
  /// All of `parent`, as elements of another type.
  explicit buffer_view(const buffer_view& parent);
  ~buffer_view();
  buffer_view& operator=(const buffer_view&) = delete;

  bool is_sub_buffer() const noexcept { return sub_buffer_; }
  const region& bytes() const noexcept { return region_; }
  std::size_t size() const noexcept { return region_.end - region_.begin; }
  const property_list& properties() const noexcept;
  void set_final_data(std::unique_ptr<final_destination> destination, std::size_t element_size);
  void set_write_back(bool enabled);

 private:
  std::shared_ptr<buffer_core> core_;
  region region_;
  bool sub_buffer_ = false;
  /// Of this view alone; that of the whole buffer is in the core.
  std::unique_ptr<final_destination> destination_;
  std::size_t element_size_ = 1;
  bool write_back_ = true;
};

}  // namespace sycl::detail
