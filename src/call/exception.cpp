// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "arbor/lumen/exception.hpp"

namespace arbor::lumen {
namespace {

std::string compose(std::string_view domain, std::string_view method, std::string_view message) {
  std::string text = "arbor::lumen";
  if (!domain.empty()) text.append("::").append(domain);
  if (!method.empty()) text.append("::").append(method);
  text.append(": ").append(message);
  return text;
}

std::string with_info(std::string_view message, std::string_view info) {
  std::string text(message);
  if (!info.empty()) text.append(": ").append(info);
  return text;
}

}  // namespace

exception::exception(std::string_view domain, std::string_view method, std::string_view message)
    : text_(compose(domain, method, message)) {}
exception::exception(const exception&) noexcept = default;
exception& exception::operator=(const exception&) noexcept = default;
exception::~exception() = default;
const char* exception::what() const noexcept { return text_.c_str(); }

invalid_argument::invalid_argument(std::string_view domain, std::string_view method,
                                   std::string_view info)
    : exception(domain, method, with_info("invalid argument", info)) {}
invalid_argument::~invalid_argument() = default;

unimplemented::unimplemented(std::string_view domain, std::string_view method,
                             std::string_view info)
    : exception(domain, method, with_info("unimplemented functionality", info)) {}
unimplemented::~unimplemented() = default;

}  // namespace arbor::lumen
