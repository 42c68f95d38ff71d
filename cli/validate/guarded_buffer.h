// A buffer handed to the plug-in with guard bytes: the space the host offers
// is filled with a pattern, followed by more pattern the plug-in must never
// touch, so writing past the capacity or forgetting the terminator shows.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace plugcore {

class GuardedBuffer {
 public:
  static constexpr uint8_t kPattern = 0xA5;
  static constexpr size_t kGuard = 64;

  // capacity bytes of pattern (or of zeroes when zeroed, as hosts hand
  // structures), then the guard.
  explicit GuardedBuffer(size_t capacity, bool zeroed = false);

  void* data() { return bytes_.data(); }
  char* text() { return reinterpret_cast<char*>(bytes_.data()); }
  size_t capacity() const { return capacity_; }

  // Empty when nothing was written beyond the capacity, else what was.
  std::string overrun() const;
  // Empty when the buffer was left alone or holds a terminated text within
  // the capacity; else the problem.
  std::string text_problem() const;
  // Empty when a field of length bytes at offset holds a terminator.
  std::string field_problem(size_t offset, size_t length, const char* field) const;
  bool untouched() const;

 private:
  size_t capacity_;
  bool zeroed_;
  std::vector<uint8_t> bytes_;
};

}  // namespace plugcore
