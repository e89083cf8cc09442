// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <atomic>
#include <cstddef>
#include <memory>
#include <utility>

#include "../property.hpp"
#include "export.hpp"
#include "region.hpp"

namespace sycl::detail {

/// Where a buffer's own memory comes from if the allocator is not the default one.
class ARBOR_LUMEN_SYCL_API buffer_memory {
 public:
  virtual ~buffer_memory();
  virtual void* allocate(std::size_t elements) = 0;
  virtual void release(void* memory, std::size_t elements) noexcept = 0;
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

class buffer_view;

/// Shares a view, which ends with its last handle.
class view_handle {
 public:
  view_handle() noexcept = default;
  /// Takes over the handle that a new view counts.
  explicit view_handle(buffer_view* counted) noexcept : view_(counted) {}
  view_handle(const view_handle& other) noexcept;
  view_handle(view_handle&& other) noexcept : view_(std::exchange(other.view_, nullptr)) {}
  view_handle& operator=(view_handle other) noexcept {
    std::swap(view_, other.view_);
    return *this;
  }
  ~view_handle();

  buffer_view* get() const noexcept { return view_; }
  /// The view with its count, for another owner.
  buffer_view* release() noexcept { return std::exchange(view_, nullptr); }

  friend bool operator==(const view_handle& a, const view_handle& b) noexcept = default;

 private:
  buffer_view* view_ = nullptr;
};

/// A buffer, a sub-buffer or a reinterpretation: a region of a storage that they share. That of the
/// whole buffer is a member of the storage and outlives its parts; these are objects by themselves.
class ARBOR_LUMEN_SYCL_API buffer_view {
 public:
  buffer_view(const buffer_view&) = delete;
  buffer_view& operator=(const buffer_view&) = delete;

  /// A null `memory` stands for the default allocator's.
  static view_handle make(const buffer_description& description,
                          std::unique_ptr<buffer_memory> memory, const property_list& properties);
  /// One more handle on this view.
  view_handle share() noexcept {
    handles_.fetch_add(1, std::memory_order_relaxed);
    return view_handle(this);
  }
  /// A part of this view, which starts `offset` bytes into it.
  view_handle part(std::size_t offset, std::size_t bytes);
  /// All of this view, as elements of another type.
  view_handle reinterpretation();

  bool is_sub_buffer() const noexcept { return sub_buffer_; }
  const region& bytes() const noexcept { return region_; }
  std::size_t size() const noexcept { return region_.end - region_.begin; }
  const property_list& properties() const noexcept;
  void set_final_data(std::unique_ptr<final_destination> destination, std::size_t element_size);
  void set_write_back(bool enabled);

 private:
  friend class view_handle;
  friend class buffer_storage;

  /// Of a whole buffer.
  explicit buffer_view(const region& whole) noexcept : region_(whole) {}
  buffer_view(view_handle whole, const region& bytes, bool sub_buffer) noexcept
      : region_(bytes), whole_(std::move(whole)), sub_buffer_(sub_buffer) {}
  ~buffer_view() = default;

  view_handle whole();
  /// The last handle is gone.
  void end();

  region region_;
  std::atomic<std::size_t> handles_{1};
  /// The view of the whole buffer; null for that view itself.
  view_handle whole_;
  bool sub_buffer_ = false;
  /// Of a part alone; that of the whole buffer is in the storage.
  std::unique_ptr<final_destination> destination_;
  std::size_t element_size_ = 1;
  bool write_back_ = true;
};

inline view_handle::view_handle(const view_handle& other) noexcept
    : view_(other.view_ != nullptr ? other.view_->share().release() : nullptr) {}

inline view_handle::~view_handle() {
  // Nobody can copy the only handle meanwhile, so it needs no counting down.
  if (view_ != nullptr && (view_->handles_.load(std::memory_order_acquire) == 1 ||
                           view_->handles_.fetch_sub(1, std::memory_order_acq_rel) == 1)) {
    view_->end();
  }
}

/// A buffer's handle on its view. That of a small buffer without contents or properties is made
/// when something first asks for it: of many such buffers, like the status of a call that reports
/// nothing, nobody ever does.
class deferred_view {
 public:
  deferred_view(view_handle made) noexcept : view_(made.release()) {}
  deferred_view(std::size_t elements, std::size_t element_size) noexcept
      : elements_(elements), element_size_(element_size) {}
  /// Whether the view of a buffer without contents may wait. The bytes of many elements may be more
  /// than can be counted.
  static bool may_defer(std::size_t elements, std::size_t element_size,
                        const property_list& properties) noexcept {
    return elements <= small && elements * element_size <= small && properties.entries_.empty();
  }
  /// Makes the view of `other`, which the copy shares.
  deferred_view(const deferred_view& other) : deferred_view(other->share()) {}
  deferred_view(deferred_view&& other) noexcept
      : view_(other.view_.load(std::memory_order_relaxed)),
        elements_(other.elements_),
        element_size_(other.element_size_) {
    other.view_.store(nullptr, std::memory_order_relaxed);
  }
  deferred_view& operator=(deferred_view other) noexcept {
    buffer_view* const before = view_.load(std::memory_order_relaxed);
    view_.store(other.view_.load(std::memory_order_relaxed), std::memory_order_relaxed);
    other.view_.store(before, std::memory_order_relaxed);
    elements_ = other.elements_;
    element_size_ = other.element_size_;
    return *this;
  }
  ~deferred_view() { view_handle(view_.load(std::memory_order_relaxed)); }

  buffer_view* get() const {
    buffer_view* const made = view_.load(std::memory_order_acquire);
    return made != nullptr ? made : make();
  }
  buffer_view* operator->() const { return get(); }
  buffer_view& operator*() const { return *get(); }

  friend bool operator==(const deferred_view& a, const deferred_view& b) noexcept {
    const buffer_view* const made = a.view_.load(std::memory_order_relaxed);
    return made == nullptr ? &a == &b : made == b.view_.load(std::memory_order_relaxed);
  }

  /// The most bytes of such a buffer.
  static constexpr std::size_t small = 64;

 private:
  ARBOR_LUMEN_SYCL_API buffer_view* make() const;

  mutable std::atomic<buffer_view*> view_{nullptr};
  std::size_t elements_ = 0;
  std::size_t element_size_ = 0;
};

}  // namespace sycl::detail
