#pragma once

#include <memory>

#include "editor/gui_part.h"
#include "guikit/knob.h"
#include "guikit/push_button.h"
#include "guikit/text_box.h"
#include "presets/preset_manager.h"
#include "presets/prog_st_ld_default.h"

class EditorTrees;

// The preset panel: eight program buttons, the Load/Store switch, the bank load
// and save buttons, the fade-time knob and its display, and the preset manager
// that drives them. The manager's bank, mode and fade time last as long as the
// editor object, across openings of the window.
class GuiPresets : public GuiPart {
 public:
  static constexpr int kNbrPrograms = 8;
  static constexpr int kFramesPerButton = 12;

  explicit GuiPresets(BrakmorphGui& gui);
  ~GuiPresets() override;

  // Hands the controls to the preset manager and points its bank dialog at the
  // setting folder; answers the manager's status.
  int init();
  void build(EditorTrees& trees);
  void deinit();

  plugcore::PresetManager& use_manager() { return manager_; }
  int get_nbr_buttons() const { return nbr_buttons_; }
  guikit::PushButton& button(int i) { return buttons_[static_cast<size_t>(i)]; }
  guikit::FlipFlop& mode_switch() { return mode_; }
  guikit::Knob& fade_knob() { return fade_knob_; }
  guikit::TextBox& fade_display() { return fade_display_; }

  // The resource-list index of frame k (0..11) of program button i: the button's
  // five pictures eased through a twelve-step flash.
  static int program_frame_index(int button, int frame);

 private:
  void ensure_buttons();

  plugcore::PresetManager manager_{kNbrPrograms};
  std::unique_ptr<guikit::PushButton[]> buttons_;  // programs, then bank load, bank save
  int nbr_buttons_ = 0;
  guikit::FlipFlop mode_;
  guikit::Knob fade_knob_;
  guikit::TextBox fade_display_;
  plugcore::ProgStLdDefault strategy_;
};
