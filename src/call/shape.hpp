// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

/// The launch shapes: how many array inputs, constants and outputs a function has, in the order of
/// an argument list. The names count inputs and outputs; `c` stands for a constant, `i` for an
/// index, and the six inputs of `v61` are two arrays and four constants.
namespace arbor::lumen::vm::detail::shape {

struct v11 {
  static constexpr const char* name = "v11";
  static constexpr int inputs = 1, constants = 0, outputs = 1;
};
struct v12 {
  static constexpr const char* name = "v12";
  static constexpr int inputs = 1, constants = 0, outputs = 2;
};
struct v21 {
  static constexpr const char* name = "v21";
  static constexpr int inputs = 2, constants = 0, outputs = 1;
};
struct v21c {
  static constexpr const char* name = "v21c";
  static constexpr int inputs = 1, constants = 1, outputs = 1;
};
struct v31 {
  static constexpr const char* name = "v31";
  static constexpr int inputs = 3, constants = 0, outputs = 1;
};
struct v61 {
  static constexpr const char* name = "v61";
  static constexpr int inputs = 2, constants = 4, outputs = 1;
};
struct vc1 {
  static constexpr const char* name = "vc1";
  static constexpr int inputs = 0, constants = 1, outputs = 1;
};
struct vc2 {
  static constexpr const char* name = "vc2";
  static constexpr int inputs = 0, constants = 1, outputs = 2;
};
struct vi2c1 {
  static constexpr const char* name = "vi2c1";
  static constexpr int inputs = 0, constants = 2, outputs = 1;
};

/// Whether functors of the shape are told the index of their element, behind the constants.
template <typename Shape>
inline constexpr bool is_indexed = false;
template <>
inline constexpr bool is_indexed<vi2c1> = true;

}  // namespace arbor::lumen::vm::detail::shape
