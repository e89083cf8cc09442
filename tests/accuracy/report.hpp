// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <ostream>

#include "measurement.hpp"

namespace arbor::lumen::accuracy {

/// A measurement in words, with a histogram of its errors.
void write_report(std::ostream& out, const subject& s, const sampling& samples,
                  const measurement& m);

/// A row of the accuracy tables: name, arguments, largest and mean error, argument of the largest.
void write_markdown_row(std::ostream& out, const subject& s, const sampling& samples,
                        const measurement& m);

}  // namespace arbor::lumen::accuracy
