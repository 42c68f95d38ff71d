#include "dsp/meter_ballistics.h"

#include <algorithm>
#include <cmath>

void MeterBallistics::set_sample_rate(float rate) {
  sample_rate_ = rate;
  sample_period_ = float(1.0 / double(rate));
  compute_hold_length();
}

void MeterBallistics::set_hold(float seconds) {
  hold_ = seconds;
  compute_hold_length();
}

void MeterBallistics::compute_hold_length() {
  hold_length_ = int(std::floor(double(hold_) * double(sample_rate_) + 0.5));
}

float MeterBallistics::update(float target, int count) {
  const float d = target - value_;
  if (d > 0.0f) {
    hold_counter_ = hold_length_;
    if (attack_ < sample_period_) {
      value_ = target;
    } else {
      const float k = float(1.0 - std::exp(-double(count) / (double(attack_) * double(sample_rate_))));
      value_ = value_ + d * k;
    }
    return value_;
  }
  if (hold_counter_ > 0) {
    const int m = std::min(count, hold_counter_);
    hold_counter_ -= m;
    count -= m;
  }
  if (hold_counter_ > 0) return value_;
  if (release_ < sample_period_) {
    value_ = target;
  } else {
    const float k = float(1.0 - std::exp(-double(count) / (double(release_) * double(sample_rate_))));
    value_ = value_ + d * k;
  }
  return value_;
}

void MeterBallistics::reset() {
  value_ = 0.0f;
  hold_counter_ = hold_length_;
}
