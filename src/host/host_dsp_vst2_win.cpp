#include "host/host_dsp_vst2_win.h"

#include <cstring>

#include "host/vst2_plugin.h"

namespace plugcore {

double HostDspVst2Win::get_property_num(const char* key) {
  if (plugin_ == nullptr || key == nullptr) {
    return 0.0;
  }
  if (std::strcmp(key, "can_tempo") == 0) {
    const VstTimeInfo* info = plugin_->getTimeInfo(kVstTempoValid);
    return info != nullptr && (info->flags & kVstTempoValid) != 0 ? 1.0 : 0.0;
  }
  if (std::strcmp(key, "param_quantization") == 0) {
    const int32_t q = plugin_->getParameterQuantization();
    return q > 1 ? 1.0 / q : 0.0;
  }
  return 0.0;
}

void HostDspVst2Win::get_tempo(TempoQuery& query) {
  const VstTimeInfo* info = plugin_ != nullptr ? plugin_->getTimeInfo(query.wanted ? kVstTempoValid : 0) : nullptr;
  if (info == nullptr) {
    query.error = true;
    return;
  }
  query.error = false;
  if ((info->flags & kVstTempoValid) != 0) {
    query.tempo = info->tempo;
  } else {
    query.wanted = false;
  }
}

bool HostDspVst2Win::is_input_connected(int group, int pin) {
  const int host_pin = plugin_ != nullptr ? plugin_->get_host_pin(false, group, pin) : -1;
  return host_pin >= 0 && plugin_->isInputConnected(host_pin);
}

bool HostDspVst2Win::is_output_connected(int group, int pin) {
  const int host_pin = plugin_ != nullptr ? plugin_->get_host_pin(true, group, pin) : -1;
  return host_pin >= 0 && plugin_->isOutputConnected(host_pin);
}

MidiMgr* HostDspVst2Win::use_midi_mgr() { return plugin_ != nullptr ? plugin_->use_midi_mgr() : nullptr; }

}  // namespace plugcore
