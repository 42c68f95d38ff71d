#pragma once

#include <memory>
#include <string>
#include <vector>

namespace plugcore {

class HostGuiInterface;
class MidiAutoBindMgr;
class MidiMgr;
class NormalizedParamInterface;

// Sits on one parameter's control: a click on the control makes its
// parameter the one the next controller moved is bound to.
class MidiAutoBindListener {
 public:
  MidiAutoBindListener(MidiAutoBindMgr& mgr, int index) : mgr_(mgr), index_(index) {}
  void clicked();
  int get_index() const { return index_; }

 private:
  MidiAutoBindMgr& mgr_;
  int index_;
};

// The editor side of auto-bind: which parameter was touched last, whether
// learning is on, and the text of the setup menu's entry.
class MidiAutoBindMgr {
 public:
  // One listener per parameter, in index order; the editor attaches them to
  // its controls. The MIDI manager is reached through the host-GUI adapter.
  void init(int nbr_params, HostGuiInterface* host_gui);
  // For a core without the adapter (tests, offline hosts).
  void init(int nbr_params, MidiMgr* mgr, std::vector<NormalizedParamInterface*> params);
  bool is_initialised() const { return initialised_; }
  MidiAutoBindListener& use_listener(int index) { return *listeners_.at(static_cast<size_t>(index)); }
  int get_nbr_listeners() const { return static_cast<int>(listeners_.size()); }

  void on_param_touched(int index);
  void set_autobind(bool on);
  // Applies the one-shot rule of mode 0 first.
  bool is_autobind_on();
  NormalizedParamInterface* get_target_param();
  int get_selected() const { return selected_; }

  // "Auto-bind", then the target's name or a prompt.
  std::string get_menu_text();

 private:
  MidiMgr* use_midi_mgr();
  void apply_one_shot_rule(MidiMgr& mgr);
  void update();

  std::vector<std::unique_ptr<MidiAutoBindListener>> listeners_;
  HostGuiInterface* host_gui_ = nullptr;
  MidiMgr* direct_mgr_ = nullptr;
  std::vector<NormalizedParamInterface*> params_;
  int selected_ = -1;
  bool initialised_ = false;
  bool autobind_on_ = false;
};

}  // namespace plugcore
