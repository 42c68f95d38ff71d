// A progress bar on standard error for long renders: it appears only on a
// terminal and only once a run has taken about a second of wall time.
#pragma once

#include <chrono>
#include <string>

namespace basic {

class ProgressBar {
 public:
  ProgressBar(std::string label, bool enabled);
  ~ProgressBar();  // clears the bar's line if one was drawn
  void update(double fraction);

 private:
  std::string label_;
  bool enabled_;
  bool drawn_ = false;
  std::chrono::steady_clock::time_point start_;
  std::chrono::steady_clock::time_point last_draw_;
};

}  // namespace basic
