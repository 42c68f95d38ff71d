#pragma once

#include <cstdint>
#include <string>

#include "guikit/message_handler_interface.h"
#include "guikit/rect.h"

namespace guikit {

class RenderingBufferInterface;
class MenuList;

// Messages are told apart by class (dynamic_cast), never by a numeric code.
class MessageInterface {
 public:
  virtual ~MessageInterface() = default;
};

// Families, mixed into the concrete classes.
class MouseMessage {
 public:
  virtual ~MouseMessage() = default;
};
class KeyboardMessage {
 public:
  virtual ~KeyboardMessage() = default;
};
class TimerMessage {
 public:
  virtual ~TimerMessage() = default;
};
class GraphicMessage {
 public:
  virtual ~GraphicMessage() = default;
};

// Travels from the window down into the trees, narrowed by its area.
class MessageDown : public MessageInterface {
 public:
  explicit MessageDown(const Rect& area) : area(area) {}
  Rect area;
  bool is_point() const { return area.right == area.left && area.bottom == area.top; }
};

// Travels from a control up through its parents to the window.
class MessageUp : public MessageInterface {};

// ---- downward ----

class Redraw : public MessageDown, public GraphicMessage {
 public:
  Redraw(const Rect& area, RenderingBufferInterface& buffer) : MessageDown(area), buffer(buffer) {}
  RenderingBufferInterface& buffer;
};

class MouseMove : public MessageDown, public MouseMessage {
 public:
  MouseMove(int32_t x, int32_t y) : MessageDown(Rect{x, y, x, y}), position{x, y} {}
  Point position;
};

// Button bits: the buttons held after the event.
enum MouseButtons : uint32_t { kButtonLeft = 1, kButtonRight = 2, kButtonMiddle = 4 };
enum MouseModifiers : uint32_t { kModControl = 1, kModShift = 2 };
enum MouseDoubleClick : uint32_t { kDoubleLeft = 1, kDoubleRight = 2, kDoubleMiddle = 4 };

class MouseClick : public MessageDown, public MouseMessage {
 public:
  MouseClick(int32_t x, int32_t y, uint32_t buttons, uint32_t modifiers, uint32_t double_click)
      : MessageDown(Rect{x, y, x, y}),
        position{x, y},
        buttons(buttons),
        modifiers(modifiers),
        double_click(double_click) {}
  Point position;
  uint32_t buttons;
  uint32_t modifiers;
  uint32_t double_click;
};

class MouseCaptureLost : public MessageDown, public MouseMessage {
 public:
  MouseCaptureLost() : MessageDown(Rect{}) {}
};

class Notify : public MessageDown, public TimerMessage {
 public:
  Notify(int32_t timer_id, double time) : MessageDown(Rect{}), timer_id(timer_id), time(time) {}
  int32_t timer_id;
  double time;  // seconds
};

class ShowObject : public MessageDown {
 public:
  explicit ShowObject(bool visible) : MessageDown(Rect{}), visible(visible) {}
  bool visible;
};

class TextInputFinished : public MessageDown, public KeyboardMessage {
 public:
  TextInputFinished(std::string text, bool accept) : MessageDown(Rect{}), text(std::move(text)), accept(accept) {}
  std::string text;
  bool accept;  // Return or loss of focus; false for Escape
};

// Declared for completeness of the dispatch; nothing constructs it.
class KeyPressed : public MessageDown, public KeyboardMessage {
 public:
  KeyPressed() : MessageDown(Rect{}) {}
};

// ---- upward ----

class Invalidate : public MessageUp, public GraphicMessage {
 public:
  explicit Invalidate(const Rect& rect) : rect(rect) {}
  Rect rect;
};

// Mode 0: plain capture; 1: hidden cursor; 2: hidden cursor and relative motion.
class MouseCapture : public MessageUp, public MouseMessage {
 public:
  MouseCapture(int32_t mode, MessageHandlerInterface* handler) : mode(mode), handler(handler) {}
  int32_t mode;
  MessageHandlerInterface* handler;
};

class MouseRelease : public MessageUp, public MouseMessage {
 public:
  MouseRelease(MessageHandlerInterface* handler, Point restore) : handler(handler), restore(restore) {}
  MessageHandlerInterface* handler;
  Point restore;  // where the cursor goes back in relative mode
};

// Takes the next process-wide timer id at construction and hands it back
// through id_out, so the creator knows it before the message is sent.
class SetTimer : public MessageUp, public TimerMessage {
 public:
  SetTimer(float period, MessageHandlerInterface* handler, int32_t* id_out = nullptr);
  float period;  // seconds
  MessageHandlerInterface* handler;
  int32_t timer_id;

  // Back to the state of a freshly loaded module (first id 1).
  static void reset_ids();
};

class ClearTimer : public MessageUp, public TimerMessage {
 public:
  explicit ClearTimer(int32_t timer_id) : timer_id(timer_id) {}
  int32_t timer_id;
};

class TextInputRequest : public MessageUp, public KeyboardMessage {
 public:
  TextInputRequest(const Rect& rect, std::string text, MessageHandlerInterface* handler)
      : rect(rect), text(std::move(text)), handler(handler) {}
  Rect rect;
  std::string text;
  MessageHandlerInterface* handler;
};

class TextInputStop : public MessageUp, public KeyboardMessage {
 public:
  explicit TextInputStop(bool accept) : accept(accept) {}
  bool accept;
};

class MenuRequest : public MessageUp {
 public:
  explicit MenuRequest(MenuList* root, int32_t x = 0, int32_t y = 0) : root(root), x(x), y(y) {}
  MenuList* root;
  int32_t x;  // unused by the requesters: the menu opens at the cursor
  int32_t y;
};

class MenuStop : public MessageUp {};

}  // namespace guikit
