#pragma once

namespace guikit {
class ControlInterface;
}

// The editor's table of bound controls, by parameter index: null for an index
// without a control.
class ParamControlFinderInterface {
 public:
  virtual ~ParamControlFinderInterface() = default;
  virtual guikit::ControlInterface* find_param_control(int index) = 0;
};
