#pragma once

#include <atomic>
#include <vector>

#include "dsp/first_order_section.h"
#include "dsp/rms_detector.h"
#include "params/notifier.h"

class BrakmorphDsp;
namespace plugcore {
class NormalizedParamInterface;
}

// A history of the engine's output in a power-of-two ring that serves the tuned
// feedback path and the delayed, inverted stereo-boost channel.
class FeedbackLine : public plugcore::NotifiedInterface {
 public:
  FeedbackLine();
  ~FeedbackLine() override = default;

  void notify(plugcore::NotifierInterface* notifier) override;
  virtual void unnamed_op() {}

  void init(BrakmorphDsp* engine);
  void set_default_state();
  void prepare();
  int get_max_chunk() const { return longest_chunk_; }
  bool is_active() const { return amount_ > 1e-9f; }
  void set_sample_rate(float rate);
  void set_master_volume(float v);
  void set_stereo_delay(float seconds);
  void recompute_longest_chunk();
  void reset();

  void mix_input(float* destination, const float* source, int n);
  void write(const float* source, int n);
  void read_stereo(float* destination, int n);
  void advance(int n);

  // Views for tests.
  int get_feedback_delay() const { return feedback_delay_; }
  int get_stereo_delay_samples() const { return stereo_delay_samples_; }
  int get_buffer_length() const { return buffer_length_; }
  float get_feedback_gain() const { return feedback_gain_; }

 private:
  void clear_state();

  std::atomic<bool> params_changed_{false};
  std::vector<float> buffer_;
  int buffer_length_ = 0;
  int mask_ = 0;
  int write_position_ = 0;
  int feedback_delay_ = 441;
  int stereo_delay_samples_ = 0;
  float feedback_gain_ = 0.0f;
  float inverse_master_volume_ = 1.0f;
  float sample_rate_ = 44100.0f;
  float period_ = 0.01f;
  float stereo_delay_ = 0.0f;
  int longest_chunk_ = 256;
  bool coefficients_changed_ = true;
  RmsDetector input_detector_;
  RmsDetector feedback_detector_;
  FirstOrderSection high_pass_;
  float b0_ = 0.0f, b1_ = 0.0f, a1_ = 0.0f, x1_ = 0.0f, y1_ = 0.0f;
  float amount_ = 0.0f;
  plugcore::NormalizedParamInterface* amount_param_ = nullptr;
  plugcore::NormalizedParamInterface* pitch_param_ = nullptr;
};
