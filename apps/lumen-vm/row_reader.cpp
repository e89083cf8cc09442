// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "row_reader.hpp"

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <iostream>
#include <utility>

namespace arbor::lumen::vm::tool {

row_reader::row_reader(std::vector<std::string> files) : files_(std::move(files)) {
  if (files_.empty()) files_.emplace_back("-");
}

bool row_reader::next() {
  while (stream_ != nullptr || open_next()) {
    errno = 0;
    while (std::getline(*stream_, line_)) {
      ++line_number_;
      split(line_);
      if (!columns_.empty()) return true;
    }
    if (stream_->bad()) fail(name_ + ": " + (errno != 0 ? std::strerror(errno) : "read error"));
    stream_ = nullptr;
  }
  return false;
}

bool row_reader::open_next() {
  while (opened_ < files_.size()) {
    const std::string& file = files_[opened_++];
    line_number_ = 0;
    if (file == "-") {
      name_ = "(standard input)";
      stream_ = &std::cin;
      return true;
    }
    name_ = file;
    file_.close();
    file_.clear();
    errno = 0;
    file_.open(file);
    if (file_.is_open()) {
      stream_ = &file_;
      return true;
    }
    fail(name_ + ": " + (errno != 0 ? std::strerror(errno) : "cannot be opened"));
  }
  return false;
}

void row_reader::split(const std::string& line) {
  constexpr const char* blanks = " \t\r\v\f";
  const std::size_t end = std::min(line.find('#'), line.size());
  std::size_t count = 0;
  std::size_t from = line.find_first_not_of(blanks);
  while (from < end) {
    const std::size_t to = std::min(line.find_first_of(blanks, from), end);
    if (count == columns_.size()) columns_.emplace_back();
    columns_[count++].assign(line, from, to - from);
    from = line.find_first_not_of(blanks, to);
  }
  columns_.resize(count);
}

void row_reader::complain(const std::string& what) {
  fail(name_ + ":" + std::to_string(line_number_) + ": " + what);
}

void row_reader::fail(const std::string& text) {
  std::fprintf(stderr, "lumen-vm: %s\n", text.c_str());
  failed_ = true;
}

}  // namespace arbor::lumen::vm::tool
