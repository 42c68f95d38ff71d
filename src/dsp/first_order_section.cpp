#include "dsp/first_order_section.h"

#include <cmath>

namespace {
const double kPi = 3.14159265358979323846;
}

FirstOrderSection::FirstOrderSection() { compute_coefs(); }

void FirstOrderSection::set_prototype(float n0, float n1, float d0, float d1) {
  n0_ = n0;
  n1_ = n1;
  d0_ = d0;
  d1_ = d1;
}

void FirstOrderSection::compute_coefs() {
  const double k = 1.0 / std::tan(kPi * double(frequency_) / double(sample_rate_));
  const double n0 = n0_, n1 = n1_, d0 = d0_, d1 = d1_;
  const double e = d0 + d1 * k;
  b0_ = float((n0 + n1 * k) / e);
  b1_ = float((n0 - n1 * k) / e);
  a0_ = 1.0f;
  a1_ = float((d0 - d1 * k) / e);
}

void FirstOrderSection::set_high_pass() {
  set_prototype(g_, 1.0f, 1.0f, 1.0f);
  compute_coefs();
}

void FirstOrderSection::process(const float* in, float* out, int count) {
  float x1 = x1_;
  float y1 = y1_;
  for (int i = 0; i < count; ++i) {
    const float x = in[i];
    const float y = b0_ * x + b1_ * x1 - a1_ * y1;
    x1 = x;
    y1 = y;
    out[i] = y;
  }
  x1_ = x1;
  y1_ = y1;
}

void FirstOrderSection::reset() {
  x1_ = 0.0f;
  y1_ = 0.0f;
}
