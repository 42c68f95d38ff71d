#pragma once

#include <array>
#include <atomic>
#include <string>

#include "dsp/band_splitter.h"
#include "dsp/feedback_line.h"
#include "dsp/first_order_section.h"
#include "dsp/freq_band.h"
#include "dsp/half_band_decimator.h"
#include "dsp/tone_filter.h"
#include "host/dsp_interface.h"
#include "midi/midi_receiver_interface.h"
#include "params/notifier.h"
#include "params/plugin_internal.h"

// The effect engine: mono mix, feedback, band split, per-band dynamics and
// distortion, sum, decimation, DC blocker, tone filter, one or two outputs.
class BrakmorphDsp : public plugcore::DspInterface,
                     public plugcore::NotifiedInterface,
                     public plugcore::NotifierInterface,
                     public plugcore::PluginInternal,
                     public plugcore::MidiReceiverInterface {
 public:
  static constexpr int kNbrBands = 4;
  static constexpr int kNbrParams = 40;
  static constexpr int kChunk = 256;

  BrakmorphDsp();
  ~BrakmorphDsp() override;

  // DspInterface.
  void init() override;
  void set_default_state() override;
  void close() override {}
  plugcore::HostDspInterface* get_host_dsp() override { return host_dsp_; }
  void set_host_dsp(plugcore::HostDspInterface* host_dsp) override;
  plugcore::GuiInterface* get_gui() override { return gui_; }
  void set_gui(plugcore::GuiInterface* gui) override { gui_ = gui; }
  int get_nbr_input_groups() override { return static_cast<int>(input_groups_.size()); }
  const plugcore::PinGroup& use_input_group(int index) override { return input_groups_[index]; }
  int get_nbr_output_groups() override { return static_cast<int>(output_groups_.size()); }
  const plugcore::PinGroup& use_output_group(int index) override { return output_groups_[index]; }
  int get_min_sample_rate() override { return 8000; }
  int get_max_sample_rate() override { return 384000; }
  void set_sample_rate(float rate) override;
  void unnamed_after_sample_rate(int value) override {}
  int get_nbr_param() override { return kNbrParams; }
  plugcore::NormalizedParamInterface& use_param(int index) override { return use_registered_param(index); }
  void set_program_name(const std::string& name) override { program_name_ = name; }
  std::string get_program_name() override { return program_name_; }
  void set_extra_control(int index, float norm) override {}
  double get_property_num(const char* key) override;
  std::string get_property_str(const char* key) override;
  void request_reset() override { reset_requested_.store(true, std::memory_order_relaxed); }
  void set_tempo(float bpm) override {}
  void unnamed_after_tempo() override {}
  void load_program(const plugcore::ProgramSlot& program) override;
  void store_program(plugcore::ProgramSlot& program) override;
  int process_replacing(float** outputs, float** inputs, int frames, int flag) override;
  int process_adding(float** outputs, float** inputs, int frames, int flag) override;

  // NotifiedInterface: parameters only raise flags; the work happens at block start.
  void notify(plugcore::NotifierInterface* notifier) override;

  // Called by the bands after their solo switches may have changed.
  void recompute_band_enabled();

  // Editor side: meters and clip lamp.
  void set_metering(bool on) { metering_on_.store(on, std::memory_order_relaxed); }
  void set_clip_detection(bool on);
  bool read_clip();
  float get_band_level(int band) const;

  // Views for tests.
  int get_band_count() const { return splitter_.get_band_count(); }
  bool is_band_enabled(int band) const { return band_enabled_[band].load(std::memory_order_relaxed); }
  const FreqBand& get_band(int band) const { return bands_[band]; }
  const FeedbackLine& get_feedback_line() const { return feedback_; }
  bool is_tone_active() const { return tone_.is_active(); }

 private:
  int process_block(float** outputs, float** inputs, int frames, bool adding);
  void update_params();
  void reset();
  void write_output(float** outputs, int pos, int n, bool second_output, bool adding);
  void detect_clip(int n);

  std::string program_name_;
  plugcore::HostDspInterface* host_dsp_ = nullptr;
  plugcore::GuiInterface* gui_ = nullptr;
  FeedbackLine feedback_;
  std::array<FreqBand, kNbrBands> bands_;
  alignas(16) float mono_input_[kChunk];
  alignas(16) float band_buffers_[kNbrBands][kChunk * 4];
  alignas(16) float feedback_mixed_[kChunk];
  std::atomic<bool> params_changed_{false};
  std::atomic<bool> reset_requested_{false};
  std::atomic<bool> split_changed_{true};
  std::atomic<bool> tone_changed_{true};
  std::atomic<bool> master_volume_changed_{true};
  std::atomic<bool> metering_on_{false};
  std::atomic<bool> clip_detection_on_{false};
  std::atomic<bool> clip_flag_{false};
  std::atomic<bool> clip_reset_requested_{false};
  float sample_rate_ = 44100.0f;
  FirstOrderSection dc_blocker_;
  BandSplitter splitter_;
  HalfBandDecimator decimator_1_;
  HalfBandDecimator decimator_2_;
  ToneFilter tone_;
  bool oversampling_on_ = false;
  bool stereo_boost_on_ = false;
  float stereo_delay_ = 0.0f;
  // Read by the editor's meters while blocks run.
  std::array<std::atomic<bool>, kNbrBands> band_enabled_{{true, true, true, true}};
  plugcore::NormalizedParamInterface* oversampling_param_ = nullptr;
  plugcore::NormalizedParamInterface* stereo_boost_param_ = nullptr;
  plugcore::NormalizedParamInterface* tone_freq_param_ = nullptr;
  plugcore::NormalizedParamInterface* tone_shape_param_ = nullptr;
  plugcore::NormalizedParamInterface* stereo_phase_param_ = nullptr;
  plugcore::NormalizedParamInterface* master_vol_param_ = nullptr;
  plugcore::NormalizedParamInterface* reserved_param_ = nullptr;
  std::array<plugcore::NormalizedParamInterface*, 3> split_params_{};
};
