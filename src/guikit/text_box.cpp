#include "guikit/text_box.h"

#include <cmath>

#include "guikit/font_interface.h"

namespace guikit {

namespace {
constexpr double kTwoPi = 6.283185307179586476925;
}

Rect TextBox::editor_rect() const {
  return Rect{box_.left + position_.x, box_.top + position_.y, box_.right + position_.x, box_.bottom + position_.y};
}

void TextBox::stop() {
  if (!editing_) return;
  TextInputStop drop(false);
  send_up(drop);
  editing_ = false;
}

int32_t TextBox::on_mouse_click(MouseClick& msg) {
  if (msg.buttons == 0) {
    if (active_) end_gesture();
    return 0;
  }
  if (!visible_ || editing_) return 0;
  if (editable_) {
    TextInputRequest request(editor_rect(), text_.get_chars(), this);
    // The flag goes up first: a line editor may finish at once.
    editing_ = true;
    if (send_up(request) != 0) editing_ = false;
  } else {
    each_event(1, 0);
  }
  return 0;
}

int32_t TextBox::on_text_input_finished(TextInputFinished& msg) {
  if (!editing_ || !visible_) return -1;
  editing_ = false;
  if (msg.accept) {
    text_.set_chars(msg.text);
    each_event(2, 0);
    request_redraw();
  }
  return 0;
}

int32_t TextBox::on_redraw(Redraw& msg) {
  if (flags_ & kDrawBackground) background_.draw(msg, position_);
  if (font_) {
    Rect r = editor_rect();
    Rect inner{r.left + margins_.left - msg.area.left, r.top + margins_.top - msg.area.top,
               r.right - margins_.right - msg.area.left, r.bottom - margins_.bottom - msg.area.top};
    font_->draw_text(inner, colour_, text_, msg.buffer);
  }
  if (flags_ & kDrawForeground) foreground_.draw(msg, position_);
  return 0;
}

double VuMeterNeedle::get_angle() const { return kTwoPi * (value_ * span_ + offset_turns_); }

int32_t VuMeterNeedle::on_show_object(ShowObject& msg) {
  if (msg.visible && timer_id_ < 0) start_timer(refresh_);
  return 0;
}

int32_t VuMeterNeedle::on_notify(Notify& msg) {
  if (msg.timer_id != timer_id_) return -1;
  each_event(0, 0);
  return 0;
}

int32_t VuMeterNeedle::on_redraw(Redraw& msg) {
  if (flags_ & kDrawBackground) background_.draw(msg, position_);
  double a = get_angle();
  double x = position_.x + pivot_.x - radius_ * std::cos(a);
  double y = position_.y + pivot_.y + radius_ * std::sin(a);
  needle_.draw_rotated(msg, static_cast<float>(x), static_cast<float>(y), static_cast<float>(a));
  if (flags_ & kDrawCover) cover_.draw(msg, position_);
  return 0;
}

}  // namespace guikit
