#pragma once

#include <string>
#include <vector>

#include "guikit/messages.h"
#include "guikit/rendering_buffer_interface.h"
#include "guikit/sp_tree_node.h"

namespace guikit_test {

struct Delivery {
  std::string node;
  std::string kind;
  guikit::Rect area;
};

// A tree leaf that logs what reaches it; on a Redraw it fills the tile part of
// the buffer with its colour so painting can be checked pixel by pixel.
class RecordingNode : public virtual guikit::SPTreeNodeInterface {
 public:
  RecordingNode(std::string name, std::vector<Delivery>* log, uint32_t colour = 0)
      : name_(std::move(name)), log_(log), colour_(colour) {}

  int32_t process_message_down(guikit::MessageInterface& m) override {
    std::string kind = "other";
    guikit::Rect area;
    if (auto* d = dynamic_cast<guikit::MessageDown*>(&m)) area = d->area;
    if (auto* r = dynamic_cast<guikit::Redraw*>(&m)) {
      kind = "redraw";
      if (colour_) fill(*r);
    } else if (dynamic_cast<guikit::MouseMove*>(&m)) {
      kind = "move";
    } else if (dynamic_cast<guikit::MouseClick*>(&m)) {
      kind = "click";
    } else if (dynamic_cast<guikit::ShowObject*>(&m)) {
      kind = "show";
    } else if (dynamic_cast<guikit::MouseCaptureLost*>(&m)) {
      kind = "lost";
    } else if (dynamic_cast<guikit::Notify*>(&m)) {
      kind = "notify";
    } else if (auto* t = dynamic_cast<guikit::TextInputFinished*>(&m)) {
      kind = std::string("text ") + (t->accept ? "accept " : "drop ") + t->text;
    }
    if (log_) log_->push_back(Delivery{name_, kind, area});
    return answer_;
  }

  void set_answer(int32_t answer) { answer_ = answer; }
  // Sends an upward message as a control would.
  int32_t send_up(guikit::MessageInterface& m) { return process_message(m); }

 private:
  // The tile's part of the buffer starts at the buffer's origin.
  void fill(guikit::Redraw& r) {
    uint32_t* px = r.buffer.get_pixels();
    int32_t w = r.buffer.get_width();
    for (int32_t y = 0; y < r.area.height(); ++y)
      for (int32_t x = 0; x < r.area.width(); ++x) px[y * w + x] = colour_ ^ static_cast<uint32_t>(((r.area.left + x) << 8) | (r.area.top + y));
  }

  std::string name_;
  std::vector<Delivery>* log_;
  uint32_t colour_;
  int32_t answer_ = 0;
};

// A plain handler that logs what it is sent.
class RecordingHandler : public guikit::MessageHandlerInterface {
 public:
  explicit RecordingHandler(std::vector<Delivery>* log, std::string name = "handler") : node_(std::move(name), log) {}
  int32_t process_message(guikit::MessageInterface& m) override { return node_.process_message_down(m); }

 private:
  RecordingNode node_;
};

}  // namespace guikit_test
