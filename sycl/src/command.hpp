// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <exception>
#include <memory>
#include <vector>

#include "queue_impl.hpp"
#include "spin_mutex.hpp"
#include "sycl/backend.hpp"
#include "sycl/detail/kernel.hpp"
#include "sycl/event.hpp"
#include "sycl/interop_handle.hpp"

namespace sycl::detail {

class buffer_storage;

/// "The successor waits for the predecessor." The successor owns its edges; until it is complete
/// the predecessor reaches them through an intrusive list.
struct edge {
  edge* next = nullptr;
  command* successor = nullptr;
  std::shared_ptr<command> predecessor;
};

/// "The command uses these bytes." A member of the list of the storage while the command is not
/// complete.
struct access_record {
  std::shared_ptr<buffer_storage> storage;
  std::size_t begin = 0;
  std::size_t end = 0;
  bool write = false;
  command* owner = nullptr;
  access_record* previous = nullptr;
  access_record* next = nullptr;
};

enum class command_state : std::uint32_t { submitted, running, complete };

enum class action : std::uint8_t {
  /// Only its dependencies matter.
  nothing,
  /// A function over a range of work-items.
  kernel,
  /// A function of the host, which may block.
  host_task,
  /// The time in which the host accesses a buffer.
  host_access,
};

/// A node of the graph of commands, and what an event refers to.
///
/// From its submission to its completion a command owns itself. What it captured, the commands
/// before it and its queue are released when it completes; only its times and state remain.
class command : public std::enable_shared_from_this<command> {
 public:
  command() = default;
  command(const command&) = delete;
  command& operator=(const command&) = delete;
  ~command();

  bool complete() const noexcept {
    return state.load(std::memory_order_acquire) == command_state::complete;
  }
  void set_state(command_state next) noexcept;
  /// Sleeps until the state is at least `least`.
  void await(command_state least) const noexcept;

  // Construction.
  void* reserve_closure(std::size_t size, std::size_t alignment);
  void add_dependency(std::shared_ptr<command> predecessor);
  void add_access(std::shared_ptr<buffer_storage> storage, std::size_t begin, std::size_t end,
                  bool write);

  /// Adds the edges to the commands that use the same bytes, one of them writing, and enters the
  /// command in the lists of its storages.
  void register_accesses();
  /// Enters the edges in the lists of the predecessors. No edge may be added any more.
  void link() noexcept;
  /// One thing less to wait for; true if it was the last.
  bool release_one() noexcept { return pending.fetch_sub(1, std::memory_order_acq_rel) == 1; }

  // Completion.
  void unregister_accesses() noexcept;
  void destroy_closure() noexcept;
  void clear_dependencies() noexcept;
  /// Ends the list of successors and returns it.
  edge* close() noexcept;

  std::vector<event> wait_list();

  std::atomic<command_state> state{command_state::submitted};
  /// Unfinished predecessors, and the submission itself.
  std::atomic<std::uint32_t> pending{1};
  action what = action::nothing;
  backend from = backend::host;
  bool profiled = false;
  /// In the scheduler's list.
  std::atomic<bool> queued{false};
  /// Several threads may run parts of it.
  bool shared = false;
  unsigned participants = 0;

  kernel_function function = nullptr;
  void (*host_function)(void* closure, const interop_handle& ih) = nullptr;
  std::size_t extents[3] = {1, 1, 1};
  /// Work-items, and how many of them to try first.
  std::size_t total = 1;
  std::size_t grain = 1;
  /// Work-items handed out and finished, of a shared command.
  std::atomic<std::size_t> cursor{0};
  std::atomic<std::size_t> finished{0};

  command* previous_ready = nullptr;
  command* next_ready = nullptr;

  std::shared_ptr<command> self;
  /// The queue, until completion; afterwards who hears of errors, if still there.
  std::shared_ptr<queue_impl> queue;
  std::weak_ptr<queue_impl> reporter;
  command* previous_in_stream = nullptr;
  command* next_in_stream = nullptr;
  std::uint64_t number = 0;

  std::exception_ptr error;
  std::atomic<bool> failed{false};
  std::uint64_t submit_time = 0;
  std::uint64_t start_time = 0;
  std::uint64_t end_time = 0;

 private:
  static constexpr std::size_t inline_edges = 2;
  static constexpr std::size_t inline_bytes = 192;

  edge& edge_at(std::size_t index) noexcept {
    return index < inline_edges ? edges_[index] : more_edges_[index - inline_edges];
  }

  spin_mutex edges_mutex_;
  std::uint32_t edge_count_ = 0;
  std::atomic<edge*> successors_{nullptr};
  edge edges_[inline_edges];
  std::vector<edge> more_edges_;
  std::vector<access_record> accesses_;

 public:
  /// Destroys the closure; null if there is nothing to do.
  void (*destroy)(void*) noexcept = nullptr;
  void* closure = nullptr;

 private:
  std::size_t closure_alignment_ = 0;
  alignas(16) unsigned char closure_bytes_[inline_bytes];
};

/// Nanoseconds of a clock that never goes back.
std::uint64_t now() noexcept;

}  // namespace sycl::detail
