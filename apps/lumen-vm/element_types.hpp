// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <stdexcept>
#include <string_view>
#include <sycl/sycl.hpp>

#include "call/shape.hpp"

/// From the letters and names that the command line and the catalogue use to C++ types.
namespace arbor::lumen::vm::tool {

constexpr const char* element_name(char letter) {
  switch (letter) {
    case 'h':
      return "half";
    case 's':
      return "float";
    case 'd':
      return "double";
    case 'c':
      return "complex float";
    case 'z':
      return "complex double";
    default:
      return "unknown";
  }
}

/// Calls `visit.template operator()<T, U>()` for the element types of inputs and outputs.
template <typename Visit>
auto with_types(char in, char out, Visit&& visit) {
  using complex_s = std::complex<float>;
  using complex_d = std::complex<double>;
  if (in == 'h') return visit.template operator()<sycl::half, sycl::half>();
  if (in == 's')
    return out == 'c' ? visit.template operator()<float, complex_s>()
                      : visit.template operator()<float, float>();
  if (in == 'd')
    return out == 'z' ? visit.template operator()<double, complex_d>()
                      : visit.template operator()<double, double>();
  if (in == 'c')
    return out == 's' ? visit.template operator()<complex_s, float>()
                      : visit.template operator()<complex_s, complex_s>();
  return out == 'd' ? visit.template operator()<complex_d, double>()
                    : visit.template operator()<complex_d, complex_d>();
}

/// Calls `visit.template operator()<Shape>()` for the shape of a public function.
template <typename Visit>
auto with_shape(std::string_view name, Visit&& visit) {
  namespace shape = detail::shape;
  if (name == shape::v11::name) return visit.template operator()<shape::v11>();
  if (name == shape::v12::name) return visit.template operator()<shape::v12>();
  if (name == shape::v21::name) return visit.template operator()<shape::v21>();
  if (name == shape::v21c::name) return visit.template operator()<shape::v21c>();
  if (name == shape::v61::name) return visit.template operator()<shape::v61>();
  throw std::logic_error("no public function has the shape " + std::string(name));
}

}  // namespace arbor::lumen::vm::tool
