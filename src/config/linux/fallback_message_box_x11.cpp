#include <X11/keysym.h>

#include <algorithm>
#include <vector>

#include "config/linux/dialog_window_x11.h"
#include "config/linux/fallback_dialogs_x11.h"

namespace sys {

namespace {

constexpr int kMargin = 16;
constexpr int kButtonWidth = 84;
constexpr int kButtonHeight = 24;
constexpr int kButtonGap = 8;
constexpr int kButtonEdge = 12;  // from the window's right and bottom edges
constexpr int kTextWidth = 380;  // where the text wraps
constexpr int kMinWidth = 240;
constexpr int kMinLines = 1;

constexpr uint32_t kBackground = 0xECECEC;
constexpr uint32_t kTextColour = 0x101010;
constexpr uint32_t kFace = 0xDCDCDC;
constexpr uint32_t kFacePressed = 0xC0C0C0;
constexpr uint32_t kEdge = 0x808080;
constexpr uint32_t kDefaultEdge = 0x1F4E9A;

// Labels of the button sets 0 (OK), 1 (OK, Cancel) and 2 (Yes, No).
const std::vector<std::string>& labels(int32_t buttons) {
  static const std::vector<std::string> sets[3] = {{"OK"}, {"OK", "Cancel"}, {"Yes", "No"}};
  return sets[buttons];
}

class MessageBoxContent : public DialogContentInterface {
 public:
  MessageBoxContent(guikit::Size size, std::vector<std::string> lines, const std::vector<std::string>& labels,
                    int32_t default_button)
      : size_(size),
        lines_(std::move(lines)),
        labels_(labels),
        default_(std::min<int32_t>(default_button, static_cast<int32_t>(labels.size()) - 1)) {}

  void paint(DialogWindowX11& w) override {
    const guikit::Size size = size_;
    w.fill(guikit::Rect{0, 0, size.width, size.height}, kBackground);
    const int lh = w.line_height();
    for (size_t i = 0; i < lines_.size(); ++i) {
      const int top = kMargin + static_cast<int>(i) * lh;
      w.text(guikit::Rect{kMargin, top, size.width - kMargin, top + lh}, lines_[i], kTextColour);
    }
    for (int32_t i = 0; i < count(); ++i) {
      const guikit::Rect r = message_box_button_rect(size, count(), i);
      w.fill(r, i == pressed_ ? kFacePressed : kFace);
      // The default button, the one Return chooses, has a heavy coloured frame.
      if (i == default_) {
        w.frame(r, kDefaultEdge, 2);
      } else {
        w.frame(r, kEdge, 1);
      }
      const std::string& label = labels_[static_cast<size_t>(i)];
      const int tw = w.text_width(label, i == default_);
      const int th = w.line_height(i == default_);
      const int left = r.left + (r.width() - tw) / 2;
      const int top = r.top + (r.height() - th) / 2;
      w.text(guikit::Rect{left, top, r.right - 2, top + th}, label, kTextColour, i == default_);
    }
  }

  void key(unsigned long keysym, const std::string&) override {
    switch (keysym) {
      case XK_Return:
      case XK_KP_Enter:
      case XK_space:
        choose(default_);
        break;
      case XK_Escape:
        close_requested();
        break;
      case XK_Tab:
      case XK_Right:
        default_ = (default_ + 1) % count();
        break;
      case XK_ISO_Left_Tab:
      case XK_Left:
        default_ = (default_ + count() - 1) % count();
        break;
      default:
        break;
    }
  }

  void press(int x, int y) override { pressed_ = button_at(x, y); }

  // A click chooses when it is let go over the button it began on.
  void release(int x, int y) override {
    const int32_t at = button_at(x, y);
    if (at >= 0 && at == pressed_) choose(at);
    pressed_ = -1;
  }

  // Closing the box answers as the cautious button would: Cancel or No, else OK.
  void close_requested() override { choose(count() > 1 ? 1 : 0); }

  bool finished() const override { return answer_ >= 0; }
  int32_t answer() const { return answer_; }

 private:
  int32_t count() const { return static_cast<int32_t>(labels_.size()); }
  void choose(int32_t index) { answer_ = index; }
  int32_t button_at(int x, int y) const {
    for (int32_t i = 0; i < count(); ++i) {
      if (message_box_button_rect(size_, count(), i).contains(x, y)) return i;
    }
    return -1;
  }

  guikit::Size size_;
  std::vector<std::string> lines_;
  const std::vector<std::string>& labels_;
  int32_t default_;
  int32_t pressed_ = -1;
  int32_t answer_ = -1;
};

}  // namespace

guikit::Rect message_box_button_rect(guikit::Size window, int32_t count, int32_t index) {
  const int right = window.width - kButtonEdge - (count - 1 - index) * (kButtonWidth + kButtonGap);
  const int bottom = window.height - kButtonEdge;
  return guikit::Rect{right - kButtonWidth, bottom - kButtonHeight, right, bottom};
}

int32_t show_fallback_message_box(const std::string& title, const std::string& text, int32_t buttons,
                                  int32_t default_button) {
  if (buttons < 0 || buttons > 2) return -1;
  DialogWindowX11 window;
  if (!window.connect()) return -1;
  std::vector<std::string> lines =
      wrap_text(text, kTextWidth, [&](const std::string& s) { return window.text_width(s); });
  int widest = 0;
  for (const std::string& line : lines) widest = std::max(widest, window.text_width(line));
  const int count = static_cast<int>(labels(buttons).size());
  const int button_row = count * kButtonWidth + (count - 1) * kButtonGap + 2 * kButtonEdge;
  const int width = std::max({kMinWidth, widest + 2 * kMargin, button_row});
  const int text_lines = std::max(kMinLines, static_cast<int>(lines.size()));
  const int height = kMargin + text_lines * window.line_height() + kMargin + kButtonHeight + kButtonEdge;

  const guikit::Size size{width, height};
  MessageBoxContent content(size, std::move(lines), labels(buttons), default_button < 0 ? 0 : default_button);
  if (!window.create(title, size)) return -1;
  window.run(content);
  return content.answer();
}

}  // namespace sys
