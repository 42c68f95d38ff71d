#pragma once

#include <array>
#include <memory>
#include <vector>

#include "editor/band_display_interface.h"
#include "editor/band_splt_listener.h"
#include "editor/diode_listener.h"
#include "editor/fading_diode.h"
#include "editor/gui_part.h"
#include "editor/peak_listener.h"
#include "editor/rc_mgr.h"
#include "editor/skin_needle.h"
#include "editor/vu_meter_listener.h"
#include "guikit/diode.h"
#include "guikit/fader.h"
#include "guikit/knob.h"
#include "guikit/push_button.h"
#include "guikit/text_box.h"
#include "params/num_param_listener.h"

class EditorTrees;

// The master column, the three band-split sliders and the four bands: every
// sound control of the editor, bound to its parameter.
class GuiMaster : public GuiPart, public BandDisplayInterface {
 public:
  static constexpr int kNbrBands = 4;
  static constexpr int kNbrSplits = 3;
  static constexpr int kNbrMasterKnobs = 6;
  static constexpr int kFirstBandParam = 12;
  static constexpr int kBandParamStride = 7;

  explicit GuiMaster(BrakmorphGui& gui);
  ~GuiMaster() override;

  // Creates, sets up, places and binds the controls; all bands start shown.
  void build(EditorTrees& trees);

  // Bands 1..3 can be switched off: their controls leave the band's group and
  // the tip page takes the place of the band's page. Band 0 is always shown.
  void show_band(int band, bool shown) override;
  bool is_band_shown(int band) const { return band_shown_[static_cast<size_t>(band)]; }

  guikit::Knob& band_knob(int band, int slot) { return bands_[static_cast<size_t>(band)].knobs[static_cast<size_t>(slot)]; }
  guikit::Fader& split(int k) { return splits_[static_cast<size_t>(k)]; }
  SkinNeedle& needle(int band) { return bands_[static_cast<size_t>(band)].needle; }
  FadingDiode& clip_diode() { return clip_; }
  VuMeterListener& meter_listener(int band) { return meters_[static_cast<size_t>(band)]; }
  RcMgr& band_link(int band, int slot) { return *links_[static_cast<size_t>(band * kLinkedSlots + slot)]; }
  guikit::FlipFlop& lamp(int k) { return lamps_[static_cast<size_t>(k)]; }

 private:
  // Knob slots of a band in parameter order: Character, Intensity, Dist Amnt, Dist Type, Volume.
  static constexpr int kBandKnobs = 5;
  // Character, Intensity, Dist Amnt, Dist Type, Volume and Solo are linked across bands.
  static constexpr int kLinkedSlots = 6;
  struct Band {
    std::array<guikit::Knob, kBandKnobs> knobs;
    guikit::FlipFlop solo;
    SkinNeedle needle;
  };

  void setup_knob(guikit::Knob& knob);
  void setup_flip_flop(guikit::FlipFlop& ff, const char* stem, guikit::Point placement, double transition);
  void bind(int index, guikit::ControlInterface& control);
  void build_master(EditorTrees& trees);
  void build_splits(EditorTrees& trees);
  void build_band(EditorTrees& trees, int band);
  // The band's controls in the order they go into its group.
  std::vector<guikit::ControlInterface*> band_controls(int band);

  EditorTrees* trees_ = nullptr;
  guikit::FlipFlop stereo_boost_;
  guikit::FlipFlop oversampling_;
  std::array<guikit::Knob, kNbrMasterKnobs> master_knobs_;
  guikit::FlipFlop reserved_;  // bound, never placed
  std::array<guikit::FlipFlop, 3> lamps_;
  FadingDiode clip_;
  std::array<guikit::Fader, kNbrSplits> splits_;
  std::array<Band, kNbrBands> bands_;
  std::array<bool, kNbrBands> band_shown_{{true, true, true, true}};
  std::vector<double> dist_type_magnets_;
  std::array<plugcore::NumParamListener, 40> listeners_;  // all but the splits
  std::array<BandSpltListener, kNbrSplits> split_listeners_{{BandSpltListener(0), BandSpltListener(1), BandSpltListener(2)}};
  std::array<DiodeListener, 3> lamp_listeners_;
  PeakListener peak_;
  std::array<VuMeterListener, kNbrBands> meters_;
  std::vector<std::unique_ptr<RcMgr>> links_;
};
