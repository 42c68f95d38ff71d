#pragma once

namespace plugcore {

class SetupMgr;

// A part of the setup menu: knows the setup manager whose state it acts on.
class SetupComponent {
 public:
  explicit SetupComponent(SetupMgr& mgr) : mgr_(mgr) {}
  SetupMgr& use_setup_mgr() const { return mgr_; }

 protected:
  SetupMgr& mgr_;
};

}  // namespace plugcore
