// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "host/error_handler.hpp"

#include "call/queue_store.hpp"
#include "host/kernel_binding.hpp"

namespace arbor::lumen::vm::detail::classic {
namespace {

int trampoline(lumen_arr_error_record* record) {
  error_handler* const handler = queue_store::instance().active_handler();
  return handler != nullptr ? handler->handle(*record) : 0;
}

}  // namespace

error_handler::~error_handler() = default;

bool error_handler::note(const lumen_arr_error_record& record) {
  const std::uint32_t status = ((1u << record.code) >> 1) & 255;
  if (queue_status != nullptr) queue_status->fetch_or(status);
  if (status_array != nullptr && status_length >= 2) {
    status_array[record.index] = static_cast<enums::status>(status);
  } else if (status_array != nullptr && status_length == 1) {
    local_status |= status;
    *status_array = static_cast<enums::status>(local_status);
  }
  return (status & status_to_fix) != 0;
}

installed_handler::installed_handler(error_handler& handler) {
  queue_store& store = queue_store::instance();
  store.set_active_handler(&handler);
  store.set_saved_callback(cpu::binding::arr_state().set_callback(&trampoline));
}

installed_handler::~installed_handler() {
  queue_store& store = queue_store::instance();
  cpu::binding::arr_state().set_callback(store.saved_callback());
  store.set_active_handler(nullptr);
}

}  // namespace arbor::lumen::vm::detail::classic
