// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <type_traits>

#include "atomic_ref.hpp"

namespace sycl {

enum class access_mode : int { read, write, read_write };

enum class target : int { device, host_task };

namespace access {
using sycl::target;
using mode = access_mode;
enum class placeholder : int { false_t, true_t };
enum class decorated : int { no, yes };
}  // namespace access

namespace detail {
template <typename DataT>
inline constexpr access_mode default_mode_v =
    std::is_const_v<DataT> ? access_mode::read : access_mode::read_write;

/// An accessor of no dimensions is one of the first element in one dimension.
template <int Dimensions>
inline constexpr int rank_v = Dimensions == 0 ? 1 : Dimensions;
}  // namespace detail

template <typename DataT, int Dimensions = 1, access_mode Mode = detail::default_mode_v<DataT>,
          target Target = target::device,
          access::placeholder Placeholder = access::placeholder::false_t>
class accessor;

template <typename DataT, int Dimensions = 1, access_mode Mode = detail::default_mode_v<DataT>>
class host_accessor;

/// The tags by which an accessor's mode and target are deduced.
template <access_mode Mode>
struct mode_tag_t {
  explicit mode_tag_t() = default;
};
template <access_mode Mode, target Target>
struct mode_target_tag_t {
  explicit mode_target_tag_t() = default;
};

inline constexpr mode_tag_t<access_mode::read> read_only{};
inline constexpr mode_tag_t<access_mode::read_write> read_write{};
inline constexpr mode_tag_t<access_mode::write> write_only{};
inline constexpr mode_target_tag_t<access_mode::read, target::host_task> read_only_host_task{};
inline constexpr mode_target_tag_t<access_mode::read_write, target::host_task>
    read_write_host_task{};
inline constexpr mode_target_tag_t<access_mode::write, target::host_task> write_only_host_task{};

}  // namespace sycl
