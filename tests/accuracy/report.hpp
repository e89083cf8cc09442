// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <ostream>
#include <string>

#include "measurement.hpp"

namespace arbor::lumen::accuracy {

/// A measurement in words, with a histogram of its errors.
void write_report(std::ostream& out, const subject& s, const sampling& samples,
                  const measurement& m);

/// The intervals of the operands.
std::string interval_text(const sampling& samples);
/// A row of a table: name, arguments, their number, largest error and where, mean error.
void write_markdown_row(std::ostream& out, const subject& s, const std::string& arguments,
                        const measurement& m);

}  // namespace arbor::lumen::accuracy
