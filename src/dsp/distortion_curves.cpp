#include "dsp/distortion_curves.h"

#include <cmath>

namespace {

const double kPi = 3.14159265358979323846;

double curve_tube_sym1(double x) { return (2.0 / kPi) * std::atan(kPi * x / 2.0); }

double curve_tube_sym2(double x) { return x / (1.0 + std::fabs(x)); }

double curve_tube_sym3(double x) {
  const double s = x > 0.0 ? 1.0 : (x < 0.0 ? -1.0 : 0.0);
  return s * std::log(1.0 + std::fabs(x));
}

double curve_tube_sym4(double x) {
  if (x >= 0.0) return 1.0 - std::cos(x) * std::exp(-x);
  return std::exp(x) * std::cos(x) - 1.0;
}

double curve_tube_asym1(double x) {
  const double k = 1.0 + std::exp(-0.75 * std::sqrt(std::fabs(x)));
  return (std::exp(x) - std::exp(-k * x)) / (std::exp(x) + std::exp(-x));
}

double curve_tube_asym2(double x) {
  return (std::exp(x - 1.0) - std::exp(-x) + 1.0 - std::exp(-1.0)) / (std::exp(x - 1.0) + std::exp(-x));
}

double curve_puncher(double x) { return std::sin(x); }

double sinc(double u) {
  if (u == 0.0) return 1.0;
  return std::sin(kPi * u) / (kPi * u);
}

double curve_raphosaure(double x) {
  if (x < 0.0) return (std::exp(x) - 1.0) - sinc(x + 3.0);
  return (1.0 - std::exp(-x)) + sinc(x - 3.0);
}

struct CurveTables {
  ShaperTable tube_sym1{curve_tube_sym1, 32};
  ShaperTable tube_sym2{curve_tube_sym2, 16};
  ShaperTable tube_sym3{curve_tube_sym3, 32};
  ShaperTable tube_sym4{curve_tube_sym4, 16};
  ShaperTable tube_asym1{curve_tube_asym1, 7};
  ShaperTable tube_asym2{curve_tube_asym2, 8};
  ShaperTable puncher{curve_puncher, 4};
  ShaperTable raphosaure{curve_raphosaure, 32};
  const ShaperTable* by_curve[kCurveCount];

  CurveTables()
      : by_curve{&tube_sym1, &tube_sym2, &tube_sym3, &tube_sym4, &tube_asym1, &tube_asym2, nullptr,
                 nullptr,    nullptr,    &puncher,   &raphosaure, &tube_sym1, &tube_sym1} {}
};

const CurveTables& tables() {
  static const CurveTables instance;  // initialised once, thread-safe
  return instance;
}

int clamp_curve(int curve) {
  if (curve < 0) return 0;
  if (curve >= kCurveCount) return kCurveCount - 1;
  return curve;
}

float slew_limit(float v, float step, float& memory) {
  if (std::fabs(v - memory) >= step) v = v <= memory ? memory - step : memory + step;
  memory = v;
  return v;
}

void apply_table(const ShaperTable& table, float* buf, int count, float gain) {
  for (int i = 0; i < count; ++i) buf[i] = table.lookup(buf[i]) * gain;
}

void apply_hardclip(float* buf, int count, float gain) {
  for (int i = 0; i < count; ++i) {
    float x = buf[i];
    x = x < -1.0f ? -1.0f : (x > 1.0f ? 1.0f : x);
    buf[i] = x * gain;
  }
}

void apply_smart1(float* buf, int count, float gain) {
  for (int i = 0; i < count; ++i) {
    const float x = buf[i];
    const float a = std::fabs(x);
    buf[i] = x * (a + 0.5f) * gain / (x * x - 0.5f * a + 1.0f);
  }
}

void apply_smart2(float* buf, int count, float gain) {
  for (int i = 0; i < count; ++i) {
    const float x = buf[i];
    const float a = std::fabs(x);
    buf[i] = x * (a - 0.5f) * gain / (x * x - 1.5f * a + 1.0f);
  }
}

// The tables exist before any audio runs.
const bool kTablesReady = (tables(), true);

}  // namespace

const float kCurveDriveFactor[kCurveCount] = {1.0f, 1.0f, 1.0f, 1.0f, 1.0f, 1.25f, 1.25f,
                                              1.0f, 1.0f, 1.0f, 1.0f, 1.0f, 1.0f};
const float kCurveOutputFactor[kCurveCount] = {1.0f, 1.0f, 1.0f, 1.0f, 1.0f, 0.8f, 0.8f,
                                               1.0f, 1.0f, 1.0f, 1.0f, 1.0f, 1.0f};

float curve_drive_factor(int curve) { return kCurveDriveFactor[clamp_curve(curve)]; }

float curve_output_factor(int curve) { return kCurveOutputFactor[clamp_curve(curve)]; }

const ShaperTable* curve_table(int curve) { return tables().by_curve[clamp_curve(curve)]; }

void prepare_curve_tables() { (void)kTablesReady; tables(); }

void apply_curve(int curve, float* buf, int count, float gain, float slew_step, float& slew_memory) {
  const CurveTables& t = tables();
  curve = clamp_curve(curve);
  switch (curve) {
    case kCurveHardclip:
      apply_hardclip(buf, count, gain);
      break;
    case kCurveSmartE1:
      apply_smart1(buf, count, gain);
      break;
    case kCurveSmartE2:
      apply_smart2(buf, count, gain);
      break;
    case kCurveSlewRate1: {
      float memory = slew_memory;
      for (int i = 0; i < count; ++i) buf[i] = slew_limit(t.tube_sym1.lookup(buf[i]), slew_step, memory) * gain;
      slew_memory = memory;
      break;
    }
    case kCurveSlewRate2: {
      float memory = slew_memory;
      for (int i = 0; i < count; ++i) buf[i] = t.tube_sym1.lookup(slew_limit(buf[i], slew_step, memory)) * gain;
      slew_memory = memory;
      break;
    }
    default:
      apply_table(*t.by_curve[curve], buf, count, gain);
      break;
  }
}
