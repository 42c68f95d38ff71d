#include "midi/midi_settings.h"

#include "config/persistent_key_list.h"

namespace plugcore {

namespace {
std::atomic<int> g_default_nrpn_compatibility{0};
}

MidiSettings::MidiSettings() : nrpn_compatibility_(g_default_nrpn_compatibility.load(std::memory_order_relaxed)) {}

void MidiSettings::set_default_nrpn_compatibility(int value) {
  g_default_nrpn_compatibility.store(value != 0 ? 1 : 0, std::memory_order_relaxed);
}

int MidiSettings::get_default_nrpn_compatibility() { return g_default_nrpn_compatibility.load(std::memory_order_relaxed); }

void MidiSettings::load(const std::string& plugin_name) {
  path_ = "Velmora/" + plugin_name;
  nrpn_compatibility_.store(sys::read_persistent_switch(path_, kNrpnName, get_nrpn_compatibility()),
                            std::memory_order_relaxed);
  autobind_mode_.store(sys::read_persistent_switch(path_, kAutobindName, get_autobind_mode()),
                       std::memory_order_relaxed);
  loaded_.store(true, std::memory_order_relaxed);
}

bool MidiSettings::set_nrpn_compatibility(int value) {
  if (!path_.empty() && !sys::write_persistent_switch(path_, kNrpnName, value)) return false;
  nrpn_compatibility_.store(value != 0 ? 1 : 0, std::memory_order_relaxed);
  return true;
}

bool MidiSettings::set_autobind_mode(int value) {
  if (!path_.empty() && !sys::write_persistent_switch(path_, kAutobindName, value)) return false;
  autobind_mode_.store(value != 0 ? 1 : 0, std::memory_order_relaxed);
  return true;
}

void MidiSettings::set_values(int nrpn_compatibility, int autobind_mode) {
  nrpn_compatibility_.store(nrpn_compatibility != 0 ? 1 : 0, std::memory_order_relaxed);
  autobind_mode_.store(autobind_mode != 0 ? 1 : 0, std::memory_order_relaxed);
}

}  // namespace plugcore
