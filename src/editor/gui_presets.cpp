#include "editor/gui_presets.h"

#include <cmath>
#include <string>

#include "editor/brakmorph_gui.h"
#include "editor/editor_trees.h"
#include "host/host_gui_interface.h"
#include "skin/skin_anchors.h"

namespace {

using guikit::Point;
using guikit::Rect;

Point anchor(const SkinPictureGeometry& g) { return Point{g.anchor_x, g.anchor_y}; }

constexpr Rect kProgramBox{0, 0, 13, 13};
constexpr Rect kPanelLampBox{-15, -9, 16, 26};
constexpr Point kModePosition{93, 22};
constexpr Point kLoadPosition{184, 22};
constexpr Point kSavePosition{213, 22};
constexpr Point kFadeKnobPosition{153, 31};
constexpr Rect kFadeKnobBox{-13, -14, 14, 13};
constexpr Point kFadeDisplayPosition{135, 28};
constexpr Rect kFadeDisplayBox{-24, 0, 0, 15};
constexpr uint32_t kFadeTextColour = 0x00FFFF;
constexpr int32_t kAlignRight = 2;

}  // namespace

GuiPresets::GuiPresets(BrakmorphGui& gui) : GuiPart(gui) {}

GuiPresets::~GuiPresets() { manager_.deinit(); }

void GuiPresets::ensure_buttons() {
  const int n = manager_.get_nbr_programs() + 2;
  if (nbr_buttons_ != n) {
    buttons_.reset(new guikit::PushButton[static_cast<size_t>(n)]);
    nbr_buttons_ = n;
  }
}

int GuiPresets::program_frame_index(int button, int frame) {
  const int first = SkinPictures::index_of("pb_11_0");
  const int m = SkinPictures::index_of("pb_12_0") - first;
  const double u = frame / 11.0;
  const int step = static_cast<int>(std::floor((m - 1) * 4.0 * u / (3.0 * u + 1.0) + 0.5));
  return first + button * m + step;
}

int GuiPresets::init() {
  ensure_buttons();
  const int n = manager_.get_nbr_programs();
  const int status = manager_.init(gui_, &strategy_, buttons_.get(), mode_, buttons_[static_cast<size_t>(n)],
                                   buttons_[static_cast<size_t>(n + 1)], fade_knob_, fade_display_,
                                   "default_preset_bank");
  plugcore::HostGuiInterface* host_gui = gui_.get_host_gui();
  if (host_gui != nullptr) {
    const std::string path = host_gui->get_setting_path();
    if (!path.empty()) manager_.set_bank_directory(path);
  }
  return status;
}

void GuiPresets::deinit() { manager_.deinit(); }

void GuiPresets::build(EditorTrees& trees) {
  ensure_buttons();
  guikit::CtrlGroupItem& group = trees.presets_group();
  const int n = manager_.get_nbr_programs();
  for (int i = 0; i < n; ++i) {
    std::vector<guikit::Picture> frames;
    for (int k = 0; k < kFramesPerButton; ++k) {
      frames.push_back(slot(SkinPictures::name_at(program_frame_index(i, k)), Point{0, 0}));
    }
    guikit::PushButton& b = buttons_[static_cast<size_t>(i)];
    b.set_frames(frames);
    b.set_flash_duration(1.0);
    place(group, b, Point{(i % 4) * 16 + 14, (i / 4 + 1) * 16}, kProgramBox);
  }

  mode_.set_frames(frame_slots("ff_18", 5, anchor(kSkinLamp)));
  mode_.set_transition_time(0.05);
  place(group, mode_, kModePosition, kPanelLampBox);

  const Point bank_positions[2] = {kLoadPosition, kSavePosition};
  for (int j = 0; j < 2; ++j) {
    guikit::PushButton& b = buttons_[static_cast<size_t>(n + j)];
    b.set_frames(frame_slots("ff_18", 5, anchor(kSkinLamp)));
    b.set_flash_duration(0.2);
    place(group, b, bank_positions[j], kPanelLampBox);
  }

  fade_knob_.set_frames({slot("kn_08", anchor(kSkinSmallKnob))});
  fade_knob_.set_rotate_frames(false);
  // The pointer dot rides 8 pixels from the knob's centre.
  fade_knob_.set_pointers(slot("kn_08_spn", anchor(kSkinSmallKnobPointer)), guikit::Picture(), Point{0, 0},
                          Point{0, 0}, 8.0, true);
  fade_knob_.set_drag_range(256.0);
  fade_knob_.set_secondary_factor(0.03125f);
  fade_knob_.set_angles(0.625, -0.75);
  fade_knob_.set_spin_speed(1.0);
  place(group, fade_knob_, kFadeKnobPosition, kFadeKnobBox);

  fade_display_.set_font(gui_.use_pictures().get_font("font_04"));
  fade_display_.set_editable(true);
  fade_display_.set_alignment(kAlignRight);
  fade_display_.set_colour(kFadeTextColour);
  place(group, fade_display_, kFadeDisplayPosition, kFadeDisplayBox);
}
