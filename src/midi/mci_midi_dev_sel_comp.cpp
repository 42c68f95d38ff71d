#include "midi/mci_midi_dev_sel_comp.h"

#include "midi/midi_mgr.h"

namespace plugcore {

MciMidiDevSelComp::MciMidiDevSelComp(MidiMgr* mgr, std::unique_ptr<sys::MidiPortDriverInterface> driver)
    : mgr_(mgr), driver_(std::move(driver)) {}

MciMidiDevSelComp::~MciMidiDevSelComp() {
  close_input();
  close_output();
}

int MciMidiDevSelComp::list_inputs(int first_index, std::vector<std::string>& names) {
  first_input_ = first_index;
  const size_t before = names.size();
  const int status = driver_ != nullptr ? driver_->list_inputs(names) : 0;
  nbr_inputs_ = static_cast<int>(names.size() - before);
  return status;
}

int MciMidiDevSelComp::list_outputs(int first_index, std::vector<std::string>& names) {
  first_output_ = first_index;
  const size_t before = names.size();
  const int status = driver_ != nullptr ? driver_->list_outputs(names) : 0;
  nbr_outputs_ = static_cast<int>(names.size() - before);
  return status;
}

int MciMidiDevSelComp::open_input(int index, MidiInInterface*& device) {
  device = nullptr;
  const int port = index - first_input_;
  if (port < 0 || port >= nbr_inputs_ || close_input() != 0) return -1;
  input_ = std::make_unique<MciMidiIn>(mgr_->use_engine_receiver(), mgr_, driver_.get(), port);
  device = input_.get();
  return 0;
}

int MciMidiDevSelComp::open_output(int index, MidiOutInterface*& device) {
  device = nullptr;
  const int port = index - first_output_;
  if (port < 0 || port >= nbr_outputs_ || close_output() != 0) return -1;
  output_ = std::make_unique<MciMidiOut>(&mgr_->use_settings(), driver_.get(), port);
  device = output_.get();
  return 0;
}

int MciMidiDevSelComp::close_input() {
  if (!input_) return 0;
  const int status = input_->close();
  if (status == 0) input_.reset();
  return status;
}

int MciMidiDevSelComp::close_output() {
  if (!output_) return 0;
  const int status = output_->close();
  if (status == 0) output_.reset();
  return status;
}

}  // namespace plugcore
