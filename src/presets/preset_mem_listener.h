#pragma once

#include "presets/generic_preset_listener.h"

namespace plugcore {

// The Load/Store switch. The mode is the bound flip-flop's value, nothing else.
class PresetMemListener : public GenericPresetListener {
 public:
  enum Mode : int { kLoad = 0, kStore = 1 };

  // Load while unbound.
  int get_mode();
  void set_mode(int mode);
};

}  // namespace plugcore
