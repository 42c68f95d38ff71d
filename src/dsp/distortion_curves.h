#pragma once

#include "dsp/shaper_table.h"

// The thirteen distortion curves of a band, by index.
enum DistortionCurve {
  kCurveTubeSym1 = 0,
  kCurveTubeSym2 = 1,
  kCurveTubeSym3 = 2,
  kCurveTubeSym4 = 3,
  kCurveTubeAsym1 = 4,
  kCurveTubeAsym2 = 5,
  kCurveHardclip = 6,
  kCurveSmartE1 = 7,
  kCurveSmartE2 = 8,
  kCurvePuncher = 9,
  kCurveRaphosaure = 10,
  kCurveSlewRate1 = 11,
  kCurveSlewRate2 = 12,
  kCurveCount = 13
};

// Gain applied before the curve and factor applied after it, by curve.
extern const float kCurveDriveFactor[kCurveCount];
extern const float kCurveOutputFactor[kCurveCount];

// The same, with indices outside 0..12 clamped.
float curve_drive_factor(int curve);
float curve_output_factor(int curve);

// The shared table behind a tabulated curve (the slew curves share curve 0's),
// or nullptr for the directly computed ones. Built once, on first use, safely
// from any thread.
const ShaperTable* curve_table(int curve);

// Builds every shared table now (it also happens while the module loads), so
// that the audio thread never does.
void prepare_curve_tables();

// Each sample x becomes curve(x) * gain. The slew curves limit the change per
// sample to slew_step, carrying their last value in slew_memory across calls.
// Indices outside 0..12 are clamped.
void apply_curve(int curve, float* buf, int count, float gain, float slew_step, float& slew_memory);
