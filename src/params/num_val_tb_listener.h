#pragma once

#include "params/num_param_listener.h"

namespace plugcore {

// The value box's listener of a parameter group. When an edit is accepted
// (event code 2) the typed text is read in the parameter's units and sent to the
// group's knob as a mouse change, so it takes the same path as a drag; a text
// that cannot be read, or a change the knob refuses, puts the value text back.
class NumValTbListener : public NumParamListener {
 public:
  static constexpr int32_t kEventEditAccepted = 2;
  void on_event(int32_t code, int32_t argument) override;
};

}  // namespace plugcore
