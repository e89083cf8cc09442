// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <array>
#include <cstddef>
#include <optional>
#include <tuple>
#include <type_traits>
#include <utility>
#include <variant>

namespace sycl {

/// Whether kernels may capture objects of the type. A program may specialise it for types of its
/// own.
template <typename T>
struct is_device_copyable : std::is_trivially_copyable<T> {};
template <typename T>
inline constexpr bool is_device_copyable_v = is_device_copyable<T>::value;

template <typename T>
struct is_device_copyable<const T> : is_device_copyable<T> {};
template <typename T, std::size_t N>
struct is_device_copyable<T[N]> : is_device_copyable<T> {};
template <typename T, std::size_t N>
struct is_device_copyable<const T[N]> : is_device_copyable<T> {};

// Assignment keeps these from being trivially copyable in general.
template <typename T, std::size_t N>
struct is_device_copyable<std::array<T, N>> : is_device_copyable<T> {};
template <typename T>
struct is_device_copyable<std::array<T, 0>> : std::true_type {};
template <typename T>
struct is_device_copyable<std::optional<T>> : is_device_copyable<T> {};
template <typename T1, typename T2>
struct is_device_copyable<std::pair<T1, T2>>
    : std::bool_constant<is_device_copyable_v<T1> && is_device_copyable_v<T2>> {};
template <typename... Ts>
struct is_device_copyable<std::tuple<Ts...>>
    : std::bool_constant<(is_device_copyable_v<Ts> && ...)> {};
template <typename... Ts>
struct is_device_copyable<std::variant<Ts...>>
    : std::bool_constant<(is_device_copyable_v<Ts> && ...)> {};

}  // namespace sycl
