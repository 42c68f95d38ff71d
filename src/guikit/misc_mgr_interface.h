#pragma once

#include <cstdint>

namespace guikit {

class MessageInterface;
class DefaultEventListener;

// A forwarding target behind a listener (band linking and the like).
class MiscMgrInterface {
 public:
  virtual ~MiscMgrInterface() = default;
  virtual void on_value(double value, int32_t origin) = 0;
  virtual void on_before_message(MessageInterface& message) = 0;
  virtual void on_after_message(MessageInterface& message) = 0;
  // Told which listener forwards to it.
  virtual void set_owner(DefaultEventListener* owner) = 0;
};

}  // namespace guikit
