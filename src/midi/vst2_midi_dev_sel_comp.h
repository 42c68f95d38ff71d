#pragma once

#include <memory>

#include "midi/midi_dev_sel_comp_interface.h"
#include "midi/vst2_midi_ports.h"

namespace plugcore {

class MidiMgr;

// The host's MIDI: one input and one output, carried by processEvents and
// audioMasterProcessEvents.
class Vst2MidiDevSelComp : public MidiDevSelCompInterface, public Vst2Component {
 public:
  static constexpr const char* kInputName = "VST MIDI In interface";
  static constexpr const char* kOutputName = "VST MIDI Out interface";

  explicit Vst2MidiDevSelComp(MidiMgr* mgr);
  ~Vst2MidiDevSelComp() override;

  void set_plugin(AudioEffectX* plugin);
  int init() override { return 0; }
  int list_inputs(int first_index, std::vector<std::string>& names) override;
  int list_outputs(int first_index, std::vector<std::string>& names) override;
  int open_input(int index, MidiInInterface*& device) override;
  int open_output(int index, MidiOutInterface*& device) override;
  int close_input() override;
  int close_output() override;

  Vst2MidiIn& use_input() { return input_; }
  Vst2MidiOut& use_output() { return output_; }

 private:
  int first_input_ = 0;
  int first_output_ = 0;
  Vst2MidiIn input_;
  Vst2MidiOut output_;
};

}  // namespace plugcore
