#pragma once

#include <string>

#include "presets/generic_preset_listener.h"

namespace plugcore {

// The fade-time display, also an input: a typed time moves the knob.
class PresetTimeDisplayListener : public GenericPresetListener {
 public:
  void set_precision(int digits) { precision_ = digits; }
  int get_precision() const { return precision_; }

  // The time as text into the bound box.
  void show(double seconds);
  std::string format(double seconds) const;
  void on_event(int32_t code, int32_t argument) override;

 private:
  int precision_ = 0;
};

}  // namespace plugcore
