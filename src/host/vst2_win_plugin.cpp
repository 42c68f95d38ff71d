#include "host/vst2_win_plugin.h"

#include "config/system_services.h"

namespace plugcore {

Vst2WinPlugin::Vst2WinPlugin(Vst2HostCallback host, DspInterface* dsp, GuiInterface* gui,
                             MidiReceiverInterface* midi_receiver, const BankManager& static_bank, int32_t unique_id)
    : Vst2Plugin(host, dsp, gui, midi_receiver, static_bank, unique_id) {}

Vst2WinPlugin::~Vst2WinPlugin() = default;

void Vst2WinPlugin::set_tempo(double bpm) {
  // The editor bridge takes the tempo over to the editor's thread once it exists.
}

std::string Vst2WinPlugin::get_base_directory() {
  const char* directory = getDirectory();
  if (directory != nullptr && directory[0] != 0) {
    return directory;
  }
  return sys::get_module_directory();
}

}  // namespace plugcore
