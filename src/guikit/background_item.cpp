#include "guikit/background_item.h"

namespace guikit {

int32_t BackgroundItem::process_message_down(MessageInterface& message) {
  if (auto* redraw = dynamic_cast<Redraw*>(&message)) {
    Point at = position_.x == SPTreeNodeInterface::kUnset ? Point{0, 0} : position_;
    draw(*redraw, at);
  }
  return 0;
}

}  // namespace guikit
