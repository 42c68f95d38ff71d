#include "guikit/frame_control.h"

#include <cmath>

namespace guikit {

int32_t FrameControl::frame_for(double position) const {
  if (frames_.empty()) return -1;
  auto index = static_cast<int32_t>(std::floor(static_cast<double>(frames_.size() - 1) * position + 0.5));
  if (index < 0) index = 0;
  if (index >= static_cast<int32_t>(frames_.size())) index = static_cast<int32_t>(frames_.size()) - 1;
  return index;
}

int32_t FrameControl::draw_layers(Redraw& msg, double position) {
  if (flags_ & kDrawBackground) background_.draw(msg, position_);
  int32_t frame = frame_for(position);
  if (frame >= 0) frames_[static_cast<size_t>(frame)].draw(msg, position_);
  if (flags_ & kDrawForeground) foreground_.draw(msg, position_);
  return 0;
}

bool FrameControl::start_timer(float period) {
  int32_t id = -1;
  SetTimer set(period, this, &id);
  if (send_up(set) != 0) return false;
  timer_id_ = id;
  return true;
}

void FrameControl::stop_timer() {
  if (timer_id_ < 0) return;
  ClearTimer clear(timer_id_);
  timer_id_ = -1;
  send_up(clear);
}

}  // namespace guikit
