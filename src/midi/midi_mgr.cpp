#include "midi/midi_mgr.h"

#include <cmath>
#include <cstdio>
#include <cstring>
#include <memory>

#include "config/conf_key.h"
#include "host/dsp_interface.h"
#include "midi/midi_controller_key.h"
#include "midi/midi_dev_sel_dispatcher.h"
#include "params/normalized_param_interface.h"
#include "params/plugin_cmd_interface.h"

namespace plugcore {

namespace {

const char kIdPrefix[] = "id_";
const char kCcPrefix[] = "cc_";
const char kRpnPrefix[] = "rpn_";
const char kNrpnPrefix[] = "nrpn_";

// The decimal number that follows prefix, or -1; at most 9 digits, so a
// hostile entry cannot overflow.
int parse_prefixed(const std::string& text, const char* prefix) {
  const size_t length = std::strlen(prefix);
  if (text.compare(0, length, prefix) != 0 || text.size() == length || text.size() > length + 9) {
    return -1;
  }
  int number = 0;
  for (size_t i = length; i < text.size(); ++i) {
    if (text[i] < '0' || text[i] > '9') {
      return -1;
    }
    number = number * 10 + (text[i] - '0');
  }
  return number;
}

std::string key_text(int32_t key) {
  char text[32];
  const int kind = midi_key_kind(key);
  if (kind == kMidiKindNrpn) {
    std::snprintf(text, sizeof(text), "%s%d", kNrpnPrefix, midi_key_number(key));
  } else if (kind == kMidiKindRpn) {
    std::snprintf(text, sizeof(text), "%s%d", kRpnPrefix, midi_key_number(key));
  } else {
    std::snprintf(text, sizeof(text), "%s%d", kCcPrefix, kind);
  }
  return text;
}

// The key an entry's text names, or -1.
int32_t parse_key_text(const std::string& text) {
  int number = parse_prefixed(text, kCcPrefix);
  if (number >= 0) {
    return number < 128 ? make_midi_key(number, 0) : -1;
  }
  number = parse_prefixed(text, kRpnPrefix);
  if (number >= 0) {
    return number < 16384 ? make_midi_key(kMidiKindRpn, number) : -1;
  }
  number = parse_prefixed(text, kNrpnPrefix);
  if (number >= 0) {
    return number < 16384 ? make_midi_key(kMidiKindNrpn, number) : -1;
  }
  return -1;
}

}  // namespace

void MidiMgr::init(MidiReceiverInterface* engine_receiver, DspInterface* dsp, MidiDevSelDispatcher* dispatcher,
                   PluginCmdInterface* cmd) {
  engine_receiver_ = engine_receiver;
  dsp_ = dsp;
  dispatcher_ = dispatcher;
  cmd_ = cmd;
  nbr_params_ = dsp_ != nullptr ? dsp_->get_nbr_param() : 0;
}

void MidiMgr::load_settings(const std::string& plugin_name) { settings_.load(plugin_name); }

void MidiMgr::set_nbr_extra_controls(int count) {
  const int room = MidiControlMap::kMaxIndex - nbr_params_;
  nbr_extra_ = count < 0 ? 0 : (count > room ? room : count);
}

void MidiMgr::reset_map() {
  map_.clear();
  for (int i = 0; i < nbr_params_ && i < MidiControlMap::kMaxIndex; ++i) {
    map_.bind(i, make_midi_key(kMidiKindNrpn, i));
  }
}

int MidiMgr::bind(int index, int kind, int number) {
  if (!valid_index(index) || kind < 0 || kind > 127 || number < 0 || number > 16383) {
    return -1;
  }
  return map_.bind(index, make_midi_key(kind, number)) ? 0 : -1;
}

int MidiMgr::unbind(int index) {
  map_.unbind(index);
  return 0;
}

bool MidiMgr::get_last_binding(int& index, int32_t& key) const {
  index = last_binding_index_.load(std::memory_order_acquire);
  key = last_binding_key_.load(std::memory_order_relaxed);
  return index >= 0;
}

bool MidiMgr::map_controller(int32_t key, int value, int& index, float& norm) {
  const int target = autobind_target_.load(std::memory_order_relaxed);
  // NRPN numbers keep their fixed addressing: they are never learned.
  if (target >= 0 && midi_key_kind(key) != kMidiKindNrpn && valid_index(target) && map_.bind(target, key)) {
    last_binding_key_.store(key, std::memory_order_relaxed);
    last_binding_index_.store(target, std::memory_order_release);
    if (settings_.get_autobind_mode() == 0) {
      int expected = target;
      autobind_target_.compare_exchange_strong(expected, -1, std::memory_order_relaxed);
    }
  }
  index = map_.find(key);
  if (index < 0) {
    return false;
  }
  norm = static_cast<float>(value / 16383.0);
  return true;
}

void MidiMgr::controller_step(int32_t key, int value) {
  int index = -1;
  float norm = 0.0f;
  if (!map_controller(key, value, index, norm)) {
    return;
  }
  if (index < nbr_params_) {
    if (cmd_ != nullptr) {
      cmd_->set_param(index, norm, kControllerPriority);
    }
  } else if (dsp_ != nullptr) {
    dsp_->set_extra_control(index, norm);
  }
}

int MidiMgr::send_feedback(int channel, int index, float norm) {
  const int32_t key = map_.key_of(index);
  if (key < 0) {
    return -2;
  }
  const double clamped = norm < 0.0f ? 0.0 : (norm > 1.0f ? 1.0 : static_cast<double>(norm));
  const int value = static_cast<int>(std::floor(clamped * 16383.0 + 0.5));
  const int kind = midi_key_kind(key);
  bool ok = true;
  if (kind == kMidiKindNrpn) {
    ok = nrpn(channel, midi_key_number(key), value) != 0;
  } else if (kind == kMidiKindRpn) {
    ok = rpn(channel, midi_key_number(key), value) != 0;
  } else {
    ok = channel_message(channel, 11, kind, value >> 7) != 0;
    if (kind < 32) {
      ok = channel_message(channel, 11, kind + 32, value & 127) != 0 && ok;
    }
  }
  return ok ? 0 : -1;
}

void MidiMgr::begin_block() {
  {
    MidiDeviceSlot<MidiInInterface>::Use input(input_);
    if (input) input->begin_block();
  }
  MidiDeviceSlot<MidiOutInterface>::Use output(output_);
  if (output) output->begin_block();
}

void MidiMgr::end_block() {
  {
    MidiDeviceSlot<MidiInInterface>::Use input(input_);
    if (input) input->end_block();
  }
  MidiDeviceSlot<MidiOutInterface>::Use output(output_);
  if (output) output->end_block();
}

int MidiMgr::receive_host_event(const unsigned char bytes[3], int sample_offset, int detune_cents) {
  MidiDeviceSlot<MidiInInterface>::Use input(input_);
  return input ? input->receive_host_event(bytes, sample_offset, detune_cents) : -1;
}

// ---- The "midi" section ------------------------------------------------------------

int MidiMgr::save(basic::ConfKeyMulti& root) {
  basic::ConfKeyMulti midi("midi");
  basic::ConfKeyMulti control_map("control_map");
  control_map.set_comment(kComment);
  char name[32];
  for (const auto& binding : map_.list()) {
    std::snprintf(name, sizeof(name), "%s%d", kIdPrefix, binding.second);
    basic::ConfKeyData entry(name, key_text(binding.first));
    if (binding.second < nbr_params_ && dsp_ != nullptr) {
      char param_name[128];
      dsp_->use_param(binding.second).get_name(param_name, sizeof(param_name));
      entry.set_comment(param_name);
    }
    control_map.add_key(entry);
  }
  midi.add_key(control_map);
  if (dispatcher_ != nullptr) {
    const int status = dispatcher_->save(midi);
    if (status != 0) {
      return status;
    }
  }
  root.set_key(midi);
  return 0;
}

int MidiMgr::load(const basic::ConfKeyMulti& root) {
  const int midi_index = root.find_multi("midi");
  if (midi_index < 0) {
    return 0;
  }
  const auto& midi = static_cast<const basic::ConfKeyMulti&>(root.use_key(midi_index));
  // The new map is built aside and takes effect only once the whole section
  // (device selection included) has loaded.
  auto candidate = std::make_unique<MidiControlMap>();
  candidate->assign(map_.list());
  const int map_index = midi.find_multi("control_map");
  if (map_index >= 0) {
    const auto& entries = static_cast<const basic::ConfKeyMulti&>(midi.use_key(map_index));
    for (int i = 0; i < entries.get_nbr_keys(); ++i) {
      const auto* entry = dynamic_cast<const basic::ConfKeyData*>(&entries.use_key(i));
      if (entry == nullptr) {
        continue;
      }
      const int index = parse_prefixed(entry->get_name(), kIdPrefix);
      const auto* text = dynamic_cast<const basic::ConfKeyContentString*>(&entry->use_content());
      const int32_t key = text != nullptr ? parse_key_text(text->get_string()) : -1;
      if (valid_index(index) && key >= 0) {
        candidate->bind(index, key);
      }
    }
  }
  if (dispatcher_ != nullptr) {
    const int status = dispatcher_->load(midi);
    if (status != 0) {
      return status;
    }
  }
  for (int index = 0; index < MidiControlMap::kMaxIndex; ++index) {
    const int32_t key = candidate->key_of(index);
    if (key < 0) {
      map_.unbind(index);
    } else if (map_.key_of(index) != key) {
      map_.bind(index, key);
    }
  }
  return 0;
}

// ---- Receiver face: the output device ---------------------------------------------------

#define PLUGCORE_FORWARD_TO_OUTPUT(call)                  \
  MidiDeviceSlot<MidiOutInterface>::Use output(output_); \
  return output ? output->call : 0

int MidiMgr::set_time_stamp(int sample_offset) { PLUGCORE_FORWARD_TO_OUTPUT(set_time_stamp(sample_offset)); }
int MidiMgr::note_on(int channel, int note, float pitch, int zero, float velocity, int one) {
  PLUGCORE_FORWARD_TO_OUTPUT(note_on(channel, note, pitch, zero, velocity, one));
}
int MidiMgr::note_off(int channel, int note, float velocity) { PLUGCORE_FORWARD_TO_OUTPUT(note_off(channel, note, velocity)); }
int MidiMgr::key_pressure(int channel, int note, float pressure) {
  PLUGCORE_FORWARD_TO_OUTPUT(key_pressure(channel, note, pressure));
}
int MidiMgr::pitch_bend(int channel, float semitones) { PLUGCORE_FORWARD_TO_OUTPUT(pitch_bend(channel, semitones)); }
int MidiMgr::program_change(int channel, int program) { PLUGCORE_FORWARD_TO_OUTPUT(program_change(channel, program)); }
int MidiMgr::rpn(int channel, int number, int value) { PLUGCORE_FORWARD_TO_OUTPUT(rpn(channel, number, value)); }
int MidiMgr::nrpn(int channel, int number, int value) { PLUGCORE_FORWARD_TO_OUTPUT(nrpn(channel, number, value)); }
int MidiMgr::channel_message(int channel, int status, int data1, int data2) {
  PLUGCORE_FORWARD_TO_OUTPUT(channel_message(channel, status, data1, data2));
}
int MidiMgr::single_byte_message(int status) { PLUGCORE_FORWARD_TO_OUTPUT(single_byte_message(status)); }
int MidiMgr::three_byte_message(int byte1, int byte2, int byte3) {
  PLUGCORE_FORWARD_TO_OUTPUT(three_byte_message(byte1, byte2, byte3));
}

#undef PLUGCORE_FORWARD_TO_OUTPUT

}  // namespace plugcore
