#pragma once

#include <cstdint>

#include "guikit/message_handler_interface.h"
#include "guikit/rect.h"

namespace guikit {

// One editor window: the two tree roots it paints and feeds with the mouse,
// and the carrier of every upward message.
class WindowInterface : public MessageHandlerInterface {
 public:
  ~WindowInterface() override = default;
  virtual int32_t open(void* parent) = 0;
  virtual void close() = 0;
  virtual void resize() = 0;
  virtual void set_roots(MessageHandlerInterface* background, MessageHandlerInterface* controls) = 0;
  virtual void set_editor_size(Size size) = 0;
  // The size the window takes when it may not follow the editor's size.
  virtual void set_window_size(Size size) = 0;
  // true: the window opens at the editor size; false: at the window size.
  virtual void set_can_resize(bool can_resize) = 0;
  // Called from the host's idle on the user-interface thread: windows whose
  // events and timers are not delivered by the system do their work here.
  virtual void idle() = 0;
};

}  // namespace guikit
