#pragma once

namespace guikit {

// The toolkit's notion of "now" in seconds. By default the system clock;
// an off-screen window installs a hand-driven clock so time is under test control.
class ClockInterface {
 public:
  virtual ~ClockInterface() = default;
  virtual double now_seconds() const = 0;
};

double toolkit_now();

// nullptr goes back to the system clock; answers the clock that was installed.
ClockInterface* install_clock(ClockInterface* clock);

}  // namespace guikit
