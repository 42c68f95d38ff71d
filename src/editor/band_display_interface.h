#pragma once

// What the band-split listeners ask of the editor: show or hide band 1, 2 or 3
// (counted from 0; band 0 is always shown). Hiding a band takes its VU needle,
// knobs and flip-flops out of the control group and puts the band's tip page in
// place of its background; showing undoes that. Called on every change of a
// split, so a call that does not change the band's state must do nothing.
class BandDisplayInterface {
 public:
  virtual ~BandDisplayInterface() = default;
  virtual void show_band(int band, bool shown) = 0;
};
