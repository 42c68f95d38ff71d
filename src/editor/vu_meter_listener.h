#pragma once

#include <cstdint>

#include "guikit/default_event_listener.h"

class BrakmorphDsp;

// Drives one band's VU needle from the engine's published band level: on each
// needle tick the level becomes a position, -30 dB at 0 and +10 dB at 1, and the
// needle moves only when the position changed by more than the minimum change.
class VuMeterListener : public guikit::DefaultEventListener {
 public:
  static constexpr int32_t kEventTick = 0;

  void set_engine(BrakmorphDsp* engine) { engine_ = engine; }
  void set_band(int band) { band_ = band; }
  int get_band() const { return band_; }
  // 1 / steps for steps > 0, else 1e-9 (every change shows).
  void set_min_change(int steps);
  float get_min_change() const { return min_change_; }
  float get_last_position() const { return last_position_; }

  // (20 log10(max(level, 1e-6)) + 30) x 0.025, limited to 0..1.
  static float level_to_position(float level);

  void on_event(int32_t code, int32_t argument) override;

 private:
  BrakmorphDsp* engine_ = nullptr;
  int band_ = -1;
  float last_position_ = -1.0f;
  float min_change_ = 0.01f;
};
