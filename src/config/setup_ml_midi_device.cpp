#include "config/setup_ml_midi_device.h"

#include <string>

#include "config/setup_mgr.h"
#include "config/simple_message_box.h"
#include "midi/midi_dev_sel_dispatcher.h"

namespace plugcore {

void SetupMLMidiDevice::on_select() {
  MidiDevSelectorInterface* selection = mgr_.use_port_selection();
  if (selection == nullptr) return;
  const int result = output_ ? selection->select_output(index_) : selection->select_input(index_);
  if (result != 0) {
    sys::SimpleMessageBox::show("Error", "Can't change MIDI device.\n\n\nCode " + std::to_string(result),
                                sys::SimpleMessageBox::kOk, 0);
  }
  // The ticks follow the selection as it now is.
  mgr_.refresh();
}

}  // namespace plugcore
