#pragma once

#include <memory>

#include "midi/mci_midi_ports.h"
#include "midi/midi_dev_sel_comp_interface.h"
#include "midi/midi_port_driver_interface.h"

namespace plugcore {

class MidiMgr;

// The system's MIDI ports, named by the driver, behind one driver per instance.
class MciMidiDevSelComp : public MidiDevSelCompInterface {
 public:
  MciMidiDevSelComp(MidiMgr* mgr, std::unique_ptr<sys::MidiPortDriverInterface> driver);
  ~MciMidiDevSelComp() override;

  int init() override { return 0; }
  int list_inputs(int first_index, std::vector<std::string>& names) override;
  int list_outputs(int first_index, std::vector<std::string>& names) override;
  int open_input(int index, MidiInInterface*& device) override;
  int open_output(int index, MidiOutInterface*& device) override;
  int close_input() override;
  int close_output() override;

  sys::MidiPortDriverInterface* use_driver() { return driver_.get(); }

 private:
  MidiMgr* mgr_;
  std::unique_ptr<sys::MidiPortDriverInterface> driver_;
  int first_input_ = 0;
  int nbr_inputs_ = 0;
  int first_output_ = 0;
  int nbr_outputs_ = 0;
  std::unique_ptr<MciMidiIn> input_;
  std::unique_ptr<MciMidiOut> output_;
};

}  // namespace plugcore
