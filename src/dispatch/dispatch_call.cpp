// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "dispatch/dispatch_call.hpp"

#include "arbor/lumen/exception.hpp"
#include "call/queue_store.hpp"
#include "dispatch/device_word.hpp"
#include "dispatch/key.hpp"
#include "dispatch/select_key.hpp"
#include "dispatch/texts.hpp"

namespace arbor::lumen::vm::detail {
namespace {

constexpr const char* domain = "vector_math";

/// Marks the queue's status and returns the event of a call that did nothing.
sycl::event decline(const input::vxx& record) {
  queue_store& store = queue_store::instance();
  store.status_word(record.queue.key()).fetch_or(enums::bad_argument);
  return store.default_event();
}

}  // namespace

std::uint32_t tuning_factor(std::uint64_t device_word, std::string_view, std::uint64_t precision,
                            std::uint64_t key) {
  if ((key & key::gpu) == 0) return 1;
  const std::uint64_t vendor = device_word & (device_word::norvane | device_word::integrated);
  if (vendor != device_word::norvane) return 1;
  if ((device_word & device_word::jasper) != 0) return precision == precision_of<float> ? 2 : 1;
  if ((device_word & device_word::beryl) != 0) {
    if (precision == precision_of<double>) return 2;
    if (precision == precision_of<float> || precision == precision_of<sycl::half>) return 4;
  }
  return 1;
}

std::string unserved_text(std::uint32_t mode, std::uint64_t precision, std::uint64_t device_word) {
  return "mode: " + mode_to_text(mode) + "; precision: " + key_to_text(precision, false) +
         "; architecture: " + device_to_text(device_word);
}

sycl::event dispatch_call(const input::vxx& record, const implementation_table& table) {
  const std::uint64_t precision = record.precision();
  // A record without a queue has no device; its check says so.
  const std::uint64_t word = record.queue == nullptr ? 0 : device_word::of_queue(record.queue);
  const auto [key, entry] = select_row(precision, word, record.mode, table);

  const bool throws = (record.mode & enums::badarg_exception) != 0;
  if (!record.check(throws)) {
    if (throws)
      throw invalid_argument(
          domain, record.name,
          key_to_text(key, true) + "; " + (record.has_slices() ? "api: strided" : "api: linear"));
    return decline(record);
  }
  if (entry == nullptr) {
    if ((record.mode & enums::mode_missing_throws) != 0)
      throw unimplemented(domain, record.name, unserved_text(record.mode, precision, word));
    return decline(record);
  }
  return entry->run(record, TuningInfo{tuning_factor(word, record.name, precision, key)});
}

}  // namespace arbor::lumen::vm::detail
