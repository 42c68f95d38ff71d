#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <vector>

#include "host/audio_effect_x.h"
#include "midi/settings_vendor_call.h"
#include "params/param_priority.h"
#include "params/plugin_cmd_interface.h"
#include "presets/bank_manager.h"

namespace plugcore {

class DspInterface;
class GuiInterface;
class MidiDevSelDispatcher;
class MidiMgr;
class MidiReceiverInterface;
class Vst2MidiDevSelComp;

// The VST 2 face of one instance: answers the host, arbitrates parameter writes,
// keeps the host bank and routes audio blocks to the engine.
class Vst2Plugin : public AudioEffectX, public PluginCmdInterface {
 public:
  Vst2Plugin(Vst2HostCallback host, DspInterface* dsp, GuiInterface* gui, MidiReceiverInterface* midi_receiver,
             const BankManager& static_bank, int32_t unique_id);
  ~Vst2Plugin() override;

  // Start-up steps run by the entry point, in this order.
  void init_instance();
  void set_default_state();

  virtual void set_tempo(double bpm) = 0;
  virtual std::string get_base_directory() = 0;

  // PluginCmdInterface.
  bool can_set_param(int index, int priority) override;
  bool lock_param(int index, int priority) override;
  void release_param(int index, int priority) override;
  bool set_param(int index, float norm, int priority) override;
  bool set_param_automated(int index, float norm, int priority) override;
  void apply_program(const ProgramSlot& program, int priority, bool release, bool automate) override;

  // AudioEffect / AudioEffectX.
  intptr_t dispatcher(int32_t opcode, int32_t index, intptr_t value, void* ptr, float opt) override;
  void suspend() override;
  void resume() override;
  void setProgram(int32_t program) override;
  void setProgramName(const char* name) override;
  void getProgramName(char* name) override;
  void getParameterLabel(int32_t index, char* label) override;
  void getParameterDisplay(int32_t index, char* text) override;
  void getParameterName(int32_t index, char* text) override;
  void setSampleRate(float rate) override;
  int32_t getChunk(void** data, bool is_preset) override;
  int32_t setChunk(void* data, int32_t size, bool is_preset) override;
  void setParameter(int32_t index, float value) override;
  float getParameter(int32_t index) override;
  void process(float** inputs, float** outputs, int32_t frames) override;
  void processReplacing(float** inputs, float** outputs, int32_t frames) override;
  int32_t processEvents(VstEvents* events) override;
  bool canParameterBeAutomated(int32_t index) override;
  bool string2parameter(int32_t index, const char* text) override;
  bool getProgramNameIndexed(int32_t category, int32_t index, char* text) override;
  bool copyProgram(int32_t destination) override;
  bool getInputProperties(int32_t index, VstPinProperties* properties) override;
  bool getOutputProperties(int32_t index, VstPinProperties* properties) override;
  int32_t getPlugCategory() override;
  bool getEffectName(char* name) override;
  bool getVendorString(char* text) override;
  bool getProductString(char* text) override;
  int32_t getVendorVersion() override;
  int32_t canDo(const char* text) override;
  bool getParameterProperties(int32_t index, VstParameterProperties* p) override;

  // What the adapters ask of the core.
  int get_host_pin(bool output, int group, int pin) const;
  MidiMgr* use_midi_mgr() { return midi_mgr_; }
  MidiDevSelDispatcher* use_midi_dispatcher() { return midi_dispatcher_; }
  Vst2MidiDevSelComp* use_host_midi_comp() { return host_midi_comp_; }
  // The setting file of the instance's MIDI settings: status of the setting manager.
  int load_setting_file(const std::string& path);
  int save_setting_file(const std::string& path);
  DspInterface* use_dsp() { return dsp_; }
  BankManager& use_bank() { return bank_; }
  int get_automation_threshold() const { return automation_threshold_; }
  void set_setting_key(const std::string& key) { setting_key_ = key; }
  const std::string& get_setting_key() const { return setting_key_; }

 protected:
  void close_instance();
  bool valid_param(int32_t index) const { return index >= 0 && index < num_params_; }
  void run_block(float** inputs, float** outputs, int32_t frames, bool adding);
  void forward_tempo();
  void recompute_automation_threshold();
  bool check_program_shape(const ProgramSlot& program) const;

  BankManager bank_;
  ParamPriorityList priorities_;
  MidiMgr* midi_mgr_ = nullptr;
  MidiDevSelDispatcher* midi_dispatcher_ = nullptr;
  Vst2MidiDevSelComp* host_midi_comp_ = nullptr;
  DspInterface* dsp_;
  GuiInterface* gui_;
  MidiReceiverInterface* midi_receiver_;
  int32_t nbr_inputs_ = 0;
  int32_t nbr_outputs_ = 0;
  int32_t automation_threshold_ = 999999999;
  float last_tempo_ = 0.0f;
  std::vector<std::array<int, 2>> input_pin_map_;
  std::vector<std::array<int, 2>> output_pin_map_;
  std::string setting_key_;
  std::vector<uint8_t> chunk_buffer_;
};

}  // namespace plugcore
