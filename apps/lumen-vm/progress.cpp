// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "progress.hpp"

#include <unistd.h>

#include <cstdio>

namespace arbor::lumen::vm::tool {

progress::progress()
    : terminal_(isatty(STDERR_FILENO) == 1), next_(clock::now() + std::chrono::seconds(1)) {}

void progress::look() {
  const auto now = clock::now();
  if (now < next_) return;
  next_ = now + std::chrono::milliseconds(200);
  std::fprintf(stderr, "\rlumen-vm: %lld rows read", static_cast<long long>(rows_));
  shown_ = true;
}

void progress::clear() {
  if (!shown_) return;
  std::fputs("\r\033[K", stderr);
  shown_ = false;
}

}  // namespace arbor::lumen::vm::tool
