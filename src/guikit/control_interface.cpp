#include "guikit/control_interface.h"

#include <algorithm>
#include <stdexcept>

#include "guikit/ctrl_group_item.h"

namespace guikit {

class ControlInterface::BusyScope {
 public:
  explicit BusyScope(ControlInterface& c) : c_(c), previous_(c.busy_) { c_.busy_ = true; }
  ~BusyScope() { c_.busy_ = previous_; }

 private:
  ControlInterface& c_;
  bool previous_;
};

bool ControlInterface::is_inside(Point point) const {
  return BoundingBoxDefaultChecker::is_inside(Point{point.x - position_.x, point.y - position_.y});
}

int32_t ControlInterface::pass_up(MessageInterface& msg) { return group_ ? group_->process_message(msg) : -1; }

int32_t ControlInterface::invalidate_self() {
  if (!placed_) return 0;
  Invalidate inv(Rect{box_.left + position_.x, box_.top + position_.y, box_.right + position_.x,
                      box_.bottom + position_.y});
  return send_up(inv);
}

int32_t ControlInterface::process_message(MessageInterface& message) {
  BusyScope busy(*this);
  for (auto* l : listeners_) l->before_message(message);
  int32_t answer = -1;
  if (auto* m = dynamic_cast<Invalidate*>(&message)) {
    answer = on_invalidate(*m);
  } else if (auto* m = dynamic_cast<Redraw*>(&message)) {
    if (visible_) {
      answer = on_redraw(*m);
      draw_marker(*m);
    } else {
      answer = 0;
    }
  } else if (auto* m = dynamic_cast<MouseCapture*>(&message)) {
    answer = on_mouse_capture(*m);
  } else if (auto* m = dynamic_cast<MouseRelease*>(&message)) {
    answer = on_mouse_release(*m);
  } else if (auto* m = dynamic_cast<MouseCaptureLost*>(&message)) {
    answer = on_mouse_capture_lost(*m);
  } else if (auto* m = dynamic_cast<MouseMove*>(&message)) {
    answer = on_mouse_move(*m);
  } else if (auto* m = dynamic_cast<MouseClick*>(&message)) {
    if (m->buttons != 0 && visible_) {
      active_ = true;
      for (auto* l : listeners_) l->clicked();
      set_active(true);
    }
    answer = on_mouse_click(*m);
  } else if (auto* m = dynamic_cast<SetTimer*>(&message)) {
    answer = on_set_timer(*m);
  } else if (auto* m = dynamic_cast<ClearTimer*>(&message)) {
    answer = on_clear_timer(*m);
  } else if (auto* m = dynamic_cast<Notify*>(&message)) {
    answer = on_notify(*m);
  } else if (auto* m = dynamic_cast<KeyPressed*>(&message)) {
    answer = on_key_pressed(*m);
  } else if (auto* m = dynamic_cast<TextInputFinished*>(&message)) {
    answer = on_text_input_finished(*m);
  } else if (auto* m = dynamic_cast<ShowObject*>(&message)) {
    visible_ = m->visible;
    answer = on_show_object(*m);
    if (!visible_) stop();
  } else if (dynamic_cast<MessageUp*>(&message)) {
    answer = pass_up(message);
  }
  for (auto* l : listeners_) l->after_message(message);
  return answer;
}

void ControlInterface::set_listener(EventListenerInterface* listener) {
  if (busy_) throw std::runtime_error("guikit::ControlInterface::set_listener() : Recursive call.");
  listeners_.clear();
  if (listener) {
    listeners_.push_back(listener);
    listener->set_control(this);
  }
}

void ControlInterface::push_back_listener(EventListenerInterface* listener) {
  if (busy_) throw std::runtime_error("guikit::ControlInterface::push_back_listener() : Recursive call.");
  if (!listener) return;
  listeners_.push_back(listener);
  listener->set_control(this);
}

void ControlInterface::remove_listener(EventListenerInterface* listener) {
  if (busy_) throw std::runtime_error("guikit::ControlInterface::remove_listener() : Recursive call.");
  listeners_.erase(std::remove(listeners_.begin(), listeners_.end(), listener), listeners_.end());
}

void ControlInterface::add_unique_listener(EventListenerInterface* listener) {
  remove_listener(listener);
  push_back_listener(listener);
}

bool ControlInterface::change_value(double value, int32_t origin, bool by_user) {
  {
    BusyScope busy(*this);
    for (auto* l : listeners_) {
      if (!l->can_change(origin)) return false;
    }
    for (auto* l : listeners_) value = by_user ? l->filter_user_value(value, origin) : l->filter_set_value(value, origin);
    for (auto* l : listeners_) value = l->value_changed(value, origin);
  }
  value_ = value;
  if (repaint_on_change_) request_redraw();
  return true;
}

bool ControlInterface::set_value_by_user(double value, int32_t origin) { return change_value(value, origin, true); }
bool ControlInterface::set_value(double value, int32_t origin) { return change_value(value, origin, false); }

bool ControlInterface::all_can_change(int32_t origin) {
  BusyScope busy(*this);
  for (auto* l : listeners_) {
    if (!l->can_change(origin)) return false;
  }
  return true;
}

void ControlInterface::each_hold_change(int32_t origin) {
  BusyScope busy(*this);
  for (auto* l : listeners_) l->hold_change(origin);
}

void ControlInterface::each_end_change(int32_t origin) {
  BusyScope busy(*this);
  for (auto* l : listeners_) l->end_change(origin);
}

void ControlInterface::each_event(int32_t code, int32_t argument) {
  BusyScope busy(*this);
  for (auto* l : listeners_) l->on_event(code, argument);
}

void ControlInterface::end_gesture() {
  active_ = false;
  {
    BusyScope busy(*this);
    for (auto* l : listeners_) l->released();
  }
  set_active(false);
}

void ControlInterface::set_offset(Point offset) {
  offset_ = offset;
  position_ = Point{group_position_.x + offset_.x, group_position_.y + offset_.y};
}

void ControlInterface::set_group(CtrlGroupItem* group, Point group_position) {
  group_ = group;
  set_group_position(group_position);
}

void ControlInterface::set_group_position(Point group_position) {
  group_position_ = group_position;
  position_ = Point{group_position_.x + offset_.x, group_position_.y + offset_.y};
}

void ControlInterface::set_highlight(bool on) {
  highlighted_ = on;
  on_highlight();
}

void ControlInterface::set_marker(int32_t index) {
  marker_ = index;
  invalidate_self();
}

void ControlInterface::draw_marker(Redraw& msg) {
  if (marker_ < 0 || static_cast<size_t>(marker_) >= markers_.size()) return;
  markers_[static_cast<size_t>(marker_)].draw(msg, position_);
}

}  // namespace guikit
