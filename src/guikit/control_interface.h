#pragma once

#include <cstdint>
#include <vector>

#include "guikit/bounding_box_checker.h"
#include "guikit/event_listener_interface.h"
#include "guikit/message_handler_interface.h"
#include "guikit/messages.h"
#include "guikit/picture.h"

namespace guikit {

class CtrlGroupItem;

// A leaf of the control tree: a value 0..1, a list of listeners every change
// passes through, and one handler per message class.
class ControlInterface : public BoundingBoxDefaultChecker, public MessageHandlerInterface {
 public:
  ControlInterface() = default;
  ControlInterface(const ControlInterface&) = delete;
  ControlInterface& operator=(const ControlInterface&) = delete;
  ~ControlInterface() override = default;

  // The point is in editor pixels; the bounding box is relative to the control.
  bool is_inside(Point point) const override;
  virtual int32_t request_redraw() { return invalidate_self(); }
  virtual void stop() {}
  virtual void set_active(bool active) {}
  virtual void on_spare_hook() {}
  virtual void on_highlight() {}
  virtual int32_t on_invalidate(Invalidate& msg) { return pass_up(msg); }
  virtual int32_t on_redraw(Redraw& msg) { return -1; }
  virtual int32_t on_mouse_capture(MouseCapture& msg) { return pass_up(msg); }
  virtual int32_t on_mouse_release(MouseRelease& msg) { return pass_up(msg); }
  virtual int32_t on_mouse_capture_lost(MouseCaptureLost& msg) { return -1; }
  virtual int32_t on_mouse_move(MouseMove& msg) { return -1; }
  virtual int32_t on_mouse_click(MouseClick& msg) { return -1; }
  virtual int32_t on_set_timer(SetTimer& msg) { return pass_up(msg); }
  virtual int32_t on_clear_timer(ClearTimer& msg) { return pass_up(msg); }
  virtual int32_t on_notify(Notify& msg) { return -1; }
  virtual int32_t on_key_pressed(KeyPressed& msg) { return -1; }
  virtual int32_t on_text_input_finished(TextInputFinished& msg) { return -1; }
  virtual int32_t on_show_object(ShowObject& msg) { return -1; }
  virtual int32_t invalidate_self();

  int32_t process_message(MessageInterface& message) override;

  // Listeners (not owned). The three changing operations throw while the
  // control is busy with its listeners or its dispatch.
  void set_listener(EventListenerInterface* listener);
  void push_back_listener(EventListenerInterface* listener);
  void remove_listener(EventListenerInterface* listener);
  void add_unique_listener(EventListenerInterface* listener);
  EventListenerInterface* get_first_listener() const { return listeners_.empty() ? nullptr : listeners_.front(); }
  size_t get_listener_count() const { return listeners_.size(); }

  // Both answer false when a listener vetoed the change.
  bool set_value_by_user(double value, int32_t origin);
  bool set_value(double value, int32_t origin);
  double get_value() const { return value_; }

  void end_gesture();

  // Placement in the tree.
  void set_offset(Point offset);
  Point get_offset() const { return offset_; }
  Point get_position() const { return position_; }
  void set_group(CtrlGroupItem* group, Point group_position);
  void set_group_position(Point group_position);
  CtrlGroupItem* get_group() const { return group_; }

  bool is_visible() const { return visible_; }
  bool is_active() const { return active_; }
  bool is_busy() const { return busy_; }
  void set_highlight(bool on);
  bool is_highlighted() const { return highlighted_; }
  void set_placed(bool placed) { placed_ = placed; }
  bool is_placed() const { return placed_; }
  void set_repaint_on_change(bool on) { repaint_on_change_ = on; }

  void set_markers(const std::vector<Picture>& markers) { markers_ = markers; }
  void set_marker(int32_t index);
  int32_t get_marker() const { return marker_; }

 protected:
  int32_t pass_up(MessageInterface& msg);
  // Sends an upward message through this control's own dispatch.
  int32_t send_up(MessageInterface& msg) { return process_message(msg); }
  void draw_marker(Redraw& msg);

  // The listener protocol, each walk guarded by the busy flag.
  bool all_can_change(int32_t origin);
  void each_hold_change(int32_t origin);
  void each_end_change(int32_t origin);
  void each_event(int32_t code, int32_t argument);

  double value_ = 0.0;
  Point position_;
  Point offset_;
  Point group_position_;
  bool visible_ = true;
  bool active_ = false;
  bool highlighted_ = false;
  CtrlGroupItem* group_ = nullptr;
  std::vector<EventListenerInterface*> listeners_;
  bool placed_ = false;
  bool repaint_on_change_ = true;
  bool busy_ = false;
  std::vector<Picture> markers_;
  int32_t marker_ = -1;

 private:
  bool change_value(double value, int32_t origin, bool by_user);
  class BusyScope;
};

}  // namespace guikit
