#pragma once

#include "presets/preset_selection_listener_base.h"

namespace guikit {
class TextBox;
}

namespace plugcore {

// One program button: a press loads (or stores) its program.
class PresetNumberListener : public PresetSelectionListenerBase {
 public:
  void set_index(int index) { index_ = index; }
  int get_index() const { return index_; }
  // Optional box that shows the selected program's name (not owned).
  void set_name_box(guikit::TextBox* box) { name_box_ = box; }

  void on_event(int32_t code, int32_t argument) override;

 private:
  int index_ = -1;
  guikit::TextBox* name_box_ = nullptr;
};

}  // namespace plugcore
