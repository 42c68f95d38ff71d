#pragma once

#include <cstdint>

namespace guikit {

class ControlInterface;
class MessageInterface;

// Origins carried with value changes.
enum ChangeOrigin : int32_t { kOriginSync = 1, kOriginMeter = 2, kOriginGlide = 50, kOriginMouse = 200 };

// Everything a control reports; every change of value passes through these.
class EventListenerInterface {
 public:
  virtual ~EventListenerInterface() = default;
  virtual void clicked() = 0;
  virtual void released() = 0;
  virtual bool can_change(int32_t origin) = 0;
  virtual void hold_change(int32_t origin) = 0;
  virtual void end_change(int32_t origin) = 0;
  virtual double value_changed(double value, int32_t origin) = 0;
  virtual double filter_user_value(double value, int32_t origin) = 0;
  virtual double filter_set_value(double value, int32_t origin) = 0;
  virtual void on_event(int32_t code, int32_t argument) = 0;
  virtual double to_display(double value) = 0;
  virtual double from_display(double value) = 0;
  virtual void before_message(MessageInterface& message) = 0;
  virtual void after_message(MessageInterface& message) = 0;
  virtual void set_control(ControlInterface* control) = 0;
  virtual ControlInterface* get_control() = 0;
};

}  // namespace guikit
