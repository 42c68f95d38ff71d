#include "host/vst2_plugin.h"

#include <cctype>
#include <cmath>
#include <map>

#include "config/setting_mgr.h"
#include "config/system_services.h"
#include "host/dsp_interface.h"
#include "host/gui_interface.h"
#include "host/host_dsp_interface.h"
#include "host/rounding_mode_guard.h"
#include "midi/midi_dev_sel_dispatcher.h"
#include "midi/midi_mgr.h"
#include "midi/vst2_midi_dev_sel_comp.h"
#include "params/normalized_param_interface.h"
#include "params/pin_group.h"

namespace plugcore {

namespace {

bool equal_ignoring_case(const std::string& a, const char* b) {
  size_t i = 0;
  for (; i < a.size() && b[i] != 0; ++i) {
    if (std::tolower(static_cast<unsigned char>(a[i])) != std::tolower(static_cast<unsigned char>(b[i]))) {
      return false;
    }
  }
  return i == a.size() && b[i] == 0;
}

// Numbers the pins of each group in order; -1 marks a group's missing second pin.
int32_t number_pins(DspInterface& dsp, bool output, std::vector<std::array<int, 2>>& map) {
  int32_t next = 0;
  const int groups = output ? dsp.get_nbr_output_groups() : dsp.get_nbr_input_groups();
  map.assign(static_cast<size_t>(groups > 0 ? groups : 0), {-1, -1});
  for (int g = 0; g < groups; ++g) {
    const PinGroup& group = output ? dsp.use_output_group(g) : dsp.use_input_group(g);
    for (size_t p = 0; p < group.pins.size() && p < 2; ++p) {
      map[static_cast<size_t>(g)][p] = next++;
    }
  }
  return next;
}

}  // namespace

Vst2Plugin::Vst2Plugin(Vst2HostCallback host, DspInterface* dsp, GuiInterface* gui,
                       MidiReceiverInterface* midi_receiver, const BankManager& static_bank, int32_t unique_id)
    : AudioEffectX(host, static_bank.get_nbr_programs(), dsp->get_nbr_param()),
      bank_(static_bank),
      dsp_(dsp),
      gui_(gui),
      midi_receiver_(midi_receiver) {
  priorities_.resize(num_params_);
  nbr_inputs_ = number_pins(*dsp_, false, input_pin_map_);
  nbr_outputs_ = number_pins(*dsp_, true, output_pin_map_);
  setNumInputs(nbr_inputs_);
  setNumOutputs(nbr_outputs_);
  set_flag(effFlagsCanReplacing, true);
  if (dsp_->get_property_num("can_mono") != 0.0) {
    set_flag(effFlagsCanMono, true);
  }
  if (midi_receiver_ != nullptr) {
    midi_mgr_ = new MidiMgr;
    host_midi_comp_ = new Vst2MidiDevSelComp(midi_mgr_);
    midi_dispatcher_ = new MidiDevSelDispatcher(midi_mgr_);
    midi_mgr_->init(midi_receiver_, dsp_, midi_dispatcher_, this);
    midi_dispatcher_->add_component(host_midi_comp_);
    host_midi_comp_->set_plugin(this);
  }
  if (equal_ignoring_case(dsp_->get_property_str("plugin_category"), "instrument")) {
    set_flag(effFlagsIsSynth, true);
  }
  setUniqueID(unique_id);
}

Vst2Plugin::~Vst2Plugin() {
  close_instance();
  delete midi_dispatcher_;  // closes the devices it opened
  delete host_midi_comp_;
  delete midi_mgr_;
  delete dsp_;
  delete gui_;
}

void Vst2Plugin::close_instance() {
  if (dsp_ != nullptr) {
    dsp_->close();
  }
  if (midi_mgr_ != nullptr) {
    midi_mgr_->set_active(false);
  }
  if (gui_ != nullptr) {
    gui_->close();
  }
}

void Vst2Plugin::init_instance() {
  dsp_->init();
  if (bank_.get_nbr_programs() > 0 && bank_.use_program(0).get_extra_size() > 0) {
    set_flag(effFlagsProgramChunks, true);
  }
  if (midi_mgr_ != nullptr) {
    const int inputs_status = midi_dispatcher_->list_inputs();
    const int outputs_status = midi_dispatcher_->list_outputs();
    midi_mgr_->set_active(inputs_status == 0 && outputs_status == 0);
    if (midi_dispatcher_->init_components() == 0) {
      midi_dispatcher_->select_default(true);
    }
  }
  if (gui_ != nullptr) {
    gui_->init();
  }
}

void Vst2Plugin::set_default_state() {
  dsp_->set_default_state();
  if (gui_ != nullptr) {
    gui_->set_default_state();
  }
}

// ---- Parameter arbitration -------------------------------------------------

bool Vst2Plugin::can_set_param(int index, int priority) {
  return valid_param(index) && priorities_.use(index).test(sys::get_time(), priority);
}

bool Vst2Plugin::lock_param(int index, int priority) {
  return valid_param(index) && priorities_.use(index).take(sys::get_time(), priority);
}

void Vst2Plugin::release_param(int index, int priority) {
  if (valid_param(index)) {
    priorities_.use(index).release(priority);
  }
}

bool Vst2Plugin::set_param(int index, float norm, int priority) {
  if (!valid_param(index) || !priorities_.use(index).take(sys::get_time(), priority)) {
    return false;
  }
  if (cur_program_ >= 0 && cur_program_ < bank_.get_nbr_programs()) {
    ProgramSlot& program = bank_.use_program(cur_program_);
    if (index < program.get_nbr_values()) {
      program.set_value(index, norm);
    }
  }
  dsp_->use_param(index).set_norm_and_notify(norm);
  if (gui_ != nullptr) {
    gui_->notify_param_change(index, norm, priority);
  }
  return true;
}

bool Vst2Plugin::set_param_automated(int index, float norm, int priority) {
  if (!set_param(index, norm, priority)) {
    return false;
  }
  if (midi_mgr_ != nullptr) {
    midi_mgr_->send_feedback(0, index, norm);
  }
  call_host(audioMasterAutomate, index, 0, nullptr, norm);
  updateDisplay();
  return true;
}

void Vst2Plugin::apply_program(const ProgramSlot& program, int priority, bool release, bool automate) {
  const int n = program.get_nbr_values();
  if (cur_program_ >= 0 && cur_program_ < bank_.get_nbr_programs()) {
    bank_.set_program(cur_program_, program);
  }
  dsp_->set_program_name(program.get_name());
  dsp_->load_program(program);
  const double now = sys::get_time();
  for (int i = 0; i < n && i < num_params_; ++i) {
    ParamPriority& record = priorities_.use(i);
    if (!record.take(now, priority)) {
      continue;
    }
    const float v = program.get_value(i);
    if (gui_ != nullptr) {
      gui_->notify_param_change(i, v, priority);
    }
    if (midi_mgr_ != nullptr) {
      midi_mgr_->send_feedback(0, i, v);
    }
    if (automate) {
      call_host(audioMasterAutomate, i, 0, nullptr, v);
    }
    if (release) {
      record.release(priority);
    }
  }
  updateDisplay();
}

// ---- Programs and state ------------------------------------------------------

void Vst2Plugin::setProgram(int32_t program) {
  if (program < 0 || program >= bank_.get_nbr_programs()) {
    return;
  }
  cur_program_ = program;
  const ProgramSlot slot = bank_.use_program(program);  // apply_program copies into the same slot
  apply_program(slot, 200, true, false);
}

bool Vst2Plugin::check_program_shape(const ProgramSlot& program) const {
  // The engine reads one value per parameter; a program of another shape would
  // leave parameters undefined, so it is refused as a whole.
  return program.get_nbr_values() == num_params_;
}

int32_t Vst2Plugin::getChunk(void** data, bool is_preset) {
  const basic::SerializableInterface* source = &bank_;
  if (is_preset) {
    if (cur_program_ < 0 || cur_program_ >= bank_.get_nbr_programs()) {
      return 0;
    }
    source = &bank_.use_program(cur_program_);
  }
  const int size = source->get_serialized_size();
  chunk_buffer_.assign(static_cast<size_t>(size > 0 ? size : 0), 0);
  if (size <= 0 || source->serialize(chunk_buffer_.data()) != 0) {
    return 0;
  }
  *data = chunk_buffer_.data();
  return size;
}

int32_t Vst2Plugin::setChunk(void* data, int32_t size, bool is_preset) {
  if (data == nullptr || size <= 0) {
    return 0;
  }
  if (is_preset) {
    if (cur_program_ < 0 || cur_program_ >= bank_.get_nbr_programs()) {
      return 0;
    }
    ProgramSlot program;
    if (program.unserialize(data, size) != 0 || !check_program_shape(program)) {
      return 0;
    }
    bank_.set_program(cur_program_, program);
  } else {
    BankManager bank;
    if (bank.unserialize(data, size) != 0 || bank.get_nbr_programs() != num_programs_) {
      return 0;
    }
    for (int i = 0; i < bank.get_nbr_programs(); ++i) {
      if (!check_program_shape(bank.use_program(i))) {
        return 0;
      }
    }
    bank_ = bank;
  }
  setProgram(cur_program_);
  return 1;
}

void Vst2Plugin::setProgramName(const char* name) {
  if (cur_program_ < 0 || cur_program_ >= bank_.get_nbr_programs()) {
    return;
  }
  bank_.use_program(cur_program_).set_name(name);
  dsp_->set_program_name(name);
}

// ---- Sample rate, suspend, resume ----------------------------------------------

void Vst2Plugin::setSampleRate(float rate) {
  if (!(rate > 0.0f) || !std::isfinite(rate)) {
    return;  // a host's zero or garbage rate would turn every coefficient into NaN
  }
  AudioEffectX::setSampleRate(rate);
  dsp_->set_sample_rate(rate);
  dsp_->request_reset();
}

void Vst2Plugin::suspend() {
  chunk_buffer_.clear();
  chunk_buffer_.shrink_to_fit();
  dsp_->request_reset();
}

void Vst2Plugin::resume() {
  chunk_buffer_.clear();
  chunk_buffer_.shrink_to_fit();
  recompute_automation_threshold();
  dsp_->request_reset();
  if (midi_receiver_ != nullptr) {
    wantEvents(1);
  }
}

void Vst2Plugin::recompute_automation_threshold() {
  const int32_t n = getNumAutomatableParameters();
  if (n <= 0) {
    return;
  }
  std::map<int, int> count_by_priority;
  for (int i = 0; i < num_params_; ++i) {
    ++count_by_priority[dsp_->use_param(i).get_priority()];
  }
  int total = 0;
  for (const auto& entry : count_by_priority) {
    total += entry.second;
    if (total > n) {
      break;
    }
    automation_threshold_ = entry.first;
  }
}

// ---- Audio ---------------------------------------------------------------------

void Vst2Plugin::forward_tempo() {
  HostDspInterface* host_dsp = dsp_->get_host_dsp();
  if (host_dsp == nullptr) {
    return;
  }
  TempoQuery query;
  query.wanted = true;
  host_dsp->get_tempo(query);
  const float tempo = static_cast<float>(query.tempo);
  if (!query.error && query.wanted && tempo != last_tempo_) {
    dsp_->set_tempo(tempo);
    if (gui_ != nullptr) {
      set_tempo(tempo);
    }
    last_tempo_ = tempo;
  }
}

void Vst2Plugin::run_block(float** inputs, float** outputs, int32_t frames, bool adding) {
  if (frames <= 0 || inputs == nullptr || outputs == nullptr) {
    return;
  }
  RoundingModeGuard rounding;
  forward_tempo();
  if (midi_mgr_ != nullptr) {
    midi_mgr_->begin_block();
  }
  if (adding) {
    dsp_->process_adding(outputs, inputs, frames, 0);
  } else {
    dsp_->process_replacing(outputs, inputs, frames, 0);
  }
  if (midi_mgr_ != nullptr) {
    midi_mgr_->set_time_stamp(0);
    midi_mgr_->end_block();
  }
}

void Vst2Plugin::process(float** inputs, float** outputs, int32_t frames) { run_block(inputs, outputs, frames, true); }

void Vst2Plugin::processReplacing(float** inputs, float** outputs, int32_t frames) {
  run_block(inputs, outputs, frames, false);
}

int32_t Vst2Plugin::processEvents(VstEvents* events) {
  if (midi_mgr_ == nullptr || events == nullptr || !host_midi_comp_->use_input().is_open()) {
    return 1;
  }
  for (int32_t i = 0; i < events->numEvents; ++i) {
    const VstEvent* event = events->events[i];
    if (event == nullptr || event->type != kVstMidiType) {
      continue;
    }
    const auto* midi = reinterpret_cast<const VstMidiEvent*>(event);
    const unsigned char bytes[3] = {static_cast<unsigned char>(midi->midiData[0]),
                                    static_cast<unsigned char>(midi->midiData[1]),
                                    static_cast<unsigned char>(midi->midiData[2])};
    midi_mgr_->receive_host_event(bytes, midi->deltaFrames, midi->detune);
  }
  return 1;
}

intptr_t Vst2Plugin::dispatcher(int32_t opcode, int32_t index, intptr_t value, void* ptr, float opt) {
  if (opcode == effVendorSpecific && index == kSettingsVendorIndex && ptr != nullptr &&
      (value == kSettingsLoadValue || value == kSettingsSaveValue)) {
    const std::string path = static_cast<const char*>(ptr);
    return (value == kSettingsLoadValue ? load_setting_file(path) : save_setting_file(path)) == 0 ? 1 : 0;
  }
  return AudioEffectX::dispatcher(opcode, index, value, ptr, opt);
}

int Vst2Plugin::load_setting_file(const std::string& path) {
  if (midi_mgr_ == nullptr) {
    return -1;
  }
  SettingMgr settings;
  settings.init(*dsp_);
  settings.add_client(midi_mgr_);
  return settings.load_file(path);
}

int Vst2Plugin::save_setting_file(const std::string& path) {
  if (midi_mgr_ == nullptr) {
    return -1;
  }
  SettingMgr settings;
  settings.init(*dsp_);
  settings.add_client(midi_mgr_);
  return settings.save_file(path);
}

// ---- Parameters --------------------------------------------------------------------

void Vst2Plugin::setParameter(int32_t index, float value) {
  if (!valid_param(index) || !std::isfinite(value)) {
    return;
  }
  const float norm = value < 0.0f ? 0.0f : (value > 1.0f ? 1.0f : value);
  set_param(index, norm, 100);
}

float Vst2Plugin::getParameter(int32_t index) {
  return valid_param(index) ? dsp_->use_param(index).get_norm() : 0.0f;
}

int Vst2Plugin::get_host_pin(bool output, int group, int pin) const {
  const auto& map = output ? output_pin_map_ : input_pin_map_;
  if (group < 0 || static_cast<size_t>(group) >= map.size() || pin < 0 || pin > 1) {
    return -1;
  }
  return map[static_cast<size_t>(group)][static_cast<size_t>(pin)];
}

}  // namespace plugcore
