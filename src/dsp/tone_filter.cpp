#include "dsp/tone_filter.h"

#include <cmath>

namespace {
const double kPi = 3.14159265358979323846;
}

void ToneFilter::recompute(float tone_freq, float shape, float sample_rate) {
  const float c = shape;
  const float f_max = 0.475f * sample_rate;
  const bool was_active = active_;
  active_ = tone_freq < f_max && std::fabs(c) >= 1e-9f;
  if (!active_) return;

  double g, h, w;
  if (c > 0.5f) {
    g = std::pow(2.0, 2.0 * double(c) - 1.0);
    h = 0.0;
    w = 1.0;
  } else {
    g = 1.0;
    h = std::pow(std::pow(10.0, -4.0 * double(c)), 1.0 / 8.0);
    w = 2.0 * double(c);
  }
  const double a = std::pow(g, -0.25);
  const double theta = (kPi / 16.0) * w;
  for (int j = 0; j < kSectionCount; ++j) {
    const int k = 2 * j + 1;
    const double b = 2.0 * a * std::cos(k * theta);
    BiquadSection& s = sections_[j];
    s.set_prototype(1.0f, float(h * b), float(h * h), 1.0f, float(b), 1.0f);
    s.set_sample_rate(sample_rate);
    s.set_frequency(tone_freq);
    s.compute_coefs();
    if (!was_active) s.reset();
  }
}

void ToneFilter::process(float* buf, int n) {
  if (!active_) return;
  for (int j = 0; j < kSectionCount; ++j) sections_[j].process(buf, buf, n);
}

void ToneFilter::reset() {
  for (int j = 0; j < kSectionCount; ++j) sections_[j].reset();
}
