// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <algorithm>
#include <cstddef>
#include <functional>
#include <iterator>
#include <memory>
#include <new>
#include <type_traits>
#include <utility>
#include <vector>

#include "access.hpp"
#include "detail/buffer_view.hpp"
#include "detail/export.hpp"
#include "id.hpp"
#include "property.hpp"
#include "range.hpp"

namespace sycl {

class handler;

namespace detail {

/// Allocates on cache-line boundaries.
template <typename T>
class aligned_allocator {
 public:
  using value_type = T;
  static constexpr std::align_val_t alignment{alignof(T) > 64 ? alignof(T) : 64};

  constexpr aligned_allocator() noexcept = default;
  template <typename U>
  constexpr aligned_allocator(const aligned_allocator<U>&) noexcept {}

  T* allocate(std::size_t count) {
    if (count > static_cast<std::size_t>(-1) / sizeof(T)) throw std::bad_array_new_length();
    return static_cast<T*>(::operator new(count * sizeof(T), alignment));
  }
  void deallocate(T* memory, std::size_t) noexcept { ::operator delete(memory, alignment); }

  template <typename U>
  friend constexpr bool operator==(const aligned_allocator&, const aligned_allocator<U>&) noexcept {
    return true;
  }
};

template <typename T, typename AllocatorT>
class allocator_memory final : public buffer_memory {
 public:
  explicit allocator_memory(const AllocatorT& allocator) : allocator_(allocator) {}
  void* allocate(std::size_t elements) override {
    return std::to_address(std::allocator_traits<AllocatorT>::allocate(allocator_, elements));
  }
  void release(void* memory, std::size_t elements) noexcept override {
    std::allocator_traits<AllocatorT>::deallocate(allocator_, static_cast<T*>(memory), elements);
  }

 private:
  AllocatorT allocator_;
};

template <typename T, typename AllocatorT>
inline constexpr bool is_default_allocator =
    alignof(T) <= 64 && std::is_same_v<AllocatorT, aligned_allocator<T>>;

/// Null for the default allocator.
template <typename T, typename AllocatorT>
std::unique_ptr<buffer_memory> memory_of(const AllocatorT& allocator) {
  if constexpr (is_default_allocator<T, AllocatorT>) {
    return nullptr;
  } else {
    return std::make_unique<allocator_memory<T, AllocatorT>>(allocator);
  }
}

template <typename T, typename Destination>
class iterator_destination final : public final_destination {
 public:
  explicit iterator_destination(Destination destination) : destination_(std::move(destination)) {}
  void write(const void* data, std::size_t elements) override {
    std::copy_n(static_cast<const T*>(data), elements, destination_);
  }

 private:
  Destination destination_;
};

template <typename T, typename Pointee>
class weak_destination final : public final_destination {
 public:
  explicit weak_destination(std::weak_ptr<Pointee> destination)
      : destination_(std::move(destination)) {}
  void write(const void* data, std::size_t elements) override {
    const std::shared_ptr<Pointee> alive = destination_.lock();
    if (alive == nullptr) return;
    std::copy_n(static_cast<const T*>(data), elements,
                static_cast<std::remove_extent_t<Pointee>*>(alive.get()));
  }

 private:
  std::weak_ptr<Pointee> destination_;
};

template <typename Container, typename T>
concept contiguous_container = requires(Container& container) {
  { *container.data() } -> std::convertible_to<const T&>;
  { container.size() } -> std::convertible_to<std::size_t>;
};

template <typename Iterator>
concept input_iterator = requires(Iterator iterator) {
  typename std::iterator_traits<Iterator>::iterator_category;
};

}  // namespace detail

template <typename T>
using buffer_allocator = detail::aligned_allocator<T>;

/// An array in one to three dimensions to which commands and the host have ordered access.
template <typename T, int Dimensions = 1,
          typename AllocatorT = buffer_allocator<std::remove_const_t<T>>>
class buffer {
  static_assert(Dimensions >= 1 && Dimensions <= 3);
  static_assert(!std::is_volatile_v<T>);

  using plain = std::remove_const_t<T>;

 public:
  using value_type = T;
  using reference = value_type&;
  using const_reference = const value_type&;
  using allocator_type = AllocatorT;

  buffer(const range<Dimensions>& extents, const property_list& properties = {})
      : view_(plain_view(extents, properties)), range_(extents) {}
  buffer(const range<Dimensions>& extents, AllocatorT allocator,
         const property_list& properties = {})
      : buffer(extents, std::move(allocator), properties, {}) {}

  /// Works in the caller's memory, which holds the contents when the buffer is gone.
  buffer(plain* host_data, const range<Dimensions>& extents, const property_list& properties = {})
      : buffer(host_data, extents, AllocatorT(), properties) {}
  buffer(plain* host_data, const range<Dimensions>& extents, AllocatorT allocator,
         const property_list& properties = {})
      : buffer(extents, std::move(allocator), properties,
               {.initial = host_data, .write_back = true, .in_place = true, .keep_alive = {}}) {}
  /// Copies the caller's memory and leaves it as it is.
  buffer(const plain* host_data, const range<Dimensions>& extents,
         const property_list& properties = {})
      : buffer(host_data, extents, AllocatorT(), properties) {}
  buffer(const plain* host_data, const range<Dimensions>& extents, AllocatorT allocator,
         const property_list& properties = {})
      : buffer(extents, std::move(allocator), properties,
               {.initial = host_data, .in_place = std::is_const_v<T>, .keep_alive = {}}) {}

  template <typename Pointee>
  requires(std::is_same_v<std::remove_extent_t<Pointee>, plain>)
      buffer(const std::shared_ptr<Pointee>& host_data, const range<Dimensions>& extents,
             const property_list& properties = {})
      : buffer(host_data, extents, AllocatorT(), properties) {}
  template <typename Pointee>
  requires(std::is_same_v<std::remove_extent_t<Pointee>, plain>)
      buffer(const std::shared_ptr<Pointee>& host_data, const range<Dimensions>& extents,
             AllocatorT allocator, const property_list& properties = {})
      : buffer(extents, std::move(allocator), properties,
               {.initial = host_data.get(),
                .write_back = true,
                .in_place = true,
                .keep_alive = host_data}) {}

  template <detail::input_iterator InputIterator>
  requires(Dimensions == 1)
      buffer(InputIterator first, InputIterator last, const property_list& properties = {})
      : buffer(std::move(first), std::move(last), AllocatorT(), properties) {}
  template <detail::input_iterator InputIterator>
  requires(Dimensions == 1) buffer(InputIterator first, InputIterator last, AllocatorT allocator,
                                   const property_list& properties = {})
      : buffer(std::vector<element>(first, last), std::move(allocator), properties) {}

  template <typename Container>
  requires(Dimensions == 1 && detail::contiguous_container<Container, T>)
      buffer(Container& container, const property_list& properties = {})
      : buffer(container, AllocatorT(), properties) {}
  template <typename Container>
  requires(Dimensions == 1 && detail::contiguous_container<Container, T>)
      buffer(Container& container, AllocatorT allocator, const property_list& properties = {})
      : buffer(container.data(), range<1>(container.size()), std::move(allocator), properties) {}

  /// The part of `parent` that begins at `base_index`; it must be contiguous.
  buffer(buffer& parent, const id<Dimensions>& base_index, const range<Dimensions>& extents)
      : view_(sub_view(parent, base_index, extents)), range_(extents) {}

  range<Dimensions> get_range() const noexcept { return range_; }
  std::size_t size() const noexcept { return range_.size(); }
  std::size_t byte_size() const noexcept { return size() * sizeof(T); }
  /// The deprecated names of size() and byte_size().
  std::size_t get_count() const noexcept { return size(); }
  std::size_t get_size() const noexcept { return byte_size(); }
  AllocatorT get_allocator() const { return allocator_; }

  template <access_mode Mode, target Target = target::device>
  auto get_access(handler& cgh);
  template <access_mode Mode, target Target = target::device>
  auto get_access(handler& cgh, range<Dimensions> extent, id<Dimensions> offset = {});
  template <typename... Ts>
  auto get_access(Ts... args);
  template <typename... Ts>
  auto get_access(handler& cgh, Ts... args);
  template <typename... Ts>
  auto get_host_access(Ts... args);

  /// Where the contents go when the buffer is gone: an output iterator, a weak_ptr, or nullptr.
  template <typename Destination = std::nullptr_t>
  void set_final_data(Destination destination = nullptr) {
    std::unique_ptr<detail::final_destination> writer;
    if constexpr (std::is_same_v<Destination, std::nullptr_t>) {
    } else if constexpr (std::is_pointer_v<Destination>) {
      if (destination != nullptr) {
        writer = std::make_unique<detail::iterator_destination<plain, Destination>>(destination);
      }
    } else if constexpr (requires {
                           typename Destination::element_type;
                           destination.lock();
                         }) {
      writer =
          std::make_unique<detail::weak_destination<plain, typename Destination::element_type>>(
              destination);
    } else if constexpr (requires {
                           typename Destination::element_type;
                           destination.get();
                         }) {
      writer =
          std::make_unique<detail::weak_destination<plain, typename Destination::element_type>>(
              destination);
    } else {
      writer = std::make_unique<detail::iterator_destination<plain, Destination>>(
          std::move(destination));
    }
    view_->set_final_data(std::move(writer), sizeof(T));
  }
  void set_write_back(bool enabled = true) { view_->set_write_back(enabled); }

  bool is_sub_buffer() const { return view_->is_sub_buffer(); }

  template <typename ReinterpretT, int ReinterpretDim>
  auto reinterpret(range<ReinterpretDim> extents) const {
    using result = buffer<ReinterpretT, ReinterpretDim,
                          typename std::allocator_traits<AllocatorT>::template rebind_alloc<
                              std::remove_const_t<ReinterpretT>>>;
    if (extents.size() * sizeof(ReinterpretT) != byte_size()) {
      detail::throw_error(errc::invalid, "a reinterpreted buffer must have as many bytes");
    }
    return result(view_->reinterpretation(), extents, typename result::allocator_type(allocator_));
  }
  template <typename ReinterpretT, int ReinterpretDim = Dimensions>
  requires(ReinterpretDim == 1 || (ReinterpretDim == Dimensions &&
                                   sizeof(ReinterpretT) == sizeof(T))) auto reinterpret() const {
    if constexpr (ReinterpretDim == 1) {
      if (byte_size() % sizeof(ReinterpretT) != 0) {
        detail::throw_error(errc::invalid, "a reinterpreted buffer must have as many bytes");
      }
      return reinterpret<ReinterpretT>(range<1>(byte_size() / sizeof(ReinterpretT)));
    } else {
      return reinterpret<ReinterpretT>(range_);
    }
  }

  template <typename Property>
  bool has_property() const noexcept {
    return view_->properties().template has_property<Property>();
  }
  template <typename Property>
  Property get_property() const {
    return view_->properties().template get_property<Property>();
  }

  /// The untyped buffer, for the runtime.
  const detail::buffer_view& view() const { return *view_; }

  friend bool operator==(const buffer& a, const buffer& b) noexcept { return a.view_ == b.view_; }

 private:
  template <typename, int, typename>
  friend class buffer;
  friend struct std::hash<buffer>;

  /// Keeps std::vector from packing bool.
  struct element {
    template <typename U>
    element(U&& from) : value(std::forward<U>(from)) {}
    plain value;
  };

  buffer(const range<Dimensions>& extents, AllocatorT allocator, const property_list& properties,
         detail::buffer_description description)
      : view_(make_view(extents, allocator, properties, std::move(description))),
        range_(extents),
        allocator_(std::move(allocator)) {}
  buffer(const std::vector<element>& contents, AllocatorT allocator,
         const property_list& properties)
      : buffer(range<1>(contents.size()), std::move(allocator), properties,
               {.initial = contents.data(), .keep_alive = {}}) {}
  buffer(detail::deferred_view view, const range<Dimensions>& extents, AllocatorT allocator)
      : view_(std::move(view)), range_(extents), allocator_(std::move(allocator)) {}

  static detail::deferred_view make_view(const range<Dimensions>& extents,
                                         const AllocatorT& allocator,
                                         const property_list& properties,
                                         detail::buffer_description description) {
    using plain_allocator =
        typename std::allocator_traits<AllocatorT>::template rebind_alloc<plain>;
    description.elements = extents.size();
    description.element_size = sizeof(T);
    return detail::buffer_view::make(
        description, detail::memory_of<plain>(plain_allocator(allocator)), properties);
  }

  /// Of uninitialised memory from a default-constructed allocator.
  static detail::deferred_view plain_view(const range<Dimensions>& extents,
                                          const property_list& properties) {
    if constexpr (detail::is_default_allocator<plain, AllocatorT>) {
      if (detail::deferred_view::may_defer(extents.size(), sizeof(T), properties)) {
        return {extents.size(), sizeof(T)};
      }
    }
    return make_view(extents, AllocatorT(), properties, {});
  }

  static detail::deferred_view sub_view(const buffer& parent, const id<Dimensions>& base_index,
                                        const range<Dimensions>& extents) {
    if (parent.is_sub_buffer()) {
      detail::throw_error(errc::invalid, "a sub-buffer cannot be made of a sub-buffer");
    }
    const range<Dimensions>& whole = parent.range_;
    std::size_t first = 0;
    bool inner_whole = true;
    for (int d = Dimensions - 1; d >= 0; --d) {
      detail::check_access_range(whole[d], base_index[d], extents[d]);
      // Outside the innermost dimension that is cut, every extent is 1.
      if (!inner_whole && extents[d] != 1) {
        detail::throw_error(errc::invalid, "a sub-buffer must be a contiguous region");
      }
      inner_whole = inner_whole && extents[d] == whole[d];
    }
    for (int d = 0; d < Dimensions; ++d) first = first * whole[d] + base_index[d];
    return parent.view_->part(first * sizeof(T), extents.size() * sizeof(T));
  }

  detail::deferred_view view_;
  range<Dimensions> range_;
  AllocatorT allocator_{};
};

template <detail::input_iterator InputIterator, typename AllocatorT>
buffer(InputIterator, InputIterator, AllocatorT, const property_list& = {})
    -> buffer<typename std::iterator_traits<InputIterator>::value_type, 1, AllocatorT>;
template <detail::input_iterator InputIterator>
buffer(InputIterator, InputIterator, const property_list& = {})
    -> buffer<typename std::iterator_traits<InputIterator>::value_type, 1>;
template <typename T, int Dimensions, typename AllocatorT>
buffer(const T*, const range<Dimensions>&, AllocatorT, const property_list& = {})
    -> buffer<T, Dimensions, AllocatorT>;
template <typename T, int Dimensions>
buffer(const T*, const range<Dimensions>&, const property_list& = {}) -> buffer<T, Dimensions>;
template <typename Container, typename AllocatorT>
requires requires(Container& c) { c.data(); }
buffer(Container&, AllocatorT, const property_list& = {})
    ->buffer<typename Container::value_type, 1, AllocatorT>;
template <typename Container>
requires requires(Container& c) { c.data(); }
buffer(Container&, const property_list& = {})->buffer<typename Container::value_type, 1>;

template <typename T, int D, typename A>
struct is_property_of<property::buffer::use_host_ptr, buffer<T, D, A>> : std::true_type {};
template <typename T, int D, typename A>
struct is_property_of<property::buffer::use_mutex, buffer<T, D, A>> : std::true_type {};
template <typename T, int D, typename A>
struct is_property_of<property::buffer::context_bound, buffer<T, D, A>> : std::true_type {};

}  // namespace sycl

template <typename T, int Dimensions, typename AllocatorT>
struct std::hash<sycl::buffer<T, Dimensions, AllocatorT>> {
  std::size_t operator()(const sycl::buffer<T, Dimensions, AllocatorT>& buf) const noexcept {
    return std::hash<const void*>()(buf.view_.get());
  }
};
