// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "native_objects.hpp"

#include <mutex>
#include <unordered_map>

#include "context_impl.hpp"
#include "device_impl.hpp"
#include "queue_impl.hpp"

namespace sycl::detail::native_objects {

namespace {

struct registry {
  std::mutex mutex;
  std::unordered_map<const void*, std::weak_ptr<context_impl>> contexts;
  std::unordered_map<const void*, std::weak_ptr<queue_impl>> queues;
};

/// Never destroyed: queues may be static objects.
registry& objects() {
  static registry& instance = *new registry;
  return instance;
}

}  // namespace

void remember(const std::shared_ptr<context_impl>& object) {
  const std::lock_guard lock(objects().mutex);
  objects().contexts[object.get()] = object;
}

void remember(const std::shared_ptr<queue_impl>& object) {
  const std::lock_guard lock(objects().mutex);
  objects().queues[object.get()] = object;
}

void forget(const void* object) noexcept {
  const std::lock_guard lock(objects().mutex);
  if (objects().queues.erase(object) == 0) objects().contexts.erase(object);
}

std::shared_ptr<context_impl> find_context(const void* address) {
  for (const std::shared_ptr<platform_impl>& platform : all_platforms()) {
    const std::lock_guard lock(platform->default_context_mutex);
    if (platform->default_context.get() == address) return platform->default_context;
  }
  const std::lock_guard lock(objects().mutex);
  const auto found = objects().contexts.find(address);
  return found == objects().contexts.end() ? nullptr : found->second.lock();
}

std::shared_ptr<queue_impl> find_queue(const void* address) {
  const std::lock_guard lock(objects().mutex);
  const auto found = objects().queues.find(address);
  return found == objects().queues.end() ? nullptr : found->second.lock();
}

}  // namespace sycl::detail::native_objects
