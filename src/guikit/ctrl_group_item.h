#pragma once

#include <cstdint>
#include <vector>

#include "guikit/sp_tree_node.h"

namespace guikit {

class ControlInterface;

// A leaf of the control tree holding controls in insertion order. A point
// (mouse) goes to the first control that contains it; an area to every control
// it overlaps.
class CtrlGroupItem : public CtrlGroupNodeInterface {
 public:
  int32_t process_message_down(MessageInterface& message) override;
  void set_position(Point point) override;

  void add_control(ControlInterface* control);
  // -1 when the control is not in the group.
  int32_t remove_control(ControlInterface* control);
  size_t get_control_count() const { return controls_.size(); }
  ControlInterface* get_control(size_t index) const { return index < controls_.size() ? controls_[index] : nullptr; }
  void set_consumed() { consumed_ = true; }

 private:
  Point placed_position() const;

  std::vector<ControlInterface*> controls_;
  bool consumed_ = false;
};

}  // namespace guikit
