// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Measuring a function against its reference over samples of its arguments.
#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "functor.hpp"
#include "number_format.hpp"
#include "reference.hpp"

namespace arbor::lumen::accuracy {

/// Which arguments are measured.
struct sampling {
  std::vector<range> ranges;      ///< one per operand
  std::uint64_t count = 100'000;  ///< random arguments
  bool uniform = false;           ///< uniform in value instead of uniform over the numbers
  std::uint64_t step = 0;         ///< not 0: every step-th number, for one operand
  std::uint64_t seed = 20240917;
};

/// What is measured: the function at one element type.
struct subject {
  std::string name;
  const number_format* format;
  std::size_t inputs;
  std::size_t outputs;
  /// Computes n elements.
  std::function<void(const void* const* in, void* const* out, std::size_t n)> run;
};

/// By the functor's call, element by element.
subject subject_of(const functor& f);
/// By the vectorised loop where there is one.
subject loop_subject_of(const functor& f);
/// The C library's function of that element type, if it has one.
std::optional<subject> c_library_subject(const reference& r, char type);

struct measurement {
  /// Errors in bins of the binary order of magnitude: below 2^-4, then one per factor 2.
  static constexpr int first_bin_exponent = -4;
  static constexpr int bins = 60;

  std::uint64_t count = 0;
  double largest = 0;  ///< in ulp
  double sum = 0;
  std::array<std::uint64_t, 2> worst_argument{};
  std::uint64_t worst_result = 0;
  std::size_t worst_output = 0;
  std::string worst_exact;
  std::array<std::uint64_t, bins> histogram{};

  double mean() const { return count == 0 ? 0 : sum / static_cast<double>(count); }
  void add(double error);
  /// Takes up what was measured over other arguments.
  void add(const measurement& other);
};

/// Measures subjects of one format and form at the same arguments.
std::vector<measurement> measure(std::span<const subject> subjects, const reference& r,
                                 const sampling& samples);

}  // namespace arbor::lumen::accuracy
