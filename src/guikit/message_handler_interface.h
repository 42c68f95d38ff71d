#pragma once

#include <cstdint>

namespace guikit {

class MessageInterface;

// The single entry point of every node, control and window: 0 handled, -1 not
// handled or failed (a control may answer other values of its own).
class MessageHandlerInterface {
 public:
  virtual ~MessageHandlerInterface() = default;
  virtual int32_t process_message(MessageInterface& message) = 0;
};

}  // namespace guikit
