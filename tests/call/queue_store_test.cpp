// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "call/queue_store.hpp"

#include <gtest/gtest.h>

#include <atomic>
#include <cstdint>
#include <cstring>
#include <deque>
#include <functional>
#include <set>
#include <string>
#include <sycl/sycl.hpp>
#include <thread>
#include <vector>

#include "frontend/call.hpp"

namespace {

using namespace arbor::lumen::vm::detail;

/// FNV-1a, on bytes in memory.
std::uint64_t fnv1a(const std::string& bytes) {
  std::uint64_t hash = 14695981039346656037u;
  for (const char byte : bytes) hash = (hash ^ static_cast<unsigned char>(byte)) * 1099511628211u;
  return hash;
}

std::string little_endian(std::uint64_t value) {
  std::string bytes;
  for (; bytes.size() < 8; value /= 256) bytes.push_back(static_cast<char>(value % 256));
  return bytes;
}

template <typename Handle>
std::uint64_t first_word(const Handle& handle) {
  std::uintptr_t words[(sizeof(Handle) + sizeof(std::uintptr_t) - 1) / sizeof(std::uintptr_t)];
  std::memcpy(words, static_cast<const void*>(&handle), sizeof(Handle));
  return words[0];
}

// Known answers of the hash: the empty string's is the offset itself.
TEST(Fnv, ReferenceMatchesKnownAnswers) {
  EXPECT_EQ(0xcbf29ce484222325u, fnv1a(""));
  EXPECT_EQ(0xaf63dc4c8601ec8cu, fnv1a("a"));
  EXPECT_EQ(0x85944171f73967e8u, fnv1a("foobar"));
}

TEST(Fnv, TakesTheEightBytesLowestFirst) {
  for (const std::uint64_t value :
       {std::uint64_t{0}, std::uint64_t{1}, std::uint64_t{0x0102030405060708}, std::uint64_t{0xff},
        std::uint64_t{0xff00000000000000}, ~std::uint64_t{0}})
    EXPECT_EQ(fnv1a(little_endian(value)), fnv(value)) << value;
}

TEST(QueueKey, OfNoQueueIsZero) { EXPECT_EQ(0u, queue_key(nullptr)); }

TEST(QueueKey, MixesQueueContextAndDevice) {
  for (int i = 0; i < 3; ++i) {
    const sycl::queue queue;
    const std::uint64_t of_queue = std::hash<sycl::queue>()(queue);
    const std::uint64_t of_context = fnv1a(little_endian(first_word(queue.get_context())));
    const std::uint64_t of_device = fnv1a(little_endian(first_word(queue.get_device())));
    const std::uint64_t expected = (of_queue * 4794697086780616226u) ^
                                   (of_context * 2605069938431070429u) ^
                                   (of_device * 5786931595072633687u);
    EXPECT_EQ(expected, queue_key(&queue));
  }
}

TEST(QueueKey, IsSharedByCopiesOnly) {
  const sycl::queue queue, other;
  const sycl::queue copy = queue;
  EXPECT_EQ(queue_key(&queue), queue_key(&copy));
  EXPECT_NE(queue_key(&queue), queue_key(&other));
}

/// Keys that no queue of this process has.
std::uint64_t unused_key() {
  static std::atomic<std::uint64_t> next{0x7465737400000000};
  return ++next;
}

TEST(QueueStore, IsOne) {
  queue_store* first = &queue_store::instance();
  std::vector<queue_store*> seen(8);
  std::vector<std::thread> threads;
  for (queue_store*& slot : seen)
    threads.emplace_back([&slot] { slot = &queue_store::instance(); });
  for (std::thread& thread : threads) thread.join();
  for (const queue_store* store : seen) EXPECT_EQ(first, store);
}

TEST(QueueStore, DefaultEventIsSharedAndComplete) {
  sycl::event a = queue_store::instance().default_event();
  const sycl::event b = queue_store::instance().default_event();
  EXPECT_EQ(a, b);
  EXPECT_EQ(sycl::info::event_command_status::complete,
            a.get_info<sycl::info::event::command_execution_status>());
  a.wait_and_throw();
}

TEST(QueueStore, KeepsTheMergedMode) {
  queue_store& store = queue_store::instance();
  const std::uint64_t key = unused_key();
  EXPECT_EQ(0u, store.stored_mode(key));
  EXPECT_EQ(0u, store.merge_mode(key, 12));
  EXPECT_EQ(0x181120Cu, store.stored_mode(key));
  EXPECT_EQ(0x181120Cu, store.merge_mode(key, 0x20000));
  EXPECT_EQ(0x182120Cu, store.stored_mode(key));
  EXPECT_EQ(0x182120Cu, store.merge_mode(key, 0));
  EXPECT_EQ(0x182120Cu, store.stored_mode(key));
  EXPECT_EQ(0u, store.stored_mode(unused_key()));
}

TEST(QueueStore, StoresTheDefaultWhenNothingIsMerged) {
  queue_store& store = queue_store::instance();
  const std::uint64_t key = unused_key();
  EXPECT_EQ(0u, store.merge_mode(key, 0));
  EXPECT_EQ(0x1811204u, store.stored_mode(key));
}

TEST(QueueStore, StatusWordsStartAtZeroAndStayInPlace) {
  queue_store& store = queue_store::instance();
  const std::uint64_t key = unused_key();
  std::atomic<std::uint32_t>& word = store.status_word(key);
  EXPECT_EQ(0u, word.load());
  word.fetch_or(256);
  // Enough entries that the map grows its table several times.
  for (int i = 0; i < 5000; ++i) store.status_word(unused_key());
  EXPECT_EQ(&word, &store.status_word(key));
  EXPECT_EQ(256u, word.load());
}

TEST(QueueStore, NotesDeviceWordsOverAndOver) {
  const std::uint64_t key = unused_key();
  queue_store::instance().record_device_word(key, 1);
  queue_store::instance().record_device_word(key, 2);
}

TEST(QueueStore, ServesManyThreads) {
  queue_store& store = queue_store::instance();
  const std::uint64_t shared = unused_key();
  std::vector<std::thread> threads;
  for (std::uint32_t t = 0; t < 8; ++t) {
    threads.emplace_back([&store, shared, t] {
      const std::uint64_t own = unused_key();
      for (int i = 0; i < 500; ++i) {
        store.status_word(shared).fetch_or(1u << t);
        store.status_word(own).fetch_or(2);
        store.merge_mode(shared, 12);
        store.merge_mode(own, 15);
        store.stored_mode(shared);
        store.record_device_word(shared, t);
        store.default_event();
      }
      EXPECT_EQ(2u, store.status_word(own).load());
      EXPECT_EQ(0x181120Fu, store.stored_mode(own));
    });
  }
  for (std::thread& thread : threads) thread.join();
  EXPECT_EQ(0xFFu, store.status_word(shared).load());
  EXPECT_EQ(0x181120Cu, store.stored_mode(shared));
}

TEST(EffectiveMode, IsTheQueuesWithTheCallersGroups) {
  namespace enums = arbor::lumen::vm::enums;
  static std::deque<sycl::queue> kept;  // a later queue in the place of one would meet its mode
  sycl::queue& queue = kept.emplace_back();
  EXPECT_EQ(0x1811204u, effective_mode(&queue, enums::not_defined));
  EXPECT_EQ(0x182120Cu, effective_mode(&queue, enums::la | enums::badarg_quiet));
  queue_store::instance().merge_mode(queue_key(&queue), 15);
  EXPECT_EQ(0x181120Fu, effective_mode(&queue, enums::not_defined));
  EXPECT_EQ(0x181120Cu, effective_mode(&queue, enums::la));
  // A call's mode is for that call alone.
  EXPECT_EQ(0x181120Fu, effective_mode(&queue, enums::not_defined));
}

}  // namespace
