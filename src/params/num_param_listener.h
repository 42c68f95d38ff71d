#pragma once

#include "params/listener_base.h"

namespace plugcore {

class NumParamMgrInterface;

// A parameter listener that belongs to the group of controls showing its
// parameter (knob, name, unit and value boxes), or to none.
class NumParamListener : public ListenerBase {
 public:
  NumParamMgrInterface* use_param_mgr() const { return mgr_; }
  void set_param_mgr(NumParamMgrInterface* mgr) { mgr_ = mgr; }

 private:
  NumParamMgrInterface* mgr_ = nullptr;
};

}  // namespace plugcore
