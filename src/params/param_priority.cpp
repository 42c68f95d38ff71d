#include "params/param_priority.h"

#include <stdexcept>

namespace plugcore {

ParamPriority::ParamPriority(const ParamPriority& other)
    : time_(other.time_.load(std::memory_order_relaxed)),
      hold_(other.hold_.load(std::memory_order_relaxed)),
      priority_(other.priority_.load(std::memory_order_relaxed)) {}

ParamPriority& ParamPriority::operator=(const ParamPriority& other) {
  time_.store(other.time_.load(std::memory_order_relaxed), std::memory_order_relaxed);
  hold_.store(other.hold_.load(std::memory_order_relaxed), std::memory_order_relaxed);
  priority_.store(other.priority_.load(std::memory_order_relaxed), std::memory_order_relaxed);
  return *this;
}

bool ParamPriority::test(double now, int priority) const {
  bool refused = priority < priority_.load(std::memory_order_relaxed) &&
                 now <= time_.load(std::memory_order_relaxed) + hold_.load(std::memory_order_relaxed);
  return !refused;
}

bool ParamPriority::take(double now, int priority) {
  if (!test(now, priority)) {
    return false;
  }
  time_.store(now, std::memory_order_relaxed);
  priority_.store(priority, std::memory_order_relaxed);
  return true;
}

void ParamPriority::release(int priority) {
  // Only the holder frees the record; a stranger's release is ignored.
  int holder = priority;
  priority_.compare_exchange_strong(holder, 0, std::memory_order_relaxed);
}

void ParamPriorityList::resize(int count) { records_.resize(count > 0 ? static_cast<size_t>(count) : 0); }

int ParamPriorityList::size() const { return static_cast<int>(records_.size()); }

ParamPriority& ParamPriorityList::use(int index) {
  if (index < 0 || index >= size()) {
    throw std::runtime_error("plugcore::ParamPriorityList::use() : Invalid index.");
  }
  return records_[static_cast<size_t>(index)];
}

}  // namespace plugcore
