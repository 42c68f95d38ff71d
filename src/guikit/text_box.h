#pragma once

#include <string>

#include "guikit/frame_control.h"
#include "guikit/text.h"

namespace guikit {

class FontInterface;

// A line of text in a bitmap font; editable boxes open the window's line editor.
class TextBox : public FrameControl {
 public:
  void set_font(const FontInterface* font) { font_ = font; }
  void set_text(const std::string& text) { text_.set_chars(text); }
  const std::string& get_text() const { return text_.get_chars(); }
  void set_colour(uint32_t rgb) { colour_ = rgb; }
  void set_margins(const Rect& margins) { margins_ = margins; }
  void set_alignment(int32_t alignment) { text_.set_alignment(alignment); }
  void set_editable(bool editable) { editable_ = editable; }
  bool is_editing() const { return editing_; }

  void stop() override;
  int32_t on_mouse_click(MouseClick& msg) override;
  int32_t on_text_input_finished(TextInputFinished& msg) override;
  int32_t on_redraw(Redraw& msg) override;

 private:
  Rect editor_rect() const;

  const FontInterface* font_ = nullptr;
  Text text_;
  uint32_t colour_ = 0;
  Rect margins_;
  bool editable_ = false;
  bool editing_ = false;
};

// A meter needle turned about a pivot; polls its listeners for a fresh value on a timer.
class VuMeterNeedle : public FrameControl {
 public:
  enum NeedleFlags : uint32_t { kDrawCover = 8 };

  void set_needle(const Picture& needle) { needle_ = needle; }
  void set_cover(const Picture& cover) { cover_ = cover; flags_ |= kDrawCover; }
  void set_refresh_period(float seconds) { refresh_ = seconds; }
  // Span and offset in turns; the pivot relative to the control.
  void set_geometry(double span, double offset, Point pivot, double radius) {
    span_ = span;
    offset_turns_ = offset;
    pivot_ = pivot;
    radius_ = radius;
  }
  double get_angle() const;

  void stop() override { stop_timer(); }
  int32_t on_show_object(ShowObject& msg) override;
  int32_t on_notify(Notify& msg) override;
  int32_t on_redraw(Redraw& msg) override;

 private:
  Picture needle_;
  Picture cover_;
  float refresh_ = 0.05f;
  double span_ = 0.25;
  double offset_turns_ = 0.0;
  Point pivot_;
  double radius_ = 0.0;
};

}  // namespace guikit
