#pragma once

#include <atomic>
#include <cstdint>
#include <string>

#include "config/setting_client_interface.h"
#include "midi/midi_control_map.h"
#include "midi/midi_controller_sink_interface.h"
#include "midi/midi_dev_interface.h"
#include "midi/midi_device_slot.h"
#include "midi/midi_receiver_interface.h"
#include "midi/midi_settings.h"

namespace basic {
class ConfKeyMulti;
}

namespace plugcore {

class DspInterface;
class MidiDevSelDispatcher;
class PluginCmdInterface;

// MIDI control of the parameters: the control map from controller keys to
// parameters, the learning step of auto-bind, the write of decoded
// controllers, the echo of editor-side changes to the selected output, and
// the "midi" section of setting files. Its receiver face sends to the
// selected output device.
class MidiMgr : public MidiReceiverInterface, public MidiControllerSinkInterface, public basic::SettingClientInterface {
 public:
  static constexpr int kControllerPriority = 125;

  MidiMgr() = default;
  ~MidiMgr() override = default;
  MidiMgr(const MidiMgr&) = delete;
  MidiMgr& operator=(const MidiMgr&) = delete;

  void init(MidiReceiverInterface* engine_receiver, DspInterface* dsp, MidiDevSelDispatcher* dispatcher,
            PluginCmdInterface* cmd);
  MidiReceiverInterface* use_engine_receiver() { return engine_receiver_; }

  // Per-user switches, read from the store under "Velmora/<name>".
  void load_settings(const std::string& plugin_name);
  MidiSettings& use_settings() { return settings_; }

  // Control map. Indices from the parameter count up are the engine's extra
  // controls; bind refuses (-1) an index that is neither, or a key no
  // controller can produce.
  void set_nbr_extra_controls(int count);
  int get_nbr_controls() const { return nbr_params_ + nbr_extra_; }
  void reset_map();
  int bind(int index, int kind, int number);
  int unbind(int index);
  int32_t get_key(int index) const { return map_.key_of(index); }
  int find_index(int32_t key) const { return map_.find(key); }
  const MidiControlMap& use_map() const { return map_; }

  // Auto-bind.
  void set_autobind_target(int index) { autobind_target_.store(index, std::memory_order_relaxed); }
  void clear_autobind_target() { autobind_target_.store(-1, std::memory_order_relaxed); }
  int get_autobind_target() const { return autobind_target_.load(std::memory_order_relaxed); }
  bool get_last_binding(int& index, int32_t& key) const;
  void clear_last_binding() { last_binding_index_.store(-1, std::memory_order_release); }

  // Learning step, then lookup: true with the index and its normalised value.
  bool map_controller(int32_t key, int value, int& index, float& norm);
  // MidiControllerSinkInterface: map_controller, then the parameter write.
  void controller_step(int32_t key, int value) override;
  int get_nrpn_compatibility() const override { return settings_.get_nrpn_compatibility(); }

  // Echo of the index's new value to the output: 0, -1 (output refused or
  // none) or -2 (no key).
  int send_feedback(int channel, int index, float norm);

  // Audio thread: the input, then the output.
  void begin_block();
  void end_block();

  // Editor thread (the device dispatcher): the devices in use. The previous
  // device comes back once no other thread can be using it.
  MidiInInterface* set_input_device(MidiInInterface* device) { return input_.swap(device); }
  MidiOutInterface* set_output_device(MidiOutInterface* device) { return output_.swap(device); }
  // Host MIDI (processEvents): hands one event to the input in use.
  int receive_host_event(const unsigned char bytes[3], int sample_offset, int detune_cents);

  void set_active(bool active) { active_.store(active, std::memory_order_relaxed); }
  bool is_active() const { return active_.load(std::memory_order_relaxed); }

  // The "midi" section: control map, then the device selection. A load that
  // fails keeps the previous map and selection.
  int save(basic::ConfKeyMulti& root);
  int load(const basic::ConfKeyMulti& root);
  int save_settings(basic::ConfKeyMulti& root) override { return save(root); }
  int load_settings(const basic::ConfKeyMulti& root) override { return load(root); }

  // MidiReceiverInterface: forwarded to the output device; 0 without one.
  int set_time_stamp(int sample_offset) override;
  int note_on(int channel, int note, float pitch, int zero, float velocity, int one) override;
  int note_off(int channel, int note, float velocity) override;
  int key_pressure(int channel, int note, float pressure) override;
  int pitch_bend(int channel, float semitones) override;
  int program_change(int channel, int program) override;
  int rpn(int channel, int number, int value) override;
  int nrpn(int channel, int number, int value) override;
  int channel_message(int channel, int status, int data1, int data2) override;
  int single_byte_message(int status) override;
  int three_byte_message(int byte1, int byte2, int byte3) override;

  static constexpr const char* kComment = "Bind param with cc_, rpn_ or nrpn_ as prefix + CC/(N)RPN #.";

 private:
  bool valid_index(int index) const { return index >= 0 && index < get_nbr_controls(); }

  MidiControlMap map_;
  MidiReceiverInterface* engine_receiver_ = nullptr;
  DspInterface* dsp_ = nullptr;
  MidiDeviceSlot<MidiInInterface> input_;
  MidiDeviceSlot<MidiOutInterface> output_;
  MidiDevSelDispatcher* dispatcher_ = nullptr;
  PluginCmdInterface* cmd_ = nullptr;
  MidiSettings settings_;
  std::atomic<int> autobind_target_{-1};
  std::atomic<int> last_binding_index_{-1};
  std::atomic<int32_t> last_binding_key_{-1};
  std::atomic<bool> active_{false};
  int nbr_params_ = 0;
  int nbr_extra_ = 0;
};

}  // namespace plugcore
