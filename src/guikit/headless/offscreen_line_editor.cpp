#include "guikit/headless/offscreen_line_editor.h"

namespace guikit {

int32_t OffscreenLineEditor::start(const TextInputRequest& request) {
  active_ = true;
  text_ = request.text;
  rect_ = request.rect;
  requester_ = request.handler;
  ++starts_;
  return 0;
}

int32_t OffscreenLineEditor::stop(bool accept) {
  if (!active_) return -1;
  active_ = false;
  if (text_.size() > kMaxText) text_.resize(kMaxText);
  MessageHandlerInterface* requester = requester_;
  requester_ = nullptr;
  if (requester) {
    TextInputFinished finished(text_, accept);
    requester->process_message(finished);
  }
  return 0;
}

}  // namespace guikit
