#pragma once

#include "params/num_param_mgr_interface.h"

namespace plugcore {

class NormalizedParamInterface;

// The plain parameter group: the controls are set once and not owned.
class NumParamMgr : public NumParamMgrInterface {
 public:
  void set_param(NormalizedParamInterface* param) { param_ = param; }
  void set_knob(guikit::ControlInterface* knob) { knob_ = knob; }
  void set_boxes(guikit::TextBox* name, guikit::TextBox* unit, guikit::TextBox* value) {
    name_ = name;
    unit_ = unit;
    value_ = value;
  }

  guikit::ControlInterface* use_knob() override { return knob_; }
  guikit::TextBox* use_name_box() override { return name_; }
  guikit::TextBox* use_unit_box() override { return unit_; }
  guikit::TextBox* use_value_box() override { return value_; }
  // The value text is that of the parameter's current natural value.
  void show_texts() override;

 private:
  NormalizedParamInterface* param_ = nullptr;
  guikit::ControlInterface* knob_ = nullptr;
  guikit::TextBox* name_ = nullptr;
  guikit::TextBox* unit_ = nullptr;
  guikit::TextBox* value_ = nullptr;
};

}  // namespace plugcore
