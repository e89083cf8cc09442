// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// `make_tables NAME FILE` writes the header NAME of tables to FILE, and leaves FILE alone if it
/// holds that text, so that nothing is rebuilt for it.

#include <filesystem>
#include <fstream>
#include <iostream>
#include <sstream>

#include "table.hpp"

namespace {

bool holds(const std::filesystem::path& path, const std::string& text) {
  std::ifstream in(path, std::ios::binary);
  std::ostringstream old;
  old << in.rdbuf();
  return in && old.str() == text;
}

}  // namespace

int main(int argc, char** argv) {
  using namespace arbor::lumen::tables;
  if (argc != 3) {
    std::cerr << "usage: make_tables NAME FILE\n";
    return 2;
  }
  const header* h = find_header(argv[1]);
  if (h == nullptr) {
    std::cerr << "make_tables: there is no header of tables " << argv[1] << "\n";
    return 2;
  }
  const std::filesystem::path path = argv[2];
  const std::string text = text_of(*h);
  if (holds(path, text)) return 0;
  if (path.has_parent_path()) std::filesystem::create_directories(path.parent_path());
  std::ofstream out(path, std::ios::binary);
  out << text << std::flush;
  if (!out) {
    std::cerr << "make_tables: cannot write " << path << "\n";
    return 1;
  }
  return 0;
}
