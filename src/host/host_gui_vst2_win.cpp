#include "host/host_gui_vst2_win.h"

#include <cstring>

#include "host/vst2_plugin.h"
#include "midi/midi_dev_sel_dispatcher.h"

namespace plugcore {

namespace {
const char kInterfaceInfo[] = "VST is a trademark of Steinberg Media AG.\nhttps://www.steinberg.net";
}

double HostGuiVst2Win::get_property_num(const char* key) {
  if (plugin_ != nullptr && key != nullptr && std::strcmp(key, "can_resize_window") == 0) {
    // Answered from the host: only a host that can size its window is asked to.
    return plugin_->canHostDo("sizeWindow") > 0 ? 1.0 : 0.0;
  }
  return 0.0;
}

std::string HostGuiVst2Win::get_property_str(const char* key) {
  if (key == nullptr) {
    return std::string();
  }
  if (std::strcmp(key, "interface_standard") == 0) {
    return "VST 2.0";
  }
  if (std::strcmp(key, "interface_info") == 0) {
    return kInterfaceInfo;
  }
  return std::string();
}

bool HostGuiVst2Win::can_set_param(int index, int priority) { return plugin_->can_set_param(index, priority); }

bool HostGuiVst2Win::lock_param(int index, int priority) { return plugin_->lock_param(index, priority); }

void HostGuiVst2Win::release_param(int index, int priority) { plugin_->release_param(index, priority); }

bool HostGuiVst2Win::set_param_automated(int index, float norm, int priority) {
  return plugin_->set_param_automated(index, norm, priority);
}

void HostGuiVst2Win::apply_program(const ProgramSlot& program, int priority) {
  plugin_->apply_program(program, priority, false, true);
}

int HostGuiVst2Win::resize_window(int width, int height) {
  if (get_property_num("can_resize_window") != 0.0 && !plugin_->sizeWindow(width, height)) {
    return -1;
  }
  // The editor window itself follows with the editor bridge.
  return 0;
}

std::string HostGuiVst2Win::get_setting_path() {
#if defined(_WIN32)
  const char* separator = "\\";
#else
  const char* separator = "/";
#endif
  return plugin_->get_base_directory() + separator + plugin_->get_setting_key();
}

MidiMgr* HostGuiVst2Win::use_midi_mgr() { return plugin_->use_midi_mgr(); }

MidiDevSelectorInterface* HostGuiVst2Win::use_midi_dev_selector() { return plugin_->use_midi_dispatcher(); }

}  // namespace plugcore
