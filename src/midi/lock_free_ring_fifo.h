#pragma once

#include <array>
#include <atomic>
#include <cstddef>

namespace basic {

// Single-producer single-consumer ring of Capacity slots, one kept free, so
// it holds at most Capacity - 1 entries. The producer writes only the write
// index and the consumer only the read index, each published with release
// after its entry and read with acquire; neither side locks or allocates.
template <class T, size_t Capacity>
class LockFreeRingFifo {
 public:
  static_assert(Capacity >= 2, "one slot is always kept free");

  // Producer side. False when full: the entry is dropped.
  bool push(const T& entry) {
    const size_t write = write_.load(std::memory_order_relaxed);
    const size_t next = (write + 1) % Capacity;
    if (next == read_.load(std::memory_order_acquire)) {
      return false;
    }
    slots_[write] = entry;
    write_.store(next, std::memory_order_release);
    return true;
  }

  // Consumer side. False when empty.
  bool pop(T& entry) {
    const size_t read = read_.load(std::memory_order_relaxed);
    if (read == write_.load(std::memory_order_acquire)) {
      return false;
    }
    entry = slots_[read];
    read_.store((read + 1) % Capacity, std::memory_order_release);
    return true;
  }

  // Consumer side: forgets everything queued so far.
  void clear() { read_.store(write_.load(std::memory_order_acquire), std::memory_order_release); }

  static constexpr size_t capacity() { return Capacity; }

 private:
  std::array<T, Capacity> slots_{};
  alignas(64) std::atomic<size_t> write_{0};
  alignas(64) std::atomic<size_t> read_{0};
};

}  // namespace basic
