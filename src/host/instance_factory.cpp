#include "host/instance_factory.h"

#include <exception>
#include <memory>
#include <stdexcept>

#include "config/system_services.h"
#include "dsp/brakmorph_dsp.h"
#include "editor/brakmorph_gui.h"
#include "host/host_dsp_vst2_win.h"
#include "host/host_gui_vst2_win.h"
#include "host/vst2_win_plugin.h"
#include "midi/midi_settings.h"
#include "presets/bank_file.h"

namespace plugcore {

namespace {

constexpr int32_t kUniqueId = 0x56626D78;  // 'Vbmx'
const char kSettingKey[] = "Velmora\\Brakmorph VST2";

BankManager load_static_bank() {
  const sys::Resource resource = sys::get_resource("VLPB", "static_presets");
  BankManager bank;
  if (!resource || load_bank_mem(resource.data, static_cast<int>(resource.size), bank, false) != 0) {
    throw std::runtime_error("plugcore::create_instance() : Cannot load the static bank.");
  }
  return bank;
}

}  // namespace

AEffect* create_instance(Vst2HostCallback host) {
  if (host == nullptr || host(nullptr, audioMasterVersion, 0, 0, nullptr, 0.0f) == 0) {
    return nullptr;
  }
  std::unique_ptr<BrakmorphDsp> dsp;
  std::unique_ptr<HostDspVst2Win> host_dsp;
  std::unique_ptr<BrakmorphGui> gui;
  std::unique_ptr<HostGuiVst2Win> host_gui;
  Vst2WinPlugin* plugin = nullptr;
  try {
    MidiSettings::set_default_nrpn_compatibility(0);
    dsp = std::make_unique<BrakmorphDsp>();
    host_dsp = std::make_unique<HostDspVst2Win>();
    gui = std::make_unique<BrakmorphGui>();
    host_gui = std::make_unique<HostGuiVst2Win>();
    const BankManager static_bank = load_static_bank();

    MidiReceiverInterface* receiver = dsp.get();
    plugin = new Vst2WinPlugin(host, dsp.get(), gui.get(), receiver, static_bank, kUniqueId);
    BrakmorphDsp* engine = dsp.release();  // the plug-in owns the engine and the editor from here
    BrakmorphGui* editor = gui.release();

    host_dsp->set_plugin(plugin);
    engine->set_host_dsp(host_dsp.release());  // the engine owns its adapter
    host_gui->set_plugin(plugin);
    editor->set_host_gui(host_gui.release());  // the editor owns its adapter
    engine->set_gui(editor);
    editor->set_dsp(engine);

    plugin->set_setting_key(kSettingKey);
    plugin->init_instance();
    plugin->set_default_state();
    return plugin->getAeffect();
  } catch (const std::exception& error) {
    sys::debug_output(error.what());
    sys::debug_output("\n");
    delete plugin;
    return nullptr;
  }
}

}  // namespace plugcore
