// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <omp.h>

#include <algorithm>
#include <atomic>
#include <cstdint>

#include "lumen_serv.h"

namespace {

/// Work that is worth a thread, in nanoseconds. In calls that follow one another OpenMP's threads
/// still spin, and two of them pay from about 5 microseconds of work in all; after a pause they have
/// to be woken, which takes some 60 microseconds, and pay from about 200. In between, what a call
/// gains in the one case is about what it loses in the other. arrmath/README.md has the figures.
constexpr float work_per_thread = 20e3f;

/// Threads begin at multiples of this many elements: whole blocks of the kernels, whole pages.
constexpr std::int64_t grain = 4096;

/// What the threads of a call need of the module.
struct module_state {
  decltype(&lumen_arr_kernel_GetMode) get_mode;
  decltype(&lumen_arr_kernel_SetMode) set_mode;
  decltype(&lumen_arr_kernel_GetErrStatus) get_status;
  decltype(&lumen_arr_kernel_SetErrStatus) set_status;

  explicit module_state(void* module)
      : get_mode(find<decltype(get_mode)>(module, "lumen_arr_kernel_GetMode")),
        set_mode(find<decltype(set_mode)>(module, "lumen_arr_kernel_SetMode")),
        get_status(find<decltype(get_status)>(module, "lumen_arr_kernel_GetErrStatus")),
        set_status(find<decltype(set_status)>(module, "lumen_arr_kernel_SetErrStatus")) {}

  bool is_complete() const { return get_mode && set_mode && get_status && set_status; }

 private:
  template <typename F>
  static F find(void* module, const char* name) {
    return reinterpret_cast<F>(lumen_serv_find_symbol(module, name));
  }
};

/// There is one module in a process.
const module_state& state_of(void* module) {
  static const module_state state(module);
  return state;
}

std::int64_t threads_for(std::int32_t n, float cost) {
  const float worth = static_cast<float>(n) * cost / work_per_thread;
  if (worth < 2 || n < 2 * grain || omp_in_parallel()) return 1;
  const std::int64_t available = omp_get_max_threads();
  const std::int64_t grains = (n + grain - 1) / grain;
  return std::min({static_cast<std::int64_t>(std::min(worth, 1e6f)), available, grains});
}

/// Calls `chunk(first, count)` for parts that cover n elements.
template <typename Chunk>
void over_threads(std::int32_t n, float cost, void* module, const Chunk& chunk) {
  const std::int64_t threads = threads_for(n, cost);
  if (threads < 2) return chunk(std::int64_t{0}, n);
  const module_state& state = state_of(module);
  if (!state.is_complete()) return chunk(std::int64_t{0}, n);
  const std::int64_t mode = state.get_mode();
  if ((mode & LUMEN_ARR_CALLBACK) != 0) return chunk(std::int64_t{0}, n);

  std::atomic<std::int32_t> status{state.get_status()};
#pragma omp parallel num_threads(static_cast<int>(threads))
  {
    const std::int64_t grains = (n + grain - 1) / grain;
    const std::int64_t team = omp_get_num_threads(), member = omp_get_thread_num();
    const std::int64_t first = std::min<std::int64_t>(grains * member / team * grain, n);
    const std::int64_t last = std::min<std::int64_t>(grains * (member + 1) / team * grain, n);
    const std::int64_t mode_before = state.set_mode(mode);
    const std::int32_t status_before = state.set_status(LUMEN_ARR_STATUS_OK);
    chunk(first, static_cast<std::int32_t>(last - first));
    status |= state.set_status(status_before);
    state.set_mode(mode_before);
  }
  state.set_status(status);
}

}  // namespace

#define LUMEN_SERV_THREADER(form, CHUNK, ...)                                                     \
  void lumen_arr_serv_threader_##form(lumen_arr_kernel_##form kernel, std::int32_t n, __VA_ARGS__, \
                                      float cost, void* module) {                                 \
    over_threads(n, cost, module,                                                                 \
                 [&](std::int64_t i, std::int32_t count) { kernel(count, CHUNK); });              \
  }
#define LUMEN_ARGUMENTS(...) __VA_ARGS__

#define LUMEN_SERV_THREADERS_11(form, formI, T, U)                                 \
  LUMEN_SERV_THREADER(form, LUMEN_ARGUMENTS(a + i, y + i), const T* a, U* y)       \
  LUMEN_SERV_THREADER(formI, LUMEN_ARGUMENTS(a + i * inca, inca, y + i * incy, incy), \
                      const T* a, std::int64_t inca, U* y, std::int64_t incy)
#define LUMEN_SERV_THREADERS_12(form, formI, T)                                              \
  LUMEN_SERV_THREADER(form, LUMEN_ARGUMENTS(a + i, y + i, z + i), const T* a, T* y, T* z)    \
  LUMEN_SERV_THREADER(                                                                       \
      formI, LUMEN_ARGUMENTS(a + i * inca, inca, y + i * incy, incy, z + i * incz, incz),    \
      const T* a, std::int64_t inca, T* y, std::int64_t incy, T* z, std::int64_t incz)
#define LUMEN_SERV_THREADERS_21(form, formI, T)                                              \
  LUMEN_SERV_THREADER(form, LUMEN_ARGUMENTS(a + i, b + i, y + i), const T* a, const T* b, T* y) \
  LUMEN_SERV_THREADER(                                                                       \
      formI, LUMEN_ARGUMENTS(a + i * inca, inca, b + i * incb, incb, y + i * incy, incy),    \
      const T* a, std::int64_t inca, const T* b, std::int64_t incb, T* y, std::int64_t incy)
#define LUMEN_SERV_THREADERS_21C(form, formI, T)                                       \
  LUMEN_SERV_THREADER(form, LUMEN_ARGUMENTS(a + i, b, y + i), const T* a, T b, T* y)   \
  LUMEN_SERV_THREADER(formI, LUMEN_ARGUMENTS(a + i * inca, inca, b, y + i * incy, incy), \
                      const T* a, std::int64_t inca, T b, T* y, std::int64_t incy)
#define LUMEN_SERV_THREADERS_61(form, formI, T)                                               \
  LUMEN_SERV_THREADER(form,                                                                   \
                      LUMEN_ARGUMENTS(a + i, b + i, scalea, shifta, scaleb, shiftb, y + i),   \
                      const T* a, const T* b, T scalea, T shifta, T scaleb, T shiftb, T* y)   \
  LUMEN_SERV_THREADER(formI,                                                                  \
                      LUMEN_ARGUMENTS(a + i * inca, inca, b + i * incb, incb, scalea, shifta, \
                                      scaleb, shiftb, y + i * incy, incy),                    \
                      const T* a, std::int64_t inca, const T* b, std::int64_t incb, T scalea, \
                      T shifta, T scaleb, T shiftb, T* y, std::int64_t incy)

LUMEN_SERV_THREADERS(LUMEN_SERV_THREADERS_11, LUMEN_SERV_THREADERS_12, LUMEN_SERV_THREADERS_21,
                     LUMEN_SERV_THREADERS_21C, LUMEN_SERV_THREADERS_61)
