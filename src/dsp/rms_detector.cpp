#include "dsp/rms_detector.h"

#include <cmath>

namespace {
const double kPi = 3.14159265358979323846;
}

RmsDetector::RmsDetector() {
  compute_coefs();
  reset();
}

void RmsDetector::set_sample_rate(float rate) {
  sample_rate_ = rate;
  compute_coefs();
}

void RmsDetector::set_time(float seconds) {
  time_ = seconds;
  compute_coefs();
}

void RmsDetector::compute_coefs() {
  const double k = 1.0 / std::tan(kPi / (double(sample_rate_) * double(time_)));
  const double b = 1.0 / (1.0 + k);
  b_ = float(b);
  a_ = float((1.0 - k) * b);
}

float RmsDetector::process(const float* in, int count) {
  for (int i = 0; i < count; ++i) step_mean_square(in[i]);
  return std::sqrt(std::fabs(y_));
}

void RmsDetector::reset() {
  p_ = 0.0f;
  y_ = 0.0f;
}
