#include "dsp/curve_names.h"

namespace {

// Order is the curve numbering of the band processor.
const char* const kCurveNames[kNbrDistortionCurves] = {
    "Tube Sym 1", "Tube Sym 2",  "Tube Sym 3", "Tube Sym 4",  "Tube Asym 1", "Tube Asym 2", "Hardclip",
    "SmartE 1",   "SmartE 2",    "Puncher",    "Raphosaure", "Slew Rate 1", "Slew Rate 2",
};

}  // namespace

const char* distortion_curve_name(int index) {
  if (index < 0 || index >= kNbrDistortionCurves) {
    return "";
  }
  return kCurveNames[index];
}
