// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <atomic>
#include <cstddef>
#include <type_traits>

namespace sycl {

enum class memory_order : int { relaxed, acquire, release, acq_rel, seq_cst };
inline constexpr memory_order memory_order_relaxed = memory_order::relaxed;
inline constexpr memory_order memory_order_acquire = memory_order::acquire;
inline constexpr memory_order memory_order_release = memory_order::release;
inline constexpr memory_order memory_order_acq_rel = memory_order::acq_rel;
inline constexpr memory_order memory_order_seq_cst = memory_order::seq_cst;

enum class memory_scope : int { work_item, sub_group, work_group, device, system };
inline constexpr memory_scope memory_scope_work_item = memory_scope::work_item;
inline constexpr memory_scope memory_scope_sub_group = memory_scope::sub_group;
inline constexpr memory_scope memory_scope_work_group = memory_scope::work_group;
inline constexpr memory_scope memory_scope_device = memory_scope::device;
inline constexpr memory_scope memory_scope_system = memory_scope::system;

namespace access {

enum class address_space : int { global_space, local_space, private_space, generic_space };

}  // namespace access

namespace detail {

constexpr std::memory_order to_std(memory_order order) noexcept {
  switch (order) {
    case memory_order::relaxed:
      return std::memory_order_relaxed;
    case memory_order::acquire:
      return std::memory_order_acquire;
    case memory_order::release:
      return std::memory_order_release;
    case memory_order::acq_rel:
      return std::memory_order_acq_rel;
    default:
      return std::memory_order_seq_cst;
  }
}

/// The order of a load that belongs to a read-modify-write operation of the given order.
constexpr memory_order load_order(memory_order order) noexcept {
  if (order == memory_order::acq_rel) return memory_order::acquire;
  return order == memory_order::release ? memory_order::relaxed : order;
}

constexpr memory_order store_order(memory_order order) noexcept {
  return order == memory_order::acq_rel ? memory_order::release : order;
}

template <typename T>
inline constexpr bool is_atomic_integer =
    std::is_same_v<T, int> || std::is_same_v<T, unsigned int> || std::is_same_v<T, long> ||
    std::is_same_v<T, unsigned long> || std::is_same_v<T, long long> ||
    std::is_same_v<T, unsigned long long>;

template <typename T>
inline constexpr bool is_atomic_floating = std::is_same_v<T, float> || std::is_same_v<T, double>;

}  // namespace detail

/// Orders memory accesses around it. Every scope lies within the one process here, so that the
/// widest is as cheap as the narrowest.
inline void atomic_fence(memory_order order, memory_scope scope) noexcept {
  if (scope == memory_scope::work_item) {
    std::atomic_signal_fence(detail::to_std(order));
  } else {
    std::atomic_thread_fence(detail::to_std(order));
  }
}

/// Atomic access to an object that lives elsewhere; while one such reference exists, the object
/// is accessed through atomic references only.
template <typename T, memory_order DefaultOrder, memory_scope DefaultScope,
          access::address_space Space = access::address_space::generic_space>
class atomic_ref {
  static constexpr bool is_integer = detail::is_atomic_integer<T>;
  static constexpr bool is_floating = detail::is_atomic_floating<T>;
  static constexpr bool is_pointer = std::is_pointer_v<T>;
  static_assert(is_integer || is_floating || is_pointer,
                "int, long, long long, their unsigned types, float, double or a pointer");
  static_assert(DefaultOrder == memory_order::relaxed || DefaultOrder == memory_order::acq_rel ||
                    DefaultOrder == memory_order::seq_cst,
                "the default order serves loads, stores and read-modify-write operations");

  template <typename U, bool Pointer>
  struct difference {
    using type = U;
  };
  template <typename U>
  struct difference<U, true> {
    using type = std::ptrdiff_t;
  };

 public:
  using value_type = T;
  using difference_type = typename difference<T, is_pointer>::type;

  static constexpr std::size_t required_alignment = std::atomic_ref<T>::required_alignment;
  static constexpr bool is_always_lock_free = std::atomic_ref<T>::is_always_lock_free;
  static constexpr memory_order default_read_order = detail::load_order(DefaultOrder);
  static constexpr memory_order default_write_order = detail::store_order(DefaultOrder);
  static constexpr memory_order default_read_modify_write_order = DefaultOrder;
  static constexpr memory_scope default_scope = DefaultScope;

  explicit atomic_ref(T& object) noexcept : ref_(object) {}
  atomic_ref(const atomic_ref&) noexcept = default;
  atomic_ref& operator=(const atomic_ref&) = delete;

  bool is_lock_free() const noexcept {
    // Decided while compiling where it can be: the question at run time may need libatomic.
    if constexpr (is_always_lock_free) {
      return true;
    } else {
      return ref_.is_lock_free();
    }
  }

  void store(T operand, memory_order order = default_write_order,
             memory_scope = default_scope) const noexcept {
    ref_.store(operand, detail::to_std(order));
  }
  T operator=(T desired) const noexcept {
    store(desired);
    return desired;
  }

  T load(memory_order order = default_read_order, memory_scope = default_scope) const noexcept {
    return ref_.load(detail::to_std(order));
  }
  operator T() const noexcept { return load(); }

  T exchange(T operand, memory_order order = default_read_modify_write_order,
             memory_scope = default_scope) const noexcept {
    return ref_.exchange(operand, detail::to_std(order));
  }

  bool compare_exchange_weak(T& expected, T desired, memory_order success, memory_order failure,
                             memory_scope = default_scope) const noexcept {
    return ref_.compare_exchange_weak(expected, desired, detail::to_std(success),
                                      detail::to_std(failure));
  }
  bool compare_exchange_weak(T& expected, T desired,
                             memory_order order = default_read_modify_write_order,
                             memory_scope scope = default_scope) const noexcept {
    return compare_exchange_weak(expected, desired, order, detail::load_order(order), scope);
  }
  bool compare_exchange_strong(T& expected, T desired, memory_order success, memory_order failure,
                               memory_scope = default_scope) const noexcept {
    return ref_.compare_exchange_strong(expected, desired, detail::to_std(success),
                                        detail::to_std(failure));
  }
  bool compare_exchange_strong(T& expected, T desired,
                               memory_order order = default_read_modify_write_order,
                               memory_scope scope = default_scope) const noexcept {
    return compare_exchange_strong(expected, desired, order, detail::load_order(order), scope);
  }

  T fetch_add(difference_type operand, memory_order order = default_read_modify_write_order,
              memory_scope = default_scope) const noexcept {
    return ref_.fetch_add(operand, detail::to_std(order));
  }
  T fetch_sub(difference_type operand, memory_order order = default_read_modify_write_order,
              memory_scope = default_scope) const noexcept {
    return ref_.fetch_sub(operand, detail::to_std(order));
  }
  T operator+=(difference_type operand) const noexcept {
    return advanced(fetch_add(operand), operand);
  }
  T operator-=(difference_type operand) const noexcept {
    return retreated(fetch_sub(operand), operand);
  }

  T operator++(int) const noexcept requires(is_integer || is_pointer) { return fetch_add(1); }
  T operator--(int) const noexcept requires(is_integer || is_pointer) { return fetch_sub(1); }
  T operator++() const noexcept requires(is_integer || is_pointer) { return *this += 1; }
  T operator--() const noexcept requires(is_integer || is_pointer) { return *this -= 1; }

  T fetch_and(T operand, memory_order order = default_read_modify_write_order,
              memory_scope = default_scope) const noexcept requires is_integer {
    return ref_.fetch_and(operand, detail::to_std(order));
  }
  T fetch_or(T operand, memory_order order = default_read_modify_write_order,
             memory_scope = default_scope) const noexcept requires is_integer {
    return ref_.fetch_or(operand, detail::to_std(order));
  }
  T fetch_xor(T operand, memory_order order = default_read_modify_write_order,
              memory_scope = default_scope) const noexcept requires is_integer {
    return ref_.fetch_xor(operand, detail::to_std(order));
  }
  T operator&=(T operand) const noexcept requires is_integer {
    return fetch_and(operand) & operand;
  }
  T operator|=(T operand) const noexcept requires is_integer { return fetch_or(operand) | operand; }
  T operator^=(T operand) const noexcept requires is_integer {
    return fetch_xor(operand) ^ operand;
  }

  T fetch_min(T operand, memory_order order = default_read_modify_write_order,
              memory_scope scope = default_scope) const noexcept
      requires(is_integer || is_floating) {
    T seen = load(detail::load_order(order), scope);
    while (!compare_exchange_weak(seen, operand < seen ? operand : seen, order, scope)) {
    }
    return seen;
  }
  T fetch_max(T operand, memory_order order = default_read_modify_write_order,
              memory_scope scope = default_scope) const noexcept
      requires(is_integer || is_floating) {
    T seen = load(detail::load_order(order), scope);
    while (!compare_exchange_weak(seen, seen < operand ? operand : seen, order, scope)) {
    }
    return seen;
  }

 private:
  // Integers wrap around, as the atomic operations themselves do.
  static T advanced(T value, difference_type operand) noexcept {
    if constexpr (is_integer) {
      using unsigned_type = std::make_unsigned_t<T>;
      return static_cast<T>(static_cast<unsigned_type>(value) +
                            static_cast<unsigned_type>(operand));
    } else {
      return value + operand;
    }
  }
  static T retreated(T value, difference_type operand) noexcept {
    if constexpr (is_integer) {
      using unsigned_type = std::make_unsigned_t<T>;
      return static_cast<T>(static_cast<unsigned_type>(value) -
                            static_cast<unsigned_type>(operand));
    } else {
      return value - operand;
    }
  }

  std::atomic_ref<T> ref_;
};

}  // namespace sycl
