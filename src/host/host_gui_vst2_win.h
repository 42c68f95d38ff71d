#pragma once

#include "host/host_gui_interface.h"

namespace plugcore {

class Vst2Plugin;

// What the editor may ask of the host and of the core.
class HostGuiVst2Win : public HostGuiInterface {
 public:
  void set_plugin(Vst2Plugin* plugin) { plugin_ = plugin; }

  void init() override {}
  double get_property_num(const char* key) override;
  std::string get_property_str(const char* key) override;
  bool can_set_param(int index, int priority) override;
  bool lock_param(int index, int priority) override;
  void release_param(int index, int priority) override;
  bool set_param_automated(int index, float norm, int priority) override;
  void apply_program(const ProgramSlot& program, int priority) override;
  int resize_window(int width, int height) override;
  std::string get_setting_path() override;
  MidiMgr* use_midi_mgr() override;
  MidiDevSelectorInterface* use_midi_dev_selector() override;

 private:
  Vst2Plugin* plugin_ = nullptr;
};

}  // namespace plugcore
