// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <fstream>
#include <istream>
#include <string>
#include <vector>

namespace arbor::lumen::vm::tool {

/// The rows of a list of files, one after the other. A row is a line of columns with blanks
/// between them. A `#` and what follows it on its line is a comment; lines without a column are no
/// rows.
class row_reader {
 public:
  /// @param files names; "-" is standard input, which is also read if the list is empty
  explicit row_reader(std::vector<std::string> files);

  /// Goes to the next row. A file that cannot be read is named on standard error, and reading goes
  /// on with the next.
  /// @returns whether there is one
  bool next();

  const std::vector<std::string>& columns() const { return columns_; }

  /// Names the row on standard error, by file and line, and says what is wrong with it.
  void complain(const std::string& what);

  /// Whether a file could not be read, or a row was complained about.
  bool failed() const { return failed_; }

 private:
  bool open_next();
  void fail(const std::string& text);
  void split(const std::string& line);

  std::vector<std::string> files_;
  std::size_t opened_ = 0;  ///< files that were opened so far
  std::ifstream file_;
  std::istream* stream_ = nullptr;
  std::string name_;
  std::size_t line_number_ = 0;
  std::string line_;
  std::vector<std::string> columns_;
  bool failed_ = false;
};

}  // namespace arbor::lumen::vm::tool
