#pragma once

#include <array>
#include <atomic>
#include <cstddef>
#include <cstdint>

namespace basic {

// A bounded queue for several producers and one consumer without locks: each
// cell carries a sequence number that says whether it is free for the
// producer of a given turn or full for the consumer. Producers claim a turn
// with a compare-and-swap; a full queue refuses at once.
template <class T, size_t Capacity>
class BoundedMpscQueue {
 public:
  static_assert(Capacity >= 2 && (Capacity & (Capacity - 1)) == 0, "capacity is a power of two");

  BoundedMpscQueue() {
    for (size_t i = 0; i < Capacity; ++i) cells_[i].sequence.store(i, std::memory_order_relaxed);
  }

  bool push(const T& value) {
    size_t position = tail_.load(std::memory_order_relaxed);
    for (;;) {
      Cell& cell = cells_[position & (Capacity - 1)];
      const size_t sequence = cell.sequence.load(std::memory_order_acquire);
      const intptr_t difference = static_cast<intptr_t>(sequence) - static_cast<intptr_t>(position);
      if (difference == 0) {
        if (tail_.compare_exchange_weak(position, position + 1, std::memory_order_relaxed)) {
          cell.value = value;
          cell.sequence.store(position + 1, std::memory_order_release);
          return true;
        }
      } else if (difference < 0) {
        return false;
      } else {
        position = tail_.load(std::memory_order_relaxed);
      }
    }
  }

  // Single consumer.
  bool pop(T& value) {
    Cell& cell = cells_[head_ & (Capacity - 1)];
    const size_t sequence = cell.sequence.load(std::memory_order_acquire);
    if (static_cast<intptr_t>(sequence) - static_cast<intptr_t>(head_ + 1) < 0) {
      return false;
    }
    value = cell.value;
    cell.sequence.store(head_ + Capacity, std::memory_order_release);
    ++head_;
    return true;
  }

 private:
  struct Cell {
    std::atomic<size_t> sequence{0};
    T value{};
  };
  std::array<Cell, Capacity> cells_;
  alignas(64) std::atomic<size_t> tail_{0};
  alignas(64) size_t head_ = 0;
};

}  // namespace basic
