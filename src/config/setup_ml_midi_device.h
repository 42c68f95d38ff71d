#pragma once

#include "config/setup_menu_listener.h"

namespace plugcore {

// One entry of a MIDI port submenu: selects its port (-1 = none) in its direction.
class SetupMLMidiDevice : public SetupMenuListener {
 public:
  SetupMLMidiDevice(SetupMgr& mgr, bool output, int index) : SetupMenuListener(mgr), output_(output), index_(index) {}
  void on_select() override;
  bool is_output() const { return output_; }
  int get_index() const { return index_; }
  void set_index(int index) { index_ = index; }

 private:
  bool output_;
  int index_;
};

}  // namespace plugcore
