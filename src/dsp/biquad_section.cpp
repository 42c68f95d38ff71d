#include "dsp/biquad_section.h"

#include <cmath>

namespace {
const double kPi = 3.14159265358979323846;
const float kDenormalOffset = 1e-20f;
}  // namespace

void BiquadSection::set_prototype(float n0, float n1, float n2, float d0, float d1, float d2) {
  n0_ = n0;
  n1_ = n1;
  n2_ = n2;
  d0_ = d0;
  d1_ = d1;
  d2_ = d2;
}

void BiquadSection::compute_coefs() {
  const double k = 1.0 / std::tan(kPi * double(frequency_) / double(sample_rate_));
  const double kk = k * k;
  const double n0 = n0_, n1 = n1_, n2 = n2_, d0 = d0_, d1 = d1_, d2 = d2_;
  const double s = d0 + d1 * k + d2 * kk;
  b0_ = float((n0 + n1 * k + n2 * kk) / s);
  b1_ = float(2.0 * (n0 - n2 * kk) / s);
  b2_ = float((n0 - n1 * k + n2 * kk) / s);
  a0_ = 1.0f;
  a1_ = float(2.0 * (d0 - d2 * kk) / s);
  a2_ = float((d0 - d1 * k + d2 * kk) / s);
}

void BiquadSection::process(const float* in, float* out, int count) {
  for (int i = 0; i < count; ++i) out[i] = step(in[i]);
}

void BiquadSection::process_offset(const float* in, float* out, int count) {
  int i = 0;
  // The offset goes to the sample processed while slot 0 is the newer one,
  // so the pattern continues across calls.
  if (ring_ != 0 && count > 0) {
    out[0] = step(in[0]);
    i = 1;
  }
  for (; i + 1 < count; i += 2) {
    out[i] = step_offset(in[i], kDenormalOffset);
    out[i + 1] = step(in[i + 1]);
  }
  if (i < count) out[i] = step(in[i]);
}

void BiquadSection::reset() {
  x_[0] = x_[1] = 0.0f;
  y_[0] = y_[1] = 0.0f;
  ring_ = 0;
}

TypedBiquadSection::TypedBiquadSection() {
  set_type_coefs();
  compute_coefs();
}

void TypedBiquadSection::set_type_coefs() {
  const double p = p_;
  const double q = q_;
  switch (type_) {
    case kLowPass:
      set_prototype(1.0f, 0.0f, 0.0f, 1.0f, float(1.0 / p), 1.0f);
      break;
    case kHighPass:
      set_prototype(0.0f, 0.0f, 1.0f, 1.0f, float(1.0 / p), 1.0f);
      break;
    case kPeaking:
      set_prototype(1.0f, float(p / q), 1.0f, 1.0f, float(1.0 / q), 1.0f);
      break;
    case kBandPass:
      set_prototype(0.0f, float(p / q), 0.0f, 1.0f, float(1.0 / q), 1.0f);
      break;
    default:
      // Unknown type: keep a well-formed denominator, leave the rest.
      d0_ = 1.0f;
      d2_ = 1.0f;
      break;
  }
}
