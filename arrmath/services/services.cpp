// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <dlfcn.h>
#include <sched.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

#include "lumen_serv.h"
#include "processor_class.hpp"

namespace {

constexpr const char* module_name = "liblumen_arr.so";

/// The folder of this library, with a slash behind; empty if the loader does not tell.
std::string own_folder() {
  Dl_info info;
  if (dladdr(reinterpret_cast<const void*>(&lumen_serv_load_arr), &info) == 0) return {};
  const std::string path = info.dli_fname;
  return path.substr(0, path.rfind('/') + 1);
}

void* load_module() {
  void* const beside = dlopen((own_folder() + module_name).c_str(), RTLD_NOW | RTLD_LOCAL);
  return beside != nullptr ? beside : dlopen(module_name, RTLD_NOW | RTLD_LOCAL);
}

/// How many bytes the position of a bad argument has.
std::atomic<std::int32_t> bytes_of_position{4};
std::atomic<lumen_serv_reporter> current_reporter{&lumen_serv_default_xerbla};
std::atomic<lumen_serv_exit_hook> exit_hook{nullptr};

}  // namespace

void* lumen_serv_load_arr() {
  static std::int32_t lock = 0;
  static void* module = nullptr;
  lumen_serv_lock(&lock);
  if (module == nullptr) module = load_module();
  void* const loaded = module;
  lumen_serv_unlock(&lock);
  return loaded;
}

void* lumen_serv_find_symbol(void* module, const char* name) { return dlsym(module, name); }

std::int32_t lumen_serv_arr_cpu_detect() {
  switch (arbor::lumen::arr::own_processor_class()) {
    case arbor::lumen::arr::processor_class::avx512: return 9;
    case arbor::lumen::arr::processor_class::avx2: return 7;
    default: return 0;
  }
}

std::int32_t lumen_serv_getenv(const char* name, char* buffer, std::int32_t size) {
  if (size <= 0) return 0;
  const char* const value = std::getenv(name);
  const std::size_t length =
      value == nullptr ? 0 : std::min(std::strlen(value), static_cast<std::size_t>(size - 1));
  if (value != nullptr) std::memcpy(buffer, value, length);
  buffer[length] = '\0';
  return static_cast<std::int32_t>(length);
}

void lumen_serv_set_xerbla_interface(std::int32_t bytes) { bytes_of_position = bytes; }

lumen_serv_reporter lumen_serv_set_xerbla(lumen_serv_reporter reporter) {
  return current_reporter.exchange(reporter != nullptr ? reporter : &lumen_serv_default_xerbla);
}

void lumen_serv_xerbla(const char* routine, const void* position, std::int32_t length) {
  current_reporter.load()(routine, position, length);
}

void lumen_serv_default_xerbla(const char* routine, const void* position, std::int32_t length) {
  std::int64_t which = 0;
  if (bytes_of_position == 8) {
    which = *static_cast<const std::int64_t*>(position);
  } else {
    which = *static_cast<const std::int32_t*>(position);
  }
  std::fprintf(stderr, "arbor lumen: argument %lld of %.*s is wrong\n",
               static_cast<long long>(which), static_cast<int>(length), routine);
}

void lumen_serv_print(std::int32_t, std::int32_t number, std::int32_t count, ...) {
  std::va_list texts;
  va_start(texts, count);
  const char* const first = count > 0 ? va_arg(texts, const char*) : "";
  va_end(texts);
  switch (number) {
    case 771: {
      const char* const reason = dlerror();
      std::fprintf(stderr, "arbor lumen: cannot load %s: %s\n", module_name,
                   reason != nullptr ? reason : "unknown reason");
      break;
    }
    case 772:
      std::fprintf(stderr, "arbor lumen: %s has no symbol %s\n", module_name, first);
      break;
    default: std::fprintf(stderr, "arbor lumen: message %d %s\n", static_cast<int>(number), first);
  }
}

void lumen_serv_lock(std::int32_t* word) {
  while (std::atomic_ref(*word).exchange(1, std::memory_order_acquire) != 0) sched_yield();
}

void lumen_serv_unlock(std::int32_t* word) {
  std::atomic_ref(*word).store(0, std::memory_order_release);
}

lumen_serv_exit_hook lumen_serv_set_exit_hook(lumen_serv_exit_hook hook) {
  return exit_hook.exchange(hook);
}

void lumen_serv_exit(std::int32_t code) {
  if (const lumen_serv_exit_hook hook = exit_hook.load(); hook != nullptr)
    hook(code);
  else
    _exit(code);
}
