// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <cstdio>
#include <string>

#include "choice.hpp"
#include "commands.hpp"
#include "dispatch/family.hpp"

namespace arbor::lumen::vm::tool {
namespace {

/// The letters of a family's element types; "c>s" where the output has another type than the input.
std::string types_of(const detail::family& family) {
  std::string text;
  for (const char* in = family.types; *in != '\0'; ++in) {
    if (!text.empty()) text += ' ';
    text += *in;
    const char out = output_letter(family, *in);
    if (out != *in) {
      text += '>';
      text += out;
    }
  }
  return text;
}

}  // namespace

int functions() {
  std::size_t functions = 0;
  std::size_t present_rows = 0;
  int catalogued_rows = 0;
  std::printf("%-10s  %-5s  %-13s  %-7s  %8s\n", "name", "shape", "types", "handler", "rows");
  for (const detail::family& family : detail::families()) {
    const std::size_t present = family.table().size();
    const std::string rows =
        std::to_string(present) + " of " + std::to_string(family.catalogued_rows);
    std::printf("%-10s  %-5s  %-13s  %-7s  %8s\n", family.name, family.shape,
                types_of(family).c_str(), family.handler ? "yes" : "no", rows.c_str());
    ++functions;
    present_rows += present;
    catalogued_rows += family.catalogued_rows;
  }
  std::printf("total: %zu functions, %zu of %d rows\n", functions, present_rows, catalogued_rows);
  return 0;
}

}  // namespace arbor::lumen::vm::tool
