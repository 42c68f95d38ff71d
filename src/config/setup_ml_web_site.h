#pragma once

#include "config/setup_menu_listener.h"

namespace plugcore {

// A web entry: opens the address the web-jump service builds for its code.
class SetupMLWebSite : public SetupMenuListener {
 public:
  SetupMLWebSite(SetupMgr& mgr, int code) : SetupMenuListener(mgr), code_(code) {}
  void on_select() override;
  int get_code() const { return code_; }

 private:
  int code_;
};

}  // namespace plugcore
