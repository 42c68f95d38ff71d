#pragma once

#include <cstdint>

#include "guikit/toolkit_clock.h"

namespace guikit {

// A millisecond clock that moves only when told to.
class ManualClock : public ClockInterface {
 public:
  double now_seconds() const override { return static_cast<double>(ms_) * 0.001; }
  uint32_t now_ms() const { return ms_; }
  void set_ms(uint32_t ms) { ms_ = ms; }

 private:
  uint32_t ms_ = 1000;
};

}  // namespace guikit
