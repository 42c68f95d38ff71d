#pragma once

#include <array>
#include <cstdint>

#include "guikit/misc_mgr_interface.h"

class ParamControlFinderInterface;

namespace guikit {
class ControlInterface;
}

// Band linking: while the user moves one band's control with the right mouse
// button, the same control of the other three bands follows. Shift makes the
// link relative (the others keep their distance), Control mirrors it (absolute:
// 1 - v; relative: they move the other way).
//
// One RcMgr sits behind the parameter listener of each band control (set_next).
// A press on the control decides the mode for the whole gesture: the link lasts
// while the button is held and through the glide after release, and follows
// only the mouse and glide origins (200 and 50), so host or MIDI writes that
// reach the control are never copied to the other bands.
//
// Relative limits: at the press, each other band's pair {dragged control's
// value, that band's value} is taken (-1, -1 until then). A band's new value is
// its own start value plus (or minus, mirrored) the dragged control's change
// since the press, limited to 0..1. A band pinned at 0 or 1 therefore stays
// there only while the drag is past its limit, and comes back in step, with its
// original distance, as soon as the drag reverses.
class RcMgr : public guikit::MiscMgrInterface {
 public:
  static constexpr int kFirstBandParam = 12;
  static constexpr int kParamsPerBand = 7;
  static constexpr int kNbrBands = 4;

  RcMgr(ParamControlFinderInterface* finder, int param_index);

  void on_value(double value, int32_t origin) override;
  void on_before_message(guikit::MessageInterface& message) override;
  void on_after_message(guikit::MessageInterface& message) override {}
  void set_owner(guikit::DefaultEventListener* owner) override { owner_ = owner; }

  bool is_linked() const { return linked_; }
  bool is_relative() const { return relative_; }
  bool is_mirrored() const { return mirrored_; }
  // The start pair of other band `c` (0..3); {-1, -1} when unset or c is this band.
  std::array<double, 2> get_limits(int c) const { return limits_[c]; }

  static int band_of(int param_index) { return (param_index - kFirstBandParam) / kParamsPerBand; }
  static int slot_of(int param_index);
  static int param_of(int band, int slot) { return kFirstBandParam + kParamsPerBand * band + slot; }

 private:
  guikit::ControlInterface* own_control() const;
  bool gesture_live() const;
  void take_limits();
  void release_linked();

  ParamControlFinderInterface* finder_;
  int index_;
  guikit::DefaultEventListener* owner_ = nullptr;
  bool busy_ = false;
  bool linked_ = false;
  bool relative_ = false;
  bool mirrored_ = false;
  std::array<std::array<double, 2>, kNbrBands> limits_;
};
