#pragma once

#include <atomic>
#include <string>

namespace plugcore {

// The MIDI manager's per-user switches. Read by decoding threads, changed on
// the editor thread: plain relaxed atomics.
class MidiSettings {
 public:
  MidiSettings();

  int get_nrpn_compatibility() const { return nrpn_compatibility_.load(std::memory_order_relaxed); }
  int get_autobind_mode() const { return autobind_mode_.load(std::memory_order_relaxed); }
  bool is_loaded() const { return loaded_.load(std::memory_order_relaxed); }

  // Reads both switches from the per-user store under "Velmora/<plug-in name>".
  void load(const std::string& plugin_name);
  // Take the new value only when the store took it.
  bool set_nrpn_compatibility(int value);
  bool set_autobind_mode(int value);
  // Values for tests and offline hosts that must not touch the store.
  void set_values(int nrpn_compatibility, int autobind_mode);

  // The start value of NRPN compatibility for every manager made afterwards.
  static void set_default_nrpn_compatibility(int value);
  static int get_default_nrpn_compatibility();

  static constexpr const char* kNrpnName = "NRPN Compatibility";
  static constexpr const char* kAutobindName = "Autobind Mode";

 private:
  std::atomic<int> nrpn_compatibility_;
  std::atomic<int> autobind_mode_{1};
  std::atomic<bool> loaded_{false};
  std::string path_;
};

}  // namespace plugcore
