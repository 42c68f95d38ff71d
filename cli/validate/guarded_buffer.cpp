#include "cli/validate/guarded_buffer.h"

#include <cstring>

namespace plugcore {

GuardedBuffer::GuardedBuffer(size_t capacity, bool zeroed)
    : capacity_(capacity), zeroed_(zeroed), bytes_(capacity + kGuard, kPattern) {
  if (zeroed) std::memset(bytes_.data(), 0, capacity);
}

std::string GuardedBuffer::overrun() const {
  for (size_t i = capacity_; i < bytes_.size(); ++i) {
    if (bytes_[i] != kPattern) {
      return "wrote byte " + std::to_string(i) + " beyond the capacity of " +
             std::to_string(capacity_);
    }
  }
  return "";
}

bool GuardedBuffer::untouched() const {
  for (size_t i = 0; i < capacity_; ++i) {
    if (bytes_[i] != (zeroed_ ? 0 : kPattern)) return false;
  }
  return true;
}

std::string GuardedBuffer::text_problem() const {
  const std::string beyond = overrun();
  if (!beyond.empty()) return beyond;
  if (untouched()) return "";
  if (std::memchr(bytes_.data(), 0, capacity_) == nullptr) {
    return "text not terminated within its capacity of " + std::to_string(capacity_);
  }
  return "";
}

std::string GuardedBuffer::field_problem(size_t offset, size_t length, const char* field) const {
  if (std::memchr(bytes_.data() + offset, 0, length) == nullptr) {
    return std::string(field) + " not terminated within its " + std::to_string(length) + " bytes";
  }
  return "";
}

}  // namespace plugcore
