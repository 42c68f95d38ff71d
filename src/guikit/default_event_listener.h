#pragma once

#include "guikit/event_listener_interface.h"
#include "guikit/misc_mgr_interface.h"

namespace guikit {

// Does nothing, lets every change through unchanged, and forwards values and
// messages to an optional target.
class DefaultEventListener : public EventListenerInterface {
 public:
  void clicked() override {}
  void released() override {}
  bool can_change(int32_t) override { return true; }
  void hold_change(int32_t) override {}
  void end_change(int32_t) override {}
  double value_changed(double value, int32_t origin) override {
    if (next_) next_->on_value(value, origin);
    return value;
  }
  double filter_user_value(double value, int32_t) override { return value; }
  double filter_set_value(double value, int32_t) override { return value; }
  void on_event(int32_t, int32_t) override {}
  double to_display(double value) override { return value; }
  double from_display(double value) override { return value; }
  void before_message(MessageInterface& message) override {
    if (next_) next_->on_before_message(message);
  }
  void after_message(MessageInterface& message) override {
    if (next_) next_->on_after_message(message);
  }
  void set_control(ControlInterface* control) override { control_ = control; }
  ControlInterface* get_control() override { return control_; }

  void set_next(MiscMgrInterface* next) {
    next_ = next;
    if (next_) next_->set_owner(this);
  }
  MiscMgrInterface* get_next() const { return next_; }

 private:
  ControlInterface* control_ = nullptr;
  MiscMgrInterface* next_ = nullptr;
};

}  // namespace guikit
