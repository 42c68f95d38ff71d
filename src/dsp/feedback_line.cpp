#include "dsp/feedback_line.h"

#include <algorithm>
#include <cmath>
#include <memory>

#include "dsp/brakmorph_dsp.h"
#include "dsp/effect_params.h"
#include "dsp/ring_cursor.h"
#include "params/param_round.h"

namespace {

constexpr int kMaxChunk = 256;


}  // namespace

FeedbackLine::FeedbackLine() {
  input_detector_.set_time(0.03f);
  feedback_detector_.set_time(0.03f);
  high_pass_.set_frequency(80.0f);
  high_pass_.set_dc_gain(0.0f);
  high_pass_.set_high_pass();
  set_sample_rate(44100.0f);
  feedback_delay_ = 441;
  stereo_delay_samples_ = 0;
}

void FeedbackLine::init(BrakmorphDsp* engine) {
  auto amount = std::make_shared<ParamFeedbackAmount>();
  auto pitch = std::make_shared<ParamFeedbackPitch>();
  pitch->init(256.0, 0);
  amount->init(0.0, 0);
  amount->set_notified(this);
  pitch->set_notified(this);
  engine->add_param(amount);
  engine->add_param(pitch);
  amount_param_ = amount.get();
  pitch_param_ = pitch.get();
}

void FeedbackLine::set_default_state() {
  pitch_param_->set_value_and_notify(256.0);
  amount_param_->set_value_and_notify(0.0);
  clear_state();
}

void FeedbackLine::notify(plugcore::NotifierInterface* notifier) {
  params_changed_.store(true, std::memory_order_relaxed);
}

void FeedbackLine::prepare() {
  if (!params_changed_.exchange(false, std::memory_order_relaxed)) {
    return;
  }
  amount_ = static_cast<float>(amount_param_->get_value());
  feedback_gain_ = static_cast<float>((std::pow(16.0, static_cast<double>(amount_)) - 1.0) / 15.0);
  coefficients_changed_ = true;
  period_ = static_cast<float>(1.0 / pitch_param_->get_value());
  feedback_delay_ = plugcore::round_half_up_int(static_cast<double>(period_) * sample_rate_);
  recompute_longest_chunk();
}

void FeedbackLine::recompute_longest_chunk() {
  longest_chunk_ = kMaxChunk;
  if (amount_ > 1e-9f) {
    // A chunk never reads delay-line samples that it writes itself.
    longest_chunk_ = std::max(1, std::min(feedback_delay_, kMaxChunk));
  }
}

void FeedbackLine::set_sample_rate(float rate) {
  sample_rate_ = rate;
  input_detector_.set_sample_rate(rate);
  feedback_detector_.set_sample_rate(rate);
  const int needed = plugcore::round_half_up_int(rate / 16.0) + kMaxChunk;
  if (needed > buffer_length_) {
    int length = 1;
    while (length < needed) {
      length *= 2;
    }
    buffer_length_ = length;
    buffer_.resize(static_cast<size_t>(length), 0.0f);
    mask_ = length - 1;
  }
  feedback_delay_ = plugcore::round_half_up_int(static_cast<double>(period_) * rate);
  stereo_delay_samples_ = plugcore::round_half_up_int(static_cast<double>(stereo_delay_) * rate);
  high_pass_.set_sample_rate(rate);
  high_pass_.set_high_pass();
  coefficients_changed_ = true;
  clear_state();
}

void FeedbackLine::set_master_volume(float v) {
  coefficients_changed_ = true;
  inverse_master_volume_ = std::fabs(v) < 1e-9f ? 0.0f : 1.0f / v;
}

void FeedbackLine::set_stereo_delay(float seconds) {
  stereo_delay_ = seconds;
  stereo_delay_samples_ = plugcore::round_half_up_int(static_cast<double>(seconds) * sample_rate_);
}

void FeedbackLine::reset() { clear_state(); }

void FeedbackLine::clear_state() {
  std::fill(buffer_.begin(), buffer_.end(), 0.0f);
  write_position_ = 0;
  input_detector_.reset();
  feedback_detector_.reset();
  x1_ = 0.0f;
  y1_ = 0.0f;
  high_pass_.reset();
}

void FeedbackLine::mix_input(float* destination, const float* source, int n) {
  if (coefficients_changed_) {
    coefficients_changed_ = false;
    // The band outputs carry the master volume: take it out of the loop and apply
    // the feedback gain in the filter.
    const float scale = inverse_master_volume_ * feedback_gain_;
    b0_ = high_pass_.b0() * scale;
    b1_ = high_pass_.b1() * scale;
    a1_ = high_pass_.a1();
  }
  RingCursor cursor;
  cursor.start(buffer_length_, (write_position_ - feedback_delay_) & mask_, n);
  int i = 0;
  for (; !cursor.done(); cursor.next()) {
    const float* run = buffer_.data() + cursor.position();
    for (int k = 0; k < cursor.run_length(); ++k, ++i) {
      const float x = source[i];
      const float p_in = std::fabs(input_detector_.step_mean_square(x));
      const float s = run[k];
      const float f = b0_ * s + b1_ * x1_ - a1_ * y1_;
      x1_ = s;
      y1_ = f;
      const float p_fb = std::fabs(feedback_detector_.step_mean_square(f));
      if (p_in < 1e-9f) {
        destination[i] = x - f;
      } else {
        const float q = std::min(0.5f * std::sqrt(p_fb / p_in), 1.0f);
        destination[i] = x - q * f;
      }
    }
  }
}

void FeedbackLine::write(const float* source, int n) {
  RingCursor cursor;
  cursor.start(buffer_length_, write_position_, n);
  int i = 0;
  for (; !cursor.done(); cursor.next()) {
    float* run = buffer_.data() + cursor.position();
    for (int k = 0; k < cursor.run_length(); ++k) {
      run[k] = source[i++];
    }
  }
}

void FeedbackLine::read_stereo(float* destination, int n) {
  RingCursor cursor;
  cursor.start(buffer_length_, (write_position_ - stereo_delay_samples_) & mask_, n);
  int i = 0;
  for (; !cursor.done(); cursor.next()) {
    const float* run = buffer_.data() + cursor.position();
    for (int k = 0; k < cursor.run_length(); ++k) {
      destination[i++] = -run[k];
    }
  }
}

void FeedbackLine::advance(int n) { write_position_ = (write_position_ + n) & mask_; }
