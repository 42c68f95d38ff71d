#include "host/vst2_win_plugin.h"

#include "config/system_services.h"
#include "guikit/platform_window.h"
#include "host/vst2_win_editor.h"
#include "midi/mci_midi_dev_sel_comp.h"
#include "midi/midi_dev_sel_dispatcher.h"
#include "midi/midi_port_driver_interface.h"

namespace plugcore {

Vst2WinPlugin::Vst2WinPlugin(Vst2HostCallback host, DspInterface* dsp, GuiInterface* gui,
                             MidiReceiverInterface* midi_receiver, const BankManager& static_bank, int32_t unique_id)
    : Vst2Plugin(host, dsp, gui, midi_receiver, static_bank, unique_id) {
  if (gui != nullptr) {
    // The bridge registers itself as the editor and raises the has-editor flag.
    editor_bridge_ = new Vst2WinEditor(this, gui, guikit::create_platform_window(guikit::Size{100, 100}));
  }
  if (midi_mgr_ != nullptr) {
    system_midi_comp_ = new MciMidiDevSelComp(midi_mgr_, sys::make_system_midi_driver());
    midi_dispatcher_->add_component(system_midi_comp_);
  }
}

Vst2WinPlugin::~Vst2WinPlugin() {
  // The window goes before the editor object whose controls it shows.
  if (editor_bridge_ != nullptr) {
    setEditor(nullptr);
    delete editor_bridge_;
    editor_bridge_ = nullptr;
  }
  if (midi_dispatcher_ != nullptr) {
    midi_dispatcher_->close_all();  // no device of the component may stay in use
  }
  delete system_midi_comp_;
}

void Vst2WinPlugin::set_tempo(double bpm) {
  // The editor bridge takes the tempo over to the editor's thread.
  if (editor_bridge_ != nullptr) {
    editor_bridge_->set_tempo(bpm);
  }
}

std::string Vst2WinPlugin::get_base_directory() {
  const char* directory = getDirectory();
  if (directory != nullptr && directory[0] != 0) {
    return directory;
  }
  return sys::get_module_directory();
}

}  // namespace plugcore
