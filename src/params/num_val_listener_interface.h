#pragma once

#include "params/num_param_listener.h"

namespace plugcore {

// The knob's listener of a parameter group: besides the parameter commands, it
// writes every shown value as the parameter's text into the group's value box.
class NumValListenerInterface : public NumParamListener {
 public:
  // The default behaviour (forwarding to the chained target), then the value text.
  double value_changed(double value, int32_t origin) override;
};

}  // namespace plugcore
