// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "scheduler.hpp"

#include <pthread.h>

#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <mutex>
#include <string>
#include <utility>

#include "environment.hpp"

namespace sycl::detail {

namespace {

/// How long a thread without work polls before it sleeps, and a waiting thread before it does.
constexpr std::uint64_t polling_time = 20'000;
/// Work for one more thread, from which waking it pays.
constexpr std::uint64_t worthwhile_time = 15'000;
/// Bounds of the time of one piece of a shared kernel.
constexpr std::uint64_t short_piece = 10'000;
constexpr std::uint64_t long_piece = 50'000;
/// Pieces of this many work-items and more are multiples of it, so that they start on the same
/// alignment as the whole.
constexpr std::size_t alignment_items = 16;

std::atomic<scheduler*> current{nullptr};
spin_mutex creation;
thread_local bool on_worker = false;
thread_local bool running_inline = false;

unsigned thread_count() {
  const std::optional<std::string> text = environment("LUMEN_SYCL_THREADS");
  if (!text) return std::max(1U, std::thread::hardware_concurrency());
  const std::optional<std::uint64_t> number = parse_number(*text, 10);
  if (!number || *number == 0 || *number > 4096) {
    throw exception(errc::runtime,
                    "LUMEN_SYCL_THREADS: '" + *text + "' is no number from 1 to 4096");
  }
  return static_cast<unsigned>(*number);
}

std::size_t aligned_grain(std::size_t grain) noexcept {
  return grain < alignment_items ? grain : grain / alignment_items * alignment_items;
}

}  // namespace

scheduler& scheduler::instance() {
  scheduler* existing = current.load(std::memory_order_acquire);
  if (existing != nullptr) return *existing;
  const std::lock_guard lock(creation);
  existing = current.load(std::memory_order_acquire);
  if (existing == nullptr) {
    existing = new scheduler(thread_count());
    current.store(existing, std::memory_order_release);
    // A child process has none of the threads; it gets a scheduler of its own if it needs one.
    [[maybe_unused]] static const int registered =
        pthread_atfork(nullptr, nullptr, [] { current.store(nullptr, std::memory_order_release); });
    [[maybe_unused]] static const int at_end = std::atexit(&scheduler::at_exit);
  }
  return *existing;
}

scheduler::scheduler(unsigned threads)
    : threads_(threads),
      polls_(std::thread::hardware_concurrency() > 1),
      host_threads_(
          [](std::shared_ptr<command> task) { instance().run_host_task(std::move(task)); }) {
  workers_.reserve(threads);
  for (unsigned i = 0; i < threads; ++i) workers_.emplace_back([this] { work(); });
}

void scheduler::at_exit() {
  scheduler* existing = current.load(std::memory_order_acquire);
  // A command that ends the process cannot be waited for.
  if (existing == nullptr || on_worker || host_threads::is_current()) return;
  existing->drain_and_stop();
}

void scheduler::drain_and_stop() {
  while (in_flight_.load(std::memory_order_acquire) != 0) {
    std::this_thread::sleep_for(std::chrono::microseconds(50));
  }
  unsigned woken = 0;
  {
    const std::lock_guard lock(mutex_);
    stopped_ = true;
    woken = claim_sleepers(threads_);
  }
  post(woken);
  for (std::thread& worker : workers_) worker.join();
  workers_.clear();
  host_threads_.stop();
}

void scheduler::push_back(command& ready) noexcept {
  ready.next_ready = nullptr;
  ready.previous_ready = last_;
  (last_ == nullptr ? first_ : last_->next_ready) = &ready;
  last_ = &ready;
  ready.queued.store(true, std::memory_order_relaxed);
  available_.store(true, std::memory_order_relaxed);
}

void scheduler::unlink(command& listed) noexcept {
  (listed.previous_ready == nullptr ? first_ : listed.previous_ready->next_ready) =
      listed.next_ready;
  (listed.next_ready == nullptr ? last_ : listed.next_ready->previous_ready) =
      listed.previous_ready;
  listed.queued.store(false, std::memory_order_relaxed);
  if (first_ == nullptr) available_.store(false, std::memory_order_relaxed);
}

unsigned scheduler::claim_sleepers(unsigned count) noexcept {
  const unsigned woken = std::min(count, sleepers_);
  sleepers_ -= woken;
  return woken;
}

void scheduler::post(unsigned permits) noexcept {
  if (permits == 0) return;
  permits_.fetch_add(permits, std::memory_order_release);
  if (permits > 4) {
    permits_.notify_all();
    return;
  }
  for (; permits != 0; --permits) permits_.notify_one();
}

void scheduler::start(command& ready) {
  if (ready.what == action::host_access) {
    ready.set_state(command_state::running);
    return;
  }
  in_flight_.fetch_add(1, std::memory_order_relaxed);
  unsigned woken = 0;
  bool stopped = false;
  {
    const std::lock_guard lock(mutex_);
    stopped = stopped_;
    if (stopped || ready.what != action::host_task) {
      push_back(ready);
      if (!polling_) woken = claim_sleepers(1);
    }
  }
  if (stopped) {
    run_inline();
  } else if (ready.what == action::host_task) {
    host_threads_.start(std::move(ready.self));
  } else {
    post(woken);
  }
}

/// After the end of main the threads are gone; what is submitted then, by the destructors of
/// static objects, runs in place.
void scheduler::run_inline() {
  if (std::exchange(running_inline, true)) return;
  for (;;) {
    std::shared_ptr<command> next;
    {
      const std::lock_guard lock(mutex_);
      if (first_ == nullptr) break;
      next = std::move(first_->self);
      unlink(*next);
    }
    if (next->what == action::host_task) {
      run_host_task(std::move(next));
    } else {
      run(std::move(next), false);
    }
  }
  running_inline = false;
}

void scheduler::run_host_task(std::shared_ptr<command> task) {
  if (task->profiled) task->start_time = now();
  task->set_state(command_state::running);
  try {
    task->host_function(task->closure, handle_access::make<interop_handle>(task->queue));
  } catch (...) {
    task->error = std::current_exception();
  }
  finish(std::move(task));
}

void scheduler::work() {
  on_worker = true;
  while (std::shared_ptr<command> taken = take()) run(std::move(taken), true);
}

bool scheduler::poll() const noexcept {
  const std::uint64_t limit = now() + polling_time;
  do {
    for (int i = 0; i < 32; ++i) {
      if (available_.load(std::memory_order_relaxed)) return true;
      pause();
    }
  } while (now() < limit);
  return false;
}

std::shared_ptr<command> scheduler::take() {
  bool polled = !polls_;
  std::unique_lock lock(mutex_);
  for (;;) {
    while (first_ != nullptr) {
      command& head = *first_;
      std::shared_ptr<command> taken;
      if (!head.shared) {
        taken = std::move(head.self);
        unlink(head);
      } else if (head.cursor.load(std::memory_order_relaxed) < head.total) {
        taken = head.self;
        ++head.participants;
      } else {
        unlink(head);
        continue;
      }
      // A shared command has called for as many threads as it can use.
      unsigned woken = 0;
      if (first_ != nullptr && !first_->shared && !polling_) woken = claim_sleepers(1);
      lock.unlock();
      post(woken);
      return taken;
    }
    if (stopped_) return nullptr;
    if (!polled && !polling_) {
      polling_ = true;
      lock.unlock();
      poll();
      lock.lock();
      polling_ = false;
      polled = true;
      continue;
    }
    ++sleepers_;
    lock.unlock();
    for (std::uint32_t permits = permits_.load(std::memory_order_relaxed);;) {
      if (permits == 0) {
        permits_.wait(0, std::memory_order_relaxed);
        permits = permits_.load(std::memory_order_relaxed);
      } else if (permits_.compare_exchange_weak(permits, permits - 1, std::memory_order_acquire)) {
        break;
      }
    }
    polled = !polls_;
    lock.lock();
  }
}

void scheduler::run(std::shared_ptr<command> taken, bool go_on) {
  while (taken != nullptr) {
    const bool done = taken->shared ? run_pieces(*taken) : run_alone(*taken);
    if (!done) return;
    taken = finish(std::move(taken), go_on);
  }
}

void scheduler::run_items(command& taken, std::size_t begin, std::size_t end) noexcept {
  try {
    taken.function(taken.closure, taken.extents, begin, end);
  } catch (...) {
    if (!taken.failed.exchange(true, std::memory_order_acq_rel)) {
      taken.error = std::current_exception();
    }
  }
}

/// Runs the kernel, or its beginning and then its share of the rest. True if the kernel is done
/// and this thread has to complete it.
bool scheduler::run_alone(command& taken) {
  if (taken.profiled) taken.start_time = now();
  taken.set_state(command_state::running);
  if (taken.function == nullptr || taken.total == 0) return true;

  std::size_t end = threads_ == 1 ? taken.total : std::min(taken.grain, taken.total);
  std::uint64_t before = end < taken.total ? now() : 0;
  for (std::size_t begin = 0;;) {
    run_items(taken, begin, end);
    if (end == taken.total || taken.failed.load(std::memory_order_relaxed)) return true;

    const std::uint64_t after = now();
    const std::uint64_t elapsed = after - before;
    before = after;
    const bool measurable = elapsed >= 1'000;
    if (measurable) {
      const double rest = static_cast<double>(elapsed) * static_cast<double>(taken.total - end) /
                          static_cast<double>(end - begin);
      if (rest >= 2.0 * static_cast<double>(worthwhile_time)) {
        taken.grain = end - begin;
        share(taken, end, rest < 1e12 ? static_cast<std::uint64_t>(rest) : 1'000'000'000'000U);
        return run_pieces(taken);
      }
    }
    begin = end;
    // Geometric growth keeps the beginnings of pieces aligned.
    const std::size_t more = measurable ? begin : 3 * begin;
    end = taken.total - begin <= more ? taken.total : begin + more;
  }
}

/// Puts a kernel whose first `done` work-items have run at the head of the list, and wakes threads
/// for the `estimate` nanoseconds of work that remain.
void scheduler::share(command& taken, std::size_t done, std::uint64_t estimate) {
  taken.cursor.store(done, std::memory_order_relaxed);
  taken.finished.store(done, std::memory_order_relaxed);
  const auto useful =
      static_cast<unsigned>(std::min<std::uint64_t>(estimate / worthwhile_time, threads_ - 1));
  unsigned woken = 0;
  {
    const std::lock_guard lock(mutex_);
    taken.self = taken.shared_from_this();
    taken.shared = true;
    taken.participants = 1;
    taken.previous_ready = nullptr;
    taken.next_ready = first_;
    (first_ == nullptr ? last_ : first_->previous_ready) = &taken;
    first_ = &taken;
    taken.queued.store(true, std::memory_order_relaxed);
    available_.store(true, std::memory_order_relaxed);
    woken = claim_sleepers(polling_ && useful > 0 ? useful - 1 : useful);
  }
  post(woken);
}

/// Runs pieces of a shared kernel until none is left. True if this thread has to complete it.
bool scheduler::run_pieces(command& taken) {
  const auto drop_from_list = [&] {
    const std::lock_guard lock(mutex_);
    if (taken.queued.load(std::memory_order_relaxed)) unlink(taken);
  };
  std::size_t grain = taken.grain;
  std::uint64_t before = now();
  for (;;) {
    const std::size_t handed_out = taken.cursor.load(std::memory_order_relaxed);
    if (handed_out >= taken.total) return false;
    // Towards the end the threads get smaller pieces, so that they end together.
    const std::size_t fair = std::max((taken.total - handed_out) / (2 * threads_), taken.grain);
    const std::size_t size = aligned_grain(std::min(grain, fair));
    const std::size_t begin = taken.cursor.fetch_add(size, std::memory_order_relaxed);
    if (begin >= taken.total) return false;
    const std::size_t count = std::min(size, taken.total - begin);
    if (begin + count == taken.total) drop_from_list();

    run_items(taken, begin, begin + count);
    std::size_t settled = count;
    if (taken.failed.load(std::memory_order_relaxed)) {
      const std::size_t rest = taken.cursor.exchange(taken.total, std::memory_order_relaxed);
      if (rest < taken.total) {
        settled += taken.total - rest;
        drop_from_list();
      }
    }
    if (taken.finished.fetch_add(settled, std::memory_order_acq_rel) + settled == taken.total) {
      return true;
    }
    const std::uint64_t after = now();
    const std::uint64_t elapsed = after - before;
    before = after;
    if (size < grain) continue;
    if (elapsed < short_piece) {
      grain *= 2;
    } else if (elapsed > long_piece) {
      grain = std::max<std::size_t>(grain / 2, 1);
    }
  }
}

void scheduler::finish(std::shared_ptr<command> done) { finish(std::move(done), false); }

/// Completes a command. If the thread is to go on, returns a command that this made ready.
std::shared_ptr<command> scheduler::finish(std::shared_ptr<command> done, bool go_on) {
  command& self = *done;
  if (self.profiled) self.end_time = now();
  self.unregister_accesses();
  self.destroy_closure();
  const std::shared_ptr<queue_impl> queue = std::move(self.queue);
  if (queue != nullptr) {
    if (self.error != nullptr) queue->add_error(std::exchange(self.error, nullptr));
    self.reporter = queue;
  }
  self.clear_dependencies();
  edge* waiting = self.close();
  self.set_state(command_state::complete);
  if (queue != nullptr) queue->stream->remove(self);

  self.self.reset();  // still there if several threads ran the command

  std::shared_ptr<command> next;
  while (waiting != nullptr) {
    command& successor = *waiting->successor;
    waiting = waiting->next;
    if (!successor.release_one()) continue;
    if (go_on && next == nullptr &&
        (successor.what == action::kernel || successor.what == action::nothing)) {
      in_flight_.fetch_add(1, std::memory_order_relaxed);
      next = std::move(successor.self);
    } else {
      start(successor);
    }
  }
  if (self.what != action::host_access) in_flight_.fetch_sub(1, std::memory_order_release);
  return next;
}

bool scheduler::help(command& awaited) {
  std::shared_ptr<command> taken;
  {
    const std::lock_guard lock(mutex_);
    if (!awaited.queued.load(std::memory_order_relaxed) || awaited.what == action::host_task) {
      return false;
    }
    if (awaited.shared) {
      if (awaited.participants >= threads_) return false;
      taken = awaited.self;
      ++awaited.participants;
    } else {
      taken = std::move(awaited.self);
      unlink(awaited);
    }
  }
  run(std::move(taken), false);
  return true;
}

void scheduler::wait(command& awaited) {
  if (awaited.complete()) return;
  const std::uint64_t limit = now() + polling_time;
  do {
    for (int i = 0; i < 32; ++i) {
      if (awaited.complete()) return;
      if (awaited.queued.load(std::memory_order_relaxed) && help(awaited)) break;
      pause();
    }
  } while (now() < limit);
  awaited.await(command_state::complete);
}

}  // namespace sycl::detail
