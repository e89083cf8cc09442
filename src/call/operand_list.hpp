// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <array>
#include <cstddef>
#include <initializer_list>
#include <ranges>

namespace arbor::lumen::vm::detail {

/// The operands of one kind in the order of an argument list, or what belongs to each of them. They
/// are stored in place, so that a call allocates nothing for them.
template <typename V>
class operand_list {
 public:
  static constexpr std::size_t capacity = 4;  ///< no shape has more

  operand_list() {}  // entries get their values with push_back
  operand_list(std::initializer_list<V> values) {
    for (const V& value : values) push_back(value);
  }
  template <std::ranges::input_range Values>
  operand_list(const Values& values) {
    for (const V& value : values) push_back(value);
  }

  void push_back(const V& value) { entries_[size_++] = value; }
  void clear() { size_ = 0; }

  std::size_t size() const { return size_; }
  bool empty() const { return size_ == 0; }
  V& operator[](std::size_t i) { return entries_[i]; }
  const V& operator[](std::size_t i) const { return entries_[i]; }
  const V& front() const { return entries_[0]; }
  const V* begin() const { return entries_.data(); }
  const V* end() const { return entries_.data() + size_; }

 private:
  std::size_t size_ = 0;
  std::array<V, capacity> entries_;
};

}  // namespace arbor::lumen::vm::detail
