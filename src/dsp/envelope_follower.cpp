#include "dsp/envelope_follower.h"

#include <cmath>

namespace {
float time_coef(float seconds, float rate) {
  const double samples = double(seconds) * double(rate);
  if (samples < 1.0) return 1.0f;
  return float(1.0 - std::exp(-1.0 / samples));
}
}  // namespace

EnvelopeFollower::EnvelopeFollower() {
  compute_coefs();
  hold_counter_ = hold_length_;
}

void EnvelopeFollower::set_sample_rate(float rate) {
  sample_rate_ = rate;
  compute_coefs();
}

void EnvelopeFollower::set_attack(float seconds) {
  attack_ = seconds;
  compute_coefs();
}

void EnvelopeFollower::set_hold(float seconds) {
  hold_ = seconds;
  compute_coefs();
}

void EnvelopeFollower::set_release(float seconds) {
  release_ = seconds;
  compute_coefs();
}

void EnvelopeFollower::compute_coefs() {
  attack_coef_ = time_coef(attack_, sample_rate_);
  release_coef_ = time_coef(release_, sample_rate_);
  hold_length_ = int(std::floor(double(hold_) * double(sample_rate_) + 0.5));
}

void EnvelopeFollower::reset() {
  envelope_ = 0.0f;
  hold_counter_ = hold_length_;
}
