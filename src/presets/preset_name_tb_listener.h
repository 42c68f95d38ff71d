#pragma once

#include "presets/preset_selection_listener_base.h"

namespace plugcore {

// An editable box: an accepted name renames the current program, or the
// engine's program when none is selected yet.
class PresetNameTbListener : public PresetSelectionListenerBase {
 public:
  void on_event(int32_t code, int32_t argument) override;
};

}  // namespace plugcore
