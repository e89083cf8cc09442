// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <memory>
#include <mutex>
#include <type_traits>
#include <utility>
#include <vector>

#include "detail/export.hpp"
#include "exception.hpp"

namespace sycl {

class context;

namespace property {

namespace queue {
/// Events of the queue carry times.
class enable_profiling {
 public:
  enable_profiling() = default;
};
/// Commands run one after the other, in the order of their submission.
class in_order {
 public:
  in_order() = default;
};
}  // namespace queue

namespace buffer {
/// The buffer works in the memory that it was given, whatever happens.
class use_host_ptr {
 public:
  use_host_ptr() = default;
};
/// The buffer reads and writes the memory that it was given only while it holds the mutex.
class use_mutex {
 public:
  use_mutex(std::mutex& mutex) : mutex_(&mutex) {}
  std::mutex* get_mutex_ptr() const { return mutex_; }

 private:
  std::mutex* mutex_;
};
/// The buffer is used with queues of one context only.
class ARBOR_LUMEN_SYCL_API context_bound {
 public:
  context_bound(context bound_context);
  context get_context() const;

 private:
  std::shared_ptr<const context> context_;
};
}  // namespace buffer

/// The former contents of the accessed region are not needed.
class no_init {
 public:
  no_init() = default;
};

}  // namespace property

inline constexpr property::no_init no_init{};

namespace detail {

class buffer_view;
class deferred_view;

/// The properties by number: the number of a type is the same in every module of a program.
enum class property_number : int {
  none,
  queue_enable_profiling,
  queue_in_order,
  buffer_use_host_ptr,
  buffer_use_mutex,
  buffer_context_bound,
  no_init,
};

template <typename>
inline constexpr property_number property_number_v = property_number::none;
template <>
inline constexpr property_number property_number_v<property::queue::enable_profiling> =
    property_number::queue_enable_profiling;
template <>
inline constexpr property_number property_number_v<property::queue::in_order> =
    property_number::queue_in_order;
template <>
inline constexpr property_number property_number_v<property::buffer::use_host_ptr> =
    property_number::buffer_use_host_ptr;
template <>
inline constexpr property_number property_number_v<property::buffer::use_mutex> =
    property_number::buffer_use_mutex;
template <>
inline constexpr property_number property_number_v<property::buffer::context_bound> =
    property_number::buffer_context_bound;
template <>
inline constexpr property_number property_number_v<property::no_init> = property_number::no_init;

}  // namespace detail

template <typename Property>
struct is_property
    : std::bool_constant<detail::property_number_v<Property> != detail::property_number::none> {};
template <typename Property>
inline constexpr bool is_property_v = is_property<Property>::value;

/// Whether objects of the class accept the property; specialised beside each class.
template <typename Property, typename SyclObject>
struct is_property_of : std::false_type {};
template <typename Property, typename SyclObject>
inline constexpr bool is_property_of_v = is_property_of<Property, SyclObject>::value;

/// The properties that an object is constructed with.
class property_list {
 public:
  template <typename... Properties>
  requires(is_property_v<Properties>&&...) property_list(Properties... properties) {
    if constexpr (sizeof...(Properties) != 0) {
      entries_.reserve(sizeof...(Properties));
      (entries_.push_back({detail::property_number_v<Properties>,
                           std::make_shared<Properties>(std::move(properties))}),
       ...);
    }
  }

  template <typename Property>
  bool has_property() const noexcept {
    return find(detail::property_number_v<Property>) != nullptr;
  }

  template <typename Property>
  requires is_property_v<Property> Property get_property()
  const {
    const void* found = find(detail::property_number_v<Property>);
    if (found == nullptr) detail::throw_error(errc::invalid, "the object lacks this property");
    return *static_cast<const Property*>(found);
  }

 private:
  friend class detail::buffer_view;
  friend class detail::deferred_view;

  struct entry {
    detail::property_number number;
    std::shared_ptr<void> value;
  };

  const void* find(detail::property_number number) const noexcept {
    for (const entry& candidate : entries_) {
      if (candidate.number == number) return candidate.value.get();
    }
    return nullptr;
  }

  std::vector<entry> entries_;
};

}  // namespace sycl
