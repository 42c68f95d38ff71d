#pragma once

#include <atomic>
#include <vector>

namespace plugcore {

// Write arbitration of one parameter: a writer of lower priority is shut out
// for `hold` seconds after a write of higher priority. Writers on several
// threads meet here without a lock, so the fields are relaxed atomics; the
// caller reads the clock and passes `now` in seconds.
class ParamPriority {
 public:
  ParamPriority() = default;
  ParamPriority(const ParamPriority& other);
  ParamPriority& operator=(const ParamPriority& other);

  bool test(double now, int priority) const;
  bool take(double now, int priority);
  void release(int priority);

  double get_time() const { return time_.load(std::memory_order_relaxed); }
  double get_hold() const { return hold_.load(std::memory_order_relaxed); }
  int get_priority() const { return priority_.load(std::memory_order_relaxed); }

 private:
  std::atomic<double> time_{0.0};
  std::atomic<double> hold_{0.5};
  std::atomic<int> priority_{0};  // 0: free
};

// One arbitration record per parameter, sized at plug-in construction.
class ParamPriorityList {
 public:
  void resize(int count);
  int size() const;
  // Throws std::runtime_error for an index outside the list.
  ParamPriority& use(int index);

 private:
  std::vector<ParamPriority> records_;
};

}  // namespace plugcore
