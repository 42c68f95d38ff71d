#pragma once

#include <string>

#include "guikit/messages.h"
#include "guikit/text_line_editor_interface.h"

namespace guikit {

// The line editor without a screen: a test types into it and ends it as
// Return (accept) or Escape (drop) would.
class OffscreenLineEditor : public TextLineEditorInterface {
 public:
  static constexpr size_t kMaxText = 1023;

  int32_t start(const TextInputRequest& request) override;
  int32_t stop(bool accept) override;
  bool is_active() const override { return active_; }

  void type(const std::string& text) { text_ = text; }
  const std::string& get_text() const { return text_; }
  const Rect& get_rect() const { return rect_; }
  int get_start_count() const { return starts_; }

 private:
  bool active_ = false;
  std::string text_;
  Rect rect_;
  MessageHandlerInterface* requester_ = nullptr;
  int starts_ = 0;
};

}  // namespace guikit
