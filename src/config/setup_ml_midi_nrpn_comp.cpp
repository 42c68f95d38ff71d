#include "config/setup_ml_midi_nrpn_comp.h"

#include "config/setup_mgr.h"
#include "midi/midi_mgr.h"

namespace plugcore {

void SetupMLMidiNrpnComp::on_select() {
  MidiMgr* midi = mgr_.use_midi_mgr();
  if (midi == nullptr || get_item() == nullptr) return;
  // Ticked means the old byte order (0) is in force: choosing it asks for the standard one.
  midi->use_settings().set_nrpn_compatibility(get_item()->is_checked() ? 1 : 0);
  // The tick shows what the manager now holds (unchanged when the store refused).
  get_item()->set_checked(midi->use_settings().get_nrpn_compatibility() == 0);
}

}  // namespace plugcore
