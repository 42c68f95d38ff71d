#pragma once

#include <algorithm>

// Walks count samples of a ring buffer from a start position in runs that
// never cross the end of the buffer, so callers copy each run with a plain loop.
class RingCursor {
 public:
  void start(int length, int position, int count) {
    length_ = length;
    position_ = position;
    remaining_ = count;
    run_length_ = std::max(0, std::min(remaining_, length_ - position_));
  }

  void next() {
    position_ += run_length_;
    if (position_ >= length_) position_ = 0;
    remaining_ -= run_length_;
    run_length_ = std::max(0, std::min(remaining_, length_ - position_));
  }

  int position() const { return position_; }
  int run_length() const { return run_length_; }
  bool done() const { return run_length_ <= 0; }

 private:
  int length_ = 0;
  int position_ = 0;
  int remaining_ = 0;
  int run_length_ = 0;
};
