#pragma once

#include "host/vst2_plugin.h"

namespace plugcore {

class MciMidiDevSelComp;
class Vst2WinEditor;

// The plug-in as the entry point builds it: adds the editor bridge and the system
// MIDI ports to the portable core once those exist for the instance.
class Vst2WinPlugin : public Vst2Plugin {
 public:
  Vst2WinPlugin(Vst2HostCallback host, DspInterface* dsp, GuiInterface* gui, MidiReceiverInterface* midi_receiver,
                const BankManager& static_bank, int32_t unique_id);
  ~Vst2WinPlugin() override;

  void set_tempo(double bpm) override;
  std::string get_base_directory() override;
  MciMidiDevSelComp* use_system_midi_comp() { return system_midi_comp_; }
  Vst2WinEditor* use_editor_bridge() { return editor_bridge_; }

 private:
  Vst2WinEditor* editor_bridge_ = nullptr;  // also the AudioEffect's editor
  MciMidiDevSelComp* system_midi_comp_ = nullptr;
};

}  // namespace plugcore
