// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "report.hpp"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <string>

namespace arbor::lumen::accuracy {

namespace {

template <typename... Arguments>
std::string print(const char* format, Arguments... arguments) {
  char text[256];
  std::snprintf(text, sizeof text, format, arguments...);
  return text;
}

std::string pattern(const number_format& format, std::uint64_t p) {
  return print("0x%0*llx", static_cast<int>(2 * format.size), static_cast<unsigned long long>(p));
}

std::string number(const number_format& format, std::uint64_t p) {
  return print("%.17g", format.value(p)) + " (" + pattern(format, p) + ")";
}

std::string how(const sampling& samples) {
  if (samples.step == 1) return "every number";
  if (samples.step != 0) return "every " + std::to_string(samples.step) + "th number";
  return samples.uniform ? "random, uniform in value" : "random numbers of the format";
}

void write_histogram(std::ostream& out, const measurement& m) {
  const auto most = *std::max_element(m.histogram.begin(), m.histogram.end());
  std::size_t last = 0;
  for (std::size_t i = 0; i < m.histogram.size(); ++i) {
    if (m.histogram[i] != 0) last = i;
  }
  for (std::size_t i = 0; i <= last; ++i) {
    // A logarithmic bar: rare large errors are what one looks for.
    const double share = m.histogram[i] == 0
                             ? 0
                             : std::log2(1.0 + static_cast<double>(m.histogram[i])) /
                                   std::log2(1.0 + static_cast<double>(most));
    const double bound = std::ldexp(1.0, measurement::first_bin_exponent + static_cast<int>(i));
    out << print("  below %9.6g ulp %12llu  ", bound,
                 static_cast<unsigned long long>(m.histogram[i]))
        << std::string(static_cast<std::size_t>(std::lround(40 * share)), '#') << "\n";
  }
}

}  // namespace

std::string interval_text(const sampling& samples) {
  std::string text;
  for (const range& r : samples.ranges)
    text += print("%s[%g, %g]", text.empty() ? "" : " × ", r.low, r.high);
  return text;
}

void write_report(std::ostream& out, const subject& s, const sampling& samples,
                  const measurement& m) {
  out << s.name << " over " << interval_text(samples) << ", " << m.count << " results, "
      << how(samples) << "\n";
  out << print("  largest error %.6g ulp, mean %.6g ulp\n", m.largest, m.mean());
  out << "  at ";
  for (std::size_t k = 0; k < s.inputs; ++k)
    out << (k == 0 ? "" : ", ") << number(*s.format, m.worst_argument[k]);
  out << "\n  result " << number(*s.format, m.worst_result)
      << (s.outputs > 1 ? (m.worst_output == 0 ? " (first)" : " (second)") : "") << "\n  exact  "
      << m.worst_exact << "\n";
  write_histogram(out, m);
}

void write_markdown_row(std::ostream& out, const subject& s, const std::string& arguments,
                        const measurement& m) {
  out << "| " << s.name << " | " << arguments << " | " << m.count << " | "
      << print("%.4g", m.largest) << " | ";
  for (std::size_t k = 0; k < s.inputs; ++k)
    out << (k == 0 ? "" : ", ") << pattern(*s.format, m.worst_argument[k]);
  out << " | " << print("%.3g", m.mean()) << " |\n";
}

}  // namespace arbor::lumen::accuracy
