#include "dsp/freq_band.h"

#include <algorithm>
#include <cmath>
#include <memory>

#include "dsp/brakmorph_dsp.h"
#include "dsp/distortion_curves.h"
#include "dsp/effect_params.h"
#include "dsp/fast_math.h"
#include "params/param_round.h"
#include "params/param_reserved.h"

namespace {

template <class Param>
plugcore::NormalizedParamInterface* add_band_param(BrakmorphDsp* engine, FreqBand* band, int number,
                                                   double default_value) {
  auto param = std::make_shared<Param>();
  param->init(default_value, 0, number);
  param->set_notified(band);
  engine->add_param(param);
  return param.get();
}

}  // namespace

FreqBand::FreqBand() {
  level_detector_.set_time(0.03f);
  meter_.set_attack(0.0f);
  meter_.set_hold(0.0f);
  meter_.set_release(0.25f);
  follower_.set_hold(0.0f);
}

void FreqBand::init(BrakmorphDsp* engine, int band_index) {
  engine_ = engine;
  character_param_ = add_band_param<ParamCharacter>(engine, this, band_index, 0.5);
  intensity_param_ = add_band_param<ParamIntensity>(engine, this, band_index, 0.0);
  amount_param_ = add_band_param<ParamDistoAmount>(engine, this, band_index, 1.0);
  type_param_ = add_band_param<ParamDistoType>(engine, this, band_index, 0.0);
  volume_param_ = add_band_param<ParamBandVolume>(engine, this, band_index, 1.0);
  solo_param_ = add_band_param<ParamSolo>(engine, this, band_index, 0.0);
  auto reserved = std::make_shared<plugcore::ParamReserved>();
  reserved->init(0.0, 0);
  reserved->set_notified(this);
  engine->add_param(reserved);
  reserved_param_ = reserved.get();
  recompute();
  apply_rate_settings();
  reset();
}

void FreqBand::set_default_state() {
  character_param_->set_value_and_notify(0.5);
  intensity_param_->set_value_and_notify(0.0);
  amount_param_->set_value_and_notify(1.0);
  type_param_->set_value_and_notify(0.0);
  volume_param_->set_value_and_notify(1.0);
  solo_param_->set_value_and_notify(0.0);
  reserved_param_->set_value_and_notify(0.0);
}

void FreqBand::notify(plugcore::NotifierInterface* notifier) { params_changed_.store(true, std::memory_order_relaxed); }

void FreqBand::prepare() {
  if (params_changed_.load(std::memory_order_relaxed)) {
    recompute();
    engine_->recompute_band_enabled();
  }
}

void FreqBand::recompute() {
  params_changed_.store(false, std::memory_order_relaxed);
  character_ = static_cast<float>(character_param_->get_value());
  intensity_ = static_cast<float>(intensity_param_->get_value());
  disto_amount_ = static_cast<float>(amount_param_->get_value());
  curve_index_ = std::min(std::max(plugcore::round_half_up_int(type_param_->get_value()), 0), kCurveCount - 1);
  band_volume_ = static_cast<float>(volume_param_->get_value());
  soloed_.store(plugcore::round_half_up_int(solo_param_->get_value()) == 1, std::memory_order_relaxed);
  if (engine_ != nullptr) {
    engine_->recompute_band_enabled();
  }

  const double c = character_;
  const double i = intensity_;
  const double b = c < 0.5 ? std::exp2(8.0 * c - 4.0) : std::exp2(2.0 * c - 1.0);
  const double intensity_curve = i < 0.5 ? 0.5 * i : 1.5 * i - 0.5;
  const double r = std::exp2(-8.0 * intensity_curve);

  follower_.set_attack(0.0005f);
  follower_.set_release(static_cast<float>(std::exp2(-4.0 * c) / 4.0));

  slope_ = static_cast<float>((b - 1.0) / 2.0);
  const double m = std::min(b, std::sqrt(b));
  const float previous_drive = drive_;
  drive_ = static_cast<float>(std::pow(r, m - 1.0) * disto_amount_ * kCurveDriveFactor[curve_index_]);
  const double threshold_amplitude = static_cast<double>(drive_) * r;
  threshold_ = static_cast<float>(threshold_amplitude * threshold_amplitude);
  threshold_log_ = fast_log2(threshold_);
  curve_volume_ = kCurveOutputFactor[curve_index_] * band_volume_;
  if (drive_ != previous_drive && previous_drive > 0.0f) {
    // Keep the follower's envelope in step with the new drive so the gain does not jump.
    follower_.scale_envelope(drive_ / previous_drive);
  }
  output_gain_ = master_volume_ * curve_volume_;
}

void FreqBand::set_master_volume(float v) {
  master_volume_ = v;
  output_gain_ = v * curve_volume_;
}

void FreqBand::set_oversampling(bool on) {
  if (on != oversampling_on_) {
    oversampling_on_ = on;
    apply_rate_settings();
  }
}

void FreqBand::set_sample_rate(float rate) {
  sample_rate_ = rate;
  follower_.set_sample_rate(rate);
  recompute();
  apply_rate_settings();
}

void FreqBand::apply_rate_settings() {
  const float r = oversampling_on_ ? sample_rate_ * 4.0f : sample_rate_;
  slew_step_ = 1000.0f / r;
  level_detector_.set_sample_rate(r);
  meter_.set_sample_rate(r);
}

void FreqBand::reset() {
  upsampler_memory_ = 0.0f;
  level_detector_.reset();
  meter_.reset();
  follower_.reset();
  slew_memory_ = 0.0f;
}

void FreqBand::process(float* buffer, int n, bool metering) {
  const float drive = drive_;
  const float threshold = threshold_;
  const float threshold_log = threshold_log_;
  const float slope = slope_;
  for (int i = 0; i < n; ++i) {
    float x = buffer[i] * drive;
    const float env = follower_.step(x * x);
    if (env > threshold) {
      x *= fast_exp2((fast_log2(env) - threshold_log) * slope);
    }
    buffer[i] = x;
  }

  int count = n;
  if (oversampling_on_ && n > 0) {
    // Linear interpolation to four times the rate, from the end backwards so it works in place.
    const float last = buffer[n - 1];
    for (int j = n - 1; j >= 0; --j) {
      const float current = buffer[j];
      const float previous = j > 0 ? buffer[j - 1] : upsampler_memory_;
      const float step = current - previous;
      buffer[4 * j + 3] = previous + 0.75f * step;
      buffer[4 * j + 2] = previous + 0.5f * step;
      buffer[4 * j + 1] = previous + 0.25f * step;
      buffer[4 * j] = previous;
    }
    upsampler_memory_ = last;
    count = 4 * n;
  }

  apply_curve(curve_index_, buffer, count, output_gain_, slew_step_, slew_memory_);

  if (metering && count > 0) {
    level_.store(meter_.update(level_detector_.process(buffer, count), count), std::memory_order_relaxed);
  }
}
