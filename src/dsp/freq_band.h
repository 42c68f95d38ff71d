#pragma once

#include <atomic>

#include "dsp/envelope_follower.h"
#include "dsp/meter_ballistics.h"
#include "dsp/rms_detector.h"
#include "params/notifier.h"

class BrakmorphDsp;
namespace plugcore {
class NormalizedParamInterface;
}

// One frequency band: drive, a dynamics stage from compression to expansion,
// optional four-times up-sampling, a distortion curve and the output gain.
class FreqBand : public plugcore::NotifiedInterface {
 public:
  FreqBand();
  ~FreqBand() override = default;

  void notify(plugcore::NotifierInterface* notifier) override;
  virtual void init(BrakmorphDsp* engine, int band_index);
  virtual void set_default_state();
  virtual void unnamed_op() {}
  virtual void set_sample_rate(float rate);
  virtual void reset();

  // Audio thread: picks up changed parameters at block start.
  void prepare();
  // Processes n samples in place; with oversampling the buffer then holds 4n.
  void process(float* buffer, int n, bool metering);
  void set_master_volume(float v);
  void set_oversampling(bool on);

  float get_level() const { return level_.load(std::memory_order_relaxed); }
  bool is_soloed() const { return soloed_.load(std::memory_order_relaxed); }

  // Read-only views for tests and the editor.
  float get_drive() const { return drive_; }
  float get_threshold() const { return threshold_; }
  float get_slope() const { return slope_; }
  float get_output_gain() const { return output_gain_; }
  float get_slew_step() const { return slew_step_; }
  int get_curve_index() const { return curve_index_; }
  float get_envelope() const { return follower_.get_envelope(); }

 private:
  void recompute();
  void apply_rate_settings();

  float sample_rate_ = 44100.0f;
  std::atomic<bool> params_changed_{false};
  float upsampler_memory_ = 0.0f;
  float drive_ = 0.0f;
  float threshold_ = 0.0f;
  float threshold_log_ = 0.0f;
  float slope_ = 0.0f;
  float curve_volume_ = 0.0f;
  float output_gain_ = 0.0f;
  float character_ = 0.5f;
  float intensity_ = 0.0f;
  float disto_amount_ = 1.0f;
  int curve_index_ = 0;
  float band_volume_ = 1.0f;
  float master_volume_ = 1.0f;
  bool oversampling_on_ = false;
  std::atomic<bool> soloed_{false};
  BrakmorphDsp* engine_ = nullptr;
  plugcore::NormalizedParamInterface* character_param_ = nullptr;
  plugcore::NormalizedParamInterface* intensity_param_ = nullptr;
  plugcore::NormalizedParamInterface* amount_param_ = nullptr;
  plugcore::NormalizedParamInterface* type_param_ = nullptr;
  plugcore::NormalizedParamInterface* volume_param_ = nullptr;
  plugcore::NormalizedParamInterface* solo_param_ = nullptr;
  plugcore::NormalizedParamInterface* reserved_param_ = nullptr;
  RmsDetector level_detector_;
  MeterBallistics meter_;
  std::atomic<float> level_{0.0f};
  EnvelopeFollower follower_;
  float slew_step_ = 0.0f;
  float slew_memory_ = 0.0f;
};
