// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "command.hpp"

#include <chrono>
#include <mutex>
#include <new>
#include <utility>

#include "buffer_storage.hpp"

namespace sycl::detail {

namespace {
/// Stands for the list of successors of a complete command.
edge* const closed = reinterpret_cast<edge*>(alignof(edge));
}  // namespace

std::uint64_t now() noexcept {
  return static_cast<std::uint64_t>(std::chrono::duration_cast<std::chrono::nanoseconds>(
                                        std::chrono::steady_clock::now().time_since_epoch())
                                        .count());
}

command::~command() { destroy_closure(); }

void command::set_state(command_state next) noexcept {
  state.store(next, std::memory_order_release);
  state.notify_all();
}

void command::await(command_state least) const noexcept {
  for (;;) {
    const command_state current = state.load(std::memory_order_acquire);
    if (current >= least) return;
    state.wait(current, std::memory_order_acquire);
  }
}

void* command::reserve_closure(std::size_t size, std::size_t alignment) {
  if (size <= inline_bytes && alignment <= 16) {
    closure = closure_bytes_;
  } else {
    closure = ::operator new (size, std::align_val_t{alignment});
    closure_alignment_ = alignment;
  }
  return closure;
}

void command::destroy_closure() noexcept {
  if (destroy != nullptr) std::exchange(destroy, nullptr)(closure);
  if (closure_alignment_ != 0) {
    ::operator delete (closure, std::align_val_t{std::exchange(closure_alignment_, 0)});
  }
}

void command::add_dependency(std::shared_ptr<command> predecessor) {
  if (predecessor == nullptr || predecessor->complete()) return;
  if (edge_count_ >= inline_edges) more_edges_.emplace_back();
  edge_at(edge_count_++).predecessor = std::move(predecessor);
}

void command::add_access(std::shared_ptr<buffer_storage> storage, std::size_t begin,
                         std::size_t end, bool write) {
  access_record record;
  record.storage = std::move(storage);
  record.begin = begin;
  record.end = end;
  record.write = write;
  accesses_.push_back(std::move(record));
}

void command::register_accesses() {
  if (accesses_.empty()) return;
  // One mutex for all buffers: the commands get one order, whatever buffers they share.
  const std::lock_guard lock(buffer_storage::accesses_mutex());
  for (access_record& record : accesses_) {
    record.owner = this;
    record.storage->add_access(record, *this);
  }
}

void command::unregister_accesses() noexcept {
  if (accesses_.empty()) return;
  {
    const std::lock_guard lock(buffer_storage::accesses_mutex());
    for (access_record& record : accesses_) record.storage->remove_access(record);
  }
  accesses_.clear();
}

void command::link() noexcept {
  for (std::uint32_t i = 0; i < edge_count_; ++i) {
    edge& added = edge_at(i);
    added.successor = this;
    pending.fetch_add(1, std::memory_order_relaxed);
    std::atomic<edge*>& list = added.predecessor->successors_;
    edge* head = list.load(std::memory_order_acquire);
    do {
      if (head == closed) {
        pending.fetch_sub(1, std::memory_order_relaxed);
        break;
      }
      added.next = head;
    } while (!list.compare_exchange_weak(head, &added, std::memory_order_release,
                                         std::memory_order_acquire));
  }
}

edge* command::close() noexcept { return successors_.exchange(closed, std::memory_order_acq_rel); }

void command::clear_dependencies() noexcept {
  if (edge_count_ == 0) return;
  const std::lock_guard lock(edges_mutex_);
  for (std::uint32_t i = 0; i < edge_count_; ++i) edge_at(i).predecessor.reset();
  edge_count_ = 0;
  more_edges_.clear();
  more_edges_.shrink_to_fit();
}

std::vector<event> command::wait_list() {
  std::vector<event> result;
  const std::lock_guard lock(edges_mutex_);
  for (std::uint32_t i = 0; i < edge_count_; ++i) {
    const std::shared_ptr<command>& predecessor = edge_at(i).predecessor;
    if (!predecessor->complete()) result.push_back(handle_access::make<event>(predecessor));
  }
  return result;
}

}  // namespace sycl::detail
