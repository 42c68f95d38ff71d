#include "dsp/brakmorph_dsp.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <memory>

#include "dsp/effect_params.h"
#include "host/host_dsp_interface.h"
#include "midi/midi_controller_key.h"
#include "midi/midi_mgr.h"
#include "params/param_reserved.h"
#include "params/pin_group.h"
#include "presets/program_slot.h"

namespace {

template <class Param>
plugcore::NormalizedParamInterface* add_global(BrakmorphDsp& engine, double default_value, int priority) {
  auto param = std::make_shared<Param>();
  param->init(default_value, priority);
  param->set_notified(&engine);
  engine.add_param(param);
  return param.get();
}

// Sum of x·0 over a buffer: 0 for finite samples, NaN as soon as one is not.
bool all_finite(const float* x, int n) {
  float probe = 0.0f;
  for (int i = 0; i < n; ++i) {
    probe += x[i] * 0.0f;
  }
  return probe == 0.0f;
}

}  // namespace

BrakmorphDsp::BrakmorphDsp() {
  add_input_group(plugcore::PinGroup{"Input", {"Left input", "Right input"}});
  add_output_group(plugcore::PinGroup{"Output", {"Left output", "Right output"}});
  std::memset(mono_input_, 0, sizeof(mono_input_));
  std::memset(band_buffers_, 0, sizeof(band_buffers_));
  std::memset(feedback_mixed_, 0, sizeof(feedback_mixed_));
}

BrakmorphDsp::~BrakmorphDsp() { delete host_dsp_; }

void BrakmorphDsp::set_host_dsp(plugcore::HostDspInterface* host_dsp) {
  if (host_dsp_ != host_dsp) {
    delete host_dsp_;
  }
  host_dsp_ = host_dsp;
}

void BrakmorphDsp::init() {
  if (host_dsp_ != nullptr) {
    host_dsp_->init();
  }
  dc_blocker_.set_frequency(10.0f);
  dc_blocker_.set_dc_gain(0.0f);
  dc_blocker_.set_high_pass();
  decimator_1_.set_coefs(HalfBandDecimator::design(69.0, 0.2));
  decimator_2_.set_coefs(HalfBandDecimator::design(69.0, 0.01));

  stereo_boost_param_ = add_global<ParamStereoBoostingFlag>(*this, 0.0, 1);
  oversampling_param_ = add_global<ParamOverSamplingFlag>(*this, 0.0, 1);
  tone_freq_param_ = add_global<ParamToneFrq>(*this, 5000.0, 0);
  tone_shape_param_ = add_global<ParamToneColor>(*this, 0.0, 0);
  stereo_phase_param_ = add_global<ParamStereoAmount>(*this, 0.0, 0);
  feedback_.init(this);
  master_vol_param_ = add_global<ParamMasterVol>(*this, 1.0, 0);
  reserved_param_ = add_global<plugcore::ParamReserved>(*this, 0.0, 0);
  for (int k = 0; k < 3; ++k) {
    auto split = std::make_shared<ParamBandSplitFrq>();
    split->init(20480.0, 0, k);
    split->set_notified(this);
    add_param(split);
    split_params_[k] = split.get();
  }
  for (int b = 0; b < kNbrBands; ++b) {
    bands_[b].init(this, b);
  }
  if (plugcore::MidiMgr* midi = host_dsp_ != nullptr ? host_dsp_->use_midi_mgr() : nullptr) {
    midi->load_settings(get_property_str("plugin_name"));
    midi->set_nbr_extra_controls(get_nbr_extra_controls());
    midi->reset_map();
    for (int j = 0; j < get_nbr_extra_controls(); ++j) {
      midi->bind(kNbrParams + j, plugcore::kMidiKindNrpn, kNbrParams + j);
    }
  }
}

void BrakmorphDsp::set_default_state() {
  stereo_boost_param_->set_value_and_notify(0.0);
  oversampling_param_->set_value_and_notify(0.0);
  tone_freq_param_->set_value_and_notify(5000.0);
  tone_shape_param_->set_value_and_notify(0.0);
  stereo_phase_param_->set_value_and_notify(0.0);
  feedback_.set_default_state();
  master_vol_param_->set_value_and_notify(1.0);
  reserved_param_->set_value_and_notify(0.0);
  for (auto* split : split_params_) {
    split->set_value_and_notify(20480.0);
  }
  for (auto& band : bands_) {
    band.set_default_state();
  }
  request_reset();
}

void BrakmorphDsp::set_sample_rate(float rate) {
  sample_rate_ = rate;
  feedback_.set_sample_rate(rate);
  for (auto& band : bands_) {
    band.set_sample_rate(rate);
  }
  dc_blocker_.set_sample_rate(rate);
  dc_blocker_.set_high_pass();
  split_changed_.store(true, std::memory_order_relaxed);
  tone_changed_.store(true, std::memory_order_relaxed);
  params_changed_.store(true, std::memory_order_relaxed);
  feedback_.recompute_longest_chunk();
}

double BrakmorphDsp::get_property_num(const char* key) {
  struct Entry {
    const char* key;
    double value;
  };
  static const Entry kNumbers[] = {{"can_mono", 1.0}, {"can_scaled_val", 0.0}, {"plugin_version", 1.24}};
  for (const Entry& entry : kNumbers) {
    if (key != nullptr && std::strcmp(key, entry.key) == 0) {
      return entry.value;
    }
  }
  return 0.0;
}

std::string BrakmorphDsp::get_property_str(const char* key) {
  if (key != nullptr && std::strcmp(key, "plugin_name") == 0) {
    return "Brakmorph";
  }
  if (key != nullptr && std::strcmp(key, "plugin_category") == 0) {
    return "effect";
  }
  return std::string();
}

void BrakmorphDsp::notify(plugcore::NotifierInterface* notifier) {
  params_changed_.store(true, std::memory_order_relaxed);
  if (dynamic_cast<ParamToneFrq*>(notifier) != nullptr || dynamic_cast<ParamToneColor*>(notifier) != nullptr) {
    tone_changed_.store(true, std::memory_order_relaxed);
  } else if (dynamic_cast<ParamBandSplitFrq*>(notifier) != nullptr) {
    split_changed_.store(true, std::memory_order_relaxed);
  } else if (dynamic_cast<ParamMasterVol*>(notifier) != nullptr) {
    master_volume_changed_.store(true, std::memory_order_relaxed);
  }
}

void BrakmorphDsp::load_program(const plugcore::ProgramSlot& program) {
  const int n = std::min(kNbrParams, std::min(program.get_nbr_values(), get_nbr_registered_params()));
  for (int i = 0; i < n; ++i) {
    const float v = program.get_value(i);
    plugcore::NormalizedParamInterface& param = use_registered_param(i);
    if (v != param.get_norm()) {
      param.set_norm_and_notify(v);
    }
  }
}

void BrakmorphDsp::store_program(plugcore::ProgramSlot& program) {
  program.set_nbr_values(kNbrParams);
  for (int i = 0; i < kNbrParams && i < get_nbr_registered_params(); ++i) {
    program.set_value(i, use_registered_param(i).get_norm());
  }
}

void BrakmorphDsp::recompute_band_enabled() {
  const int count = splitter_.get_band_count();
  std::array<bool, kNbrBands> enabled{};
  bool any = false;
  for (int b = 0; b < kNbrBands; ++b) {
    enabled[b] = bands_[b].is_soloed();
    if (b < count && enabled[b]) {
      any = true;
    }
  }
  if (!any) {
    enabled.fill(true);
  }
  for (int b = 0; b < kNbrBands; ++b) {
    band_enabled_[b].store(enabled[b], std::memory_order_relaxed);
  }
}

void BrakmorphDsp::set_clip_detection(bool on) {
  clip_detection_on_.store(on, std::memory_order_relaxed);
  if (on) {
    clip_flag_.store(false, std::memory_order_relaxed);
    clip_reset_requested_.store(false, std::memory_order_relaxed);
  }
}

bool BrakmorphDsp::read_clip() {
  const bool clip = clip_flag_.load(std::memory_order_relaxed);
  clip_reset_requested_.store(true, std::memory_order_relaxed);
  return clip;
}

float BrakmorphDsp::get_band_level(int band) const {
  if (band < 0 || band >= kNbrBands || !band_enabled_[band].load(std::memory_order_relaxed)) {
    return 0.0f;
  }
  return bands_[band].get_level();
}

// ---- Block processing -----------------------------------------------------------

int BrakmorphDsp::process_replacing(float** outputs, float** inputs, int frames, int flag) {
  process_block(outputs, inputs, frames, false);
  return flag;
}

int BrakmorphDsp::process_adding(float** outputs, float** inputs, int frames, int flag) {
  process_block(outputs, inputs, frames, true);
  return flag;
}

void BrakmorphDsp::reset() {
  feedback_.reset();
  for (auto& band : bands_) {
    band.reset();
  }
  splitter_.reset();
  decimator_1_.reset();
  decimator_2_.reset();
  tone_.reset();
  dc_blocker_.reset();
  clip_flag_.store(false, std::memory_order_relaxed);
  clip_reset_requested_.store(false, std::memory_order_relaxed);
}

void BrakmorphDsp::update_params() {
  params_changed_.store(false, std::memory_order_relaxed);
  stereo_boost_on_ = stereo_boost_param_->get_value() > 0.5;
  const bool oversampling = oversampling_param_->get_value() > 0.5;
  if (oversampling != oversampling_on_) {
    oversampling_on_ = oversampling;
    for (auto& band : bands_) {
      band.set_oversampling(oversampling);
    }
  }
  stereo_delay_ = static_cast<float>(stereo_phase_param_->get_value());
  feedback_.set_stereo_delay(stereo_delay_);
  if (tone_changed_.exchange(false, std::memory_order_relaxed)) {
    tone_.recompute(static_cast<float>(tone_freq_param_->get_value()),
                    static_cast<float>(tone_shape_param_->get_value()), sample_rate_);
  }
  if (split_changed_.exchange(false, std::memory_order_relaxed)) {
    const float split[3] = {static_cast<float>(split_params_[0]->get_value()),
                            static_cast<float>(split_params_[1]->get_value()),
                            static_cast<float>(split_params_[2]->get_value())};
    splitter_.recompute(split, sample_rate_);
  }
  if (master_volume_changed_.exchange(false, std::memory_order_relaxed)) {
    const float v = static_cast<float>(master_vol_param_->get_value());
    for (auto& band : bands_) {
      band.set_master_volume(v);
    }
    feedback_.set_master_volume(v);
  }
  recompute_band_enabled();
}

int BrakmorphDsp::process_block(float** outputs, float** inputs, int frames, bool adding) {
  if (reset_requested_.exchange(false, std::memory_order_relaxed)) {
    reset();
  }
  if (frames <= 0 || inputs == nullptr || outputs == nullptr || inputs[0] == nullptr || outputs[0] == nullptr) {
    return 0;
  }
  const bool second_input =
      (host_dsp_ == nullptr || host_dsp_->is_input_connected(0, 1)) && inputs[1] != nullptr;
  const bool second_output =
      (host_dsp_ == nullptr || host_dsp_->is_output_connected(0, 1)) && outputs[1] != nullptr;
  if (params_changed_.load(std::memory_order_relaxed)) {
    update_params();
  }
  feedback_.prepare();
  for (auto& band : bands_) {
    band.prepare();
  }

  float* const bands[kNbrBands] = {band_buffers_[0], band_buffers_[1], band_buffers_[2], band_buffers_[3]};
  const bool metering = metering_on_.load(std::memory_order_relaxed);
  bool finite = true;
  int pos = 0;
  while (pos < frames) {
    const int n = std::min(frames - pos, std::min(feedback_.get_max_chunk(), kChunk));
    const float* signal = inputs[0] + pos;
    if (second_input) {
      const float* left = inputs[0] + pos;
      const float* right = inputs[1] + pos;
      for (int i = 0; i < n; ++i) {
        mono_input_[i] = (left[i] + right[i]) * 0.5f;
      }
      signal = mono_input_;
    }
    finite = finite && all_finite(signal, n);
    if (feedback_.is_active()) {
      feedback_.mix_input(feedback_mixed_, signal, n);
      signal = feedback_mixed_;
    }
    splitter_.split(signal, bands, n);

    const int count = oversampling_on_ ? 4 * n : n;
    const int band_count = splitter_.get_band_count();
    for (int b = 0; b < band_count; ++b) {
      if (band_enabled_[b].load(std::memory_order_relaxed)) {
        bands_[b].process(bands[b], n, metering);
      } else {
        std::fill(bands[b], bands[b] + count, 0.0f);
      }
    }
    splitter_.sum(bands, count);
    if (oversampling_on_) {
      decimator_1_.process(bands[0], bands[0], 2 * n);
      decimator_2_.process(bands[0], bands[0], n);
    }
    dc_blocker_.process(bands[0], bands[0], n);
    if (tone_.is_active()) {
      tone_.process(bands[0], n);
    }
    if (feedback_.is_active() || stereo_boost_on_) {
      feedback_.write(bands[0], n);
    }
    write_output(outputs, pos, n, second_output, adding);
    detect_clip(n);
    finite = finite && all_finite(bands[0], n);
    feedback_.advance(n);
    pos += n;
  }
  for (const auto& band : bands_) {
    finite = finite && std::isfinite(band.get_envelope());
  }
  if (!finite) {
    // A non-finite sample (from the input or from overflow) would stay in the filter,
    // follower and delay states for ever: start the next block from silence.
    request_reset();
  }
  return 0;
}

void BrakmorphDsp::write_output(float** outputs, int pos, int n, bool second_output, bool adding) {
  const float* left = band_buffers_[0];
  const float* right = left;
  if (second_output && stereo_boost_on_) {
    feedback_.read_stereo(band_buffers_[1], n);
    right = band_buffers_[1];
  }
  float* out_left = outputs[0] + pos;
  if (adding) {
    for (int i = 0; i < n; ++i) {
      out_left[i] += left[i];
    }
  } else {
    std::copy(left, left + n, out_left);
  }
  if (!second_output) {
    return;
  }
  float* out_right = outputs[1] + pos;
  if (adding) {
    for (int i = 0; i < n; ++i) {
      out_right[i] += right[i];
    }
  } else {
    std::copy(right, right + n, out_right);
  }
}

void BrakmorphDsp::detect_clip(int n) {
  if (clip_reset_requested_.load(std::memory_order_relaxed)) {
    clip_flag_.store(false, std::memory_order_relaxed);
  }
  if (!clip_detection_on_.load(std::memory_order_relaxed) || clip_flag_.load(std::memory_order_relaxed)) {
    return;
  }
  const float* left = band_buffers_[0];
  for (int i = 0; i < n; ++i) {
    if (std::fabs(left[i]) >= 1.0f) {
      clip_flag_.store(true, std::memory_order_relaxed);
      return;
    }
  }
}
