#pragma once

namespace guikit {
class ControlInterface;
class TextBox;
}  // namespace guikit

namespace plugcore {

// The controls that show one parameter: a knob (or any pot) and up to three text
// boxes for its name, unit and value. Every accessor answers null when the group
// has no such control. show_texts writes the parameter's name, unit and value
// text into the boxes the group has.
class NumParamMgrInterface {
 public:
  virtual ~NumParamMgrInterface() = default;
  virtual guikit::ControlInterface* use_knob() = 0;
  virtual guikit::TextBox* use_name_box() = 0;
  virtual guikit::TextBox* use_unit_box() = 0;
  virtual guikit::TextBox* use_value_box() = 0;
  virtual void show_texts() = 0;
};

}  // namespace plugcore
