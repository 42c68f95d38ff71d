#include "guikit/ctrl_group_item.h"

#include <algorithm>

#include "guikit/control_interface.h"

namespace guikit {

// A group that was never placed lends its controls the origin.
Point CtrlGroupItem::placed_position() const {
  return position_.x == kUnset ? Point{0, 0} : position_;
}

void CtrlGroupItem::set_position(Point point) {
  position_ = point;
  for (auto* c : controls_) c->set_group_position(placed_position());
}

void CtrlGroupItem::add_control(ControlInterface* control) {
  if (!control) return;
  controls_.push_back(control);
  control->set_group(this, placed_position());
  ShowObject show(visible_);
  control->process_message(show);
}

int32_t CtrlGroupItem::remove_control(ControlInterface* control) {
  auto it = std::find(controls_.begin(), controls_.end(), control);
  if (it == controls_.end()) return -1;
  ShowObject hide(false);
  control->process_message(hide);
  control->set_group(nullptr, Point{0, 0});
  controls_.erase(it);
  return 0;
}

int32_t CtrlGroupItem::process_message_down(MessageInterface& message) {
  auto* down = dynamic_cast<MessageDown*>(&message);
  if (!down || controls_.empty()) return -1;
  // Visibility concerns every control, whatever the area.
  if (dynamic_cast<ShowObject*>(&message)) {
    for (auto* c : controls_) c->process_message(message);
    return 0;
  }
  const Rect& a = down->area;
  if (down->is_point()) {
    for (auto* c : controls_) {
      if (c->is_inside(Point{a.left, a.top})) return c->process_message(message);
    }
    return -1;
  }
  consumed_ = false;
  int32_t answer = 0;
  for (auto* c : controls_) {
    if (consumed_) break;
    const Rect& b = c->get_bounding_box();
    Point p = c->get_position();
    Rect r{b.left + p.x, b.top + p.y, b.right + p.x, b.bottom + p.y};
    if (r.right > a.left && r.left < a.right && r.bottom > a.top && r.top < a.bottom) answer = c->process_message(message);
  }
  return answer;
}

}  // namespace guikit
