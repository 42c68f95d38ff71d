#include "editor/gui_master.h"

#include <cstdint>
#include <cstdio>
#include <cstring>
#include <string>

#include "editor/brakmorph_gui.h"
#include "editor/editor_trees.h"
#include "guikit/messages.h"
#include "skin/skin_anchors.h"

namespace {

using guikit::Point;
using guikit::Rect;

Point anchor(const SkinPictureGeometry& g) { return Point{g.anchor_x, g.anchor_y}; }

// The knob strip covers 98/97 of three quarters of a turn, so that the frames of
// both ends sit half a step inside the sweep; the exact single-precision value.
float knob_turns_covered() {
  const uint32_t bits = 0xBF41FAB9u;
  float turns;
  std::memcpy(&turns, &bits, sizeof turns);
  return turns;
}

struct MasterKnob {
  int param;
  Point position;
};
// Parameters 2..7 of the master column.
constexpr MasterKnob kMasterKnobs[GuiMaster::kNbrMasterKnobs] = {
    {2, {35, 72}}, {3, {94, 72}}, {4, {35, 197}}, {5, {94, 135}}, {6, {35, 135}}, {7, {94, 22}}};
constexpr Point kLampPositions[3] = {{68, 44}, {120, 169}, {92, 107}};
constexpr Point kClipPosition{126, 20};
constexpr Point kSplitPosition[GuiMaster::kNbrSplits] = {{162, 10}, {162, 20}, {162, 30}};
constexpr int kFirstSplitParam = 9;

// Band controls at band 1's positions; each further band sits 114 pixels to the right.
constexpr Point kBandKnobPositions[5] = {{177, 136}, {230, 136}, {177, 197}, {230, 197}, {230, 82}};
constexpr int kBandStep = 114;
constexpr int kSoloX[GuiMaster::kNbrBands] = {226, 340, 455, 569};
constexpr int kSoloY = 39;
constexpr Point kNeedlePosition{180, 118};
constexpr int kSoloSlot = 5;

constexpr Rect kKnobBox{-19, -19, 20, 23};
constexpr Rect kSplitBox{-4, -3, 448, 4};
constexpr Rect kStereoBox{0, 0, 17, 17};
constexpr Rect kWideBox{-16, -5, 41, 28};
constexpr Rect kSoloBox{-4, -3, 27, 15};
constexpr Rect kLampBox{-8, -8, 9, 9};
constexpr Rect kNeedleBox{-23, -59, 23, -22};

Point offset_in(const guikit::CtrlGroupItem& group, Point position) {
  const Point g = group.get_position();
  return Point{position.x - g.x, position.y - g.y};
}

}  // namespace

GuiMaster::GuiMaster(BrakmorphGui& gui) : GuiPart(gui) {
  // One magnet per curve: 0, then 1/12 in single precision added twelve times.
  float v = 0.0f;
  for (int i = 0; i < 13; ++i) {
    double m = v < 0.0f ? 0.0 : (v > 1.0f ? 1.0 : static_cast<double>(v));
    dist_type_magnets_.push_back(m);
    v += 1.0f / 12.0f;
  }
}

GuiMaster::~GuiMaster() = default;

void GuiMaster::setup_knob(guikit::Knob& knob) {
  std::vector<guikit::Picture> frames;
  for (int i = 0; i < kSkinKnobFrameCount; ++i) {
    char name[16];
    std::snprintf(name, sizeof name, "kn_26_%02d", i);
    frames.push_back(slot(name, anchor(kSkinKnobFrame)));
  }
  knob.set_frames(frames, 0.625, knob_turns_covered());
  knob.set_rotate_frames(true);
  knob.set_background(slot("kn_26_p", anchor(kSkinKnobBack)));
  knob.set_active_picture(slot("kn_26_s", anchor(kSkinKnobActive)));
  knob.set_drag_range(256.0);
  knob.set_secondary_factor(0.03125f);
  knob.set_angles(0.625, -0.75);
  knob.set_spin_speed(1.0);
}

void GuiMaster::setup_flip_flop(guikit::FlipFlop& ff, const char* stem, Point placement, double transition) {
  ff.set_frames(frame_slots(stem, 5, placement));
  ff.set_transition_time(transition);
}

void GuiMaster::bind(int index, guikit::ControlInterface& control) {
  gui_.bind(index, control, listeners_[static_cast<size_t>(index)]);
}

void GuiMaster::build(EditorTrees& trees) {
  trees_ = &trees;
  build_master(trees);
  build_splits(trees);
  for (int b = 0; b < kNbrBands; ++b) build_band(trees, b);
}

void GuiMaster::build_master(EditorTrees& trees) {
  guikit::CtrlGroupItem& group = trees.master_group();

  setup_flip_flop(stereo_boost_, "ff_04", anchor(kSkinStereoSwitch), 0.2);
  bind(0, stereo_boost_);
  place(group, stereo_boost_, offset_in(group, Point{112, 188}), kStereoBox);

  setup_flip_flop(oversampling_, "ff_16", anchor(kSkinWideSwitch), 0.3);
  oversampling_.set_foreground(slot("ff_16_p", anchor(kSkinWideSwitchFront)));
  bind(1, oversampling_);
  place(group, oversampling_, offset_in(group, Point{26, 8}), kWideBox);

  for (int k = 0; k < kNbrMasterKnobs; ++k) {
    guikit::Knob& knob = master_knobs_[static_cast<size_t>(k)];
    setup_knob(knob);
    bind(kMasterKnobs[k].param, knob);
    place(group, knob, offset_in(group, kMasterKnobs[k].position), kKnobBox);
  }

  // "Reserved" keeps a control so that every parameter has one, but it is never shown.
  setup_flip_flop(reserved_, "ff_04", anchor(kSkinStereoSwitch), 0.2);
  bind(8, reserved_);

  for (int k = 0; k < 3; ++k) {
    guikit::FlipFlop& lamp = lamps_[static_cast<size_t>(k)];
    setup_flip_flop(lamp, "ff_18", anchor(kSkinLamp), 0.3);
    place(group, lamp, offset_in(group, kLampPositions[k]), kLampBox);
  }

  // The lamps light while their companion control is above zero.
  guikit::ControlInterface* companions[3] = {&master_knobs_[1], &stereo_boost_, &master_knobs_[3]};
  for (int k = 0; k < 3; ++k) {
    lamp_listeners_[static_cast<size_t>(k)].set_diode(&lamps_[static_cast<size_t>(k)]);
    companions[k]->push_back_listener(&lamp_listeners_[static_cast<size_t>(k)]);
  }

  clip_.set_frames(frame_slots("ff_18", 5, anchor(kSkinClipLamp)));
  clip_.set_refresh_period(0.05f);
  clip_.set_fade_times(0.0, 0.5);
  peak_.set_engine(gui_.use_engine());
  clip_.set_listener(&peak_);
  place(group, clip_, offset_in(group, kClipPosition), kWideBox);
}

void GuiMaster::build_splits(EditorTrees& trees) {
  guikit::CtrlGroupItem& group = trees.top_group();
  const std::array<BandSpltListener*, kNbrSplits> all = {&split_listeners_[0], &split_listeners_[1],
                                                         &split_listeners_[2]};
  for (int k = 0; k < kNbrSplits; ++k) {
    guikit::Fader& fader = splits_[static_cast<size_t>(k)];
    fader.set_orientation(false);
    fader.set_travel_length(kSkinFaderTravel);
    fader.set_cap(slot("fd_09", anchor(kSkinFaderCap)));
    fader.set_background(slot("fd_09_s", anchor(kSkinFaderTrack)));
    fader.set_secondary_factor(0.03125f);
    fader.set_spin_speed(1.0);
    BandSpltListener& listener = split_listeners_[static_cast<size_t>(k)];
    listener.set_splits(all);
    listener.set_band_display(this);
    gui_.bind(kFirstSplitParam + k, fader, listener);
    place(group, fader, offset_in(group, kSplitPosition[k]), kSplitBox);
  }
}

void GuiMaster::build_band(EditorTrees& trees, int b) {
  Band& band = bands_[static_cast<size_t>(b)];
  const int first = kFirstBandParam + kBandParamStride * b;
  for (int s = 0; s < kBandKnobs; ++s) {
    guikit::Knob& knob = band.knobs[static_cast<size_t>(s)];
    setup_knob(knob);
    bind(first + s, knob);
  }
  band.knobs[3].set_magnets(&dist_type_magnets_);

  setup_flip_flop(band.solo, "ff_17", anchor(kSkinSoloSwitch), 0.3);
  bind(first + kSoloSlot, band.solo);
  // Right-button linking of the same control across the bands.
  for (int s = 0; s < kLinkedSlots; ++s) {
    links_.push_back(std::make_unique<RcMgr>(&gui_, first + s));
    listeners_[static_cast<size_t>(first + s)].set_next(links_.back().get());
  }

  const std::string stem = "vn_0" + std::to_string(b + 1);
  // The skin's needle stands upright and turns about its own pivot.
  band.needle.set_skin(slot(stem + "_p", anchor(kSkinMeterFace)), slot(stem, Point{0, 0}),
                       slot(stem + "_o", anchor(kSkinMeterCover)), kSkinNeedle.pivot_x, kSkinNeedle.pivot_y);
  band.needle.set_geometry(0.3175, -0.135, Point{0, 0}, 4.0);
  band.needle.set_refresh_period(0.04f);
  VuMeterListener& meter = meters_[static_cast<size_t>(b)];
  meter.set_engine(gui_.use_engine());
  meter.set_band(b);
  band.needle.set_listener(&meter);

  guikit::CtrlGroupItem& group = trees.band_group(b);
  const int dx = kBandStep * b;
  for (int s = 0; s < kBandKnobs; ++s) {
    const Point p{kBandKnobPositions[s].x + dx, kBandKnobPositions[s].y};
    band.knobs[static_cast<size_t>(s)].set_offset(offset_in(group, p));
    band.knobs[static_cast<size_t>(s)].set_bounding_box(kKnobBox);
  }
  band.solo.set_offset(offset_in(group, Point{kSoloX[b], kSoloY}));
  band.solo.set_bounding_box(kSoloBox);
  band.needle.set_offset(offset_in(group, Point{kNeedlePosition.x + dx, kNeedlePosition.y}));
  band.needle.set_bounding_box(kNeedleBox);
  for (guikit::ControlInterface* c : band_controls(b)) {
    c->set_placed(true);
    group.add_control(c);
  }
}

std::vector<guikit::ControlInterface*> GuiMaster::band_controls(int b) {
  Band& band = bands_[static_cast<size_t>(b)];
  std::vector<guikit::ControlInterface*> controls;
  controls.push_back(&band.needle);
  for (guikit::Knob& knob : band.knobs) controls.push_back(&knob);
  controls.push_back(&band.solo);
  return controls;
}

void GuiMaster::show_band(int band, bool shown) {
  if (band <= 0 || band >= kNbrBands || trees_ == nullptr) return;
  const size_t b = static_cast<size_t>(band);
  if (band_shown_[b] == shown) return;
  band_shown_[b] = shown;
  guikit::CtrlGroupItem& group = trees_->band_group(band);
  for (guikit::ControlInterface* c : band_controls(band)) {
    if (shown) {
      group.add_control(c);
    } else {
      group.remove_control(c);
    }
  }
  const Rect area = trees_->show_band_page(band, shown);
  guikit::Invalidate invalidate(area);
  trees_->background_root().process_message(invalidate);
}
