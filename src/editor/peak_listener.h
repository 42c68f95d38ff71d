#pragma once

#include <cstdint>

#include "guikit/default_event_listener.h"

class BrakmorphDsp;

// Lights the clip lamp (a FadingDiode) from the engine's clip flag. Each lamp
// tick reads the flag, which also lets the engine clear it for the next chunk,
// so a lit lamp means "clipped since the last tick". A change of state switches
// the lamp and starts its fade.
class PeakListener : public guikit::DefaultEventListener {
 public:
  static constexpr int32_t kEventTick = 2;

  void set_engine(BrakmorphDsp* engine) { engine_ = engine; }
  bool get_last_clip() const { return last_clip_; }

  void on_event(int32_t code, int32_t argument) override;

 private:
  BrakmorphDsp* engine_ = nullptr;
  bool last_clip_ = false;
};
