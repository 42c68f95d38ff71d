#include "midi/vst2_midi_dev_sel_comp.h"

#include "midi/midi_mgr.h"

namespace plugcore {

Vst2MidiDevSelComp::Vst2MidiDevSelComp(MidiMgr* mgr)
    : input_(mgr->use_engine_receiver(), mgr), output_(&mgr->use_settings()) {}

Vst2MidiDevSelComp::~Vst2MidiDevSelComp() = default;

void Vst2MidiDevSelComp::set_plugin(AudioEffectX* plugin) {
  plugin_ = plugin;
  input_.set_plugin(plugin);
  output_.set_plugin(plugin);
}

int Vst2MidiDevSelComp::list_inputs(int first_index, std::vector<std::string>& names) {
  first_input_ = first_index;
  names.push_back(kInputName);
  return 0;
}

int Vst2MidiDevSelComp::list_outputs(int first_index, std::vector<std::string>& names) {
  first_output_ = first_index;
  names.push_back(kOutputName);
  return 0;
}

int Vst2MidiDevSelComp::open_input(int index, MidiInInterface*& device) {
  device = index == first_input_ ? &input_ : nullptr;
  return device != nullptr ? 0 : -1;
}

int Vst2MidiDevSelComp::open_output(int index, MidiOutInterface*& device) {
  device = index == first_output_ ? &output_ : nullptr;
  return device != nullptr ? 0 : -1;
}

int Vst2MidiDevSelComp::close_input() { return input_.close(); }

int Vst2MidiDevSelComp::close_output() { return output_.close(); }

}  // namespace plugcore
