// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <exception>
#include <string>
#include <string_view>

#include "arbor/lumen/export.hpp"

namespace arbor::lumen {

/// Root of the library's own exceptions. `what()` reads "arbor::lumen", "::" and the domain, "::"
/// and the method, ": " and the message; an empty domain or method leaves out its "::" too.
///
/// Exceptions of the SYCL runtime pass through the library unchanged and are not of this type.
class ARBORLUMEN_EXPORT exception : public std::exception {
 public:
  exception(std::string_view domain, std::string_view method, std::string_view message);
  exception(const exception&) noexcept;
  exception& operator=(const exception&) noexcept;
  ~exception() override;

  /// The full text, valid as long as the exception lives.
  const char* what() const noexcept override;

 private:
  std::string text_;
};

/// An argument that a function cannot accept. The message is "invalid argument", followed by ": "
/// and the info if there is one.
class ARBORLUMEN_EXPORT invalid_argument : public exception {
 public:
  invalid_argument(std::string_view domain, std::string_view method, std::string_view info = {});
  ~invalid_argument() override;
};

/// A call that no implementation in the library serves on this device and in this mode. The message
/// is "unimplemented functionality", followed by ": " and the info if there is one.
class ARBORLUMEN_EXPORT unimplemented : public exception {
 public:
  unimplemented(std::string_view domain, std::string_view method, std::string_view info = {});
  ~unimplemented() override;
};

}  // namespace arbor::lumen
