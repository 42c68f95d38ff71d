#include "guikit/toolkit_clock.h"

#include "config/system_services.h"

namespace guikit {

namespace {
ClockInterface* g_clock = nullptr;
}

double toolkit_now() { return g_clock ? g_clock->now_seconds() : sys::get_time(); }

ClockInterface* install_clock(ClockInterface* clock) {
  ClockInterface* previous = g_clock;
  g_clock = clock;
  return previous;
}

}  // namespace guikit
