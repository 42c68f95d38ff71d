#pragma once

#include "host/host_dsp_interface.h"

namespace plugcore {

class Vst2Plugin;

// What the engine may ask of the host, answered through the plug-in's host callback.
class HostDspVst2Win : public HostDspInterface {
 public:
  void set_plugin(Vst2Plugin* plugin) { plugin_ = plugin; }

  int init() override { return 0; }
  double get_property_num(const char* key) override;
  void get_tempo(TempoQuery& query) override;
  bool is_input_connected(int group, int pin) override;
  bool is_output_connected(int group, int pin) override;
  MidiMgr* use_midi_mgr() override;

 private:
  Vst2Plugin* plugin_ = nullptr;
};

}  // namespace plugcore
