#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <utility>

namespace guikit {

class FontInterface;

enum TextAlignment : int32_t { kAlignLeft = 0, kAlignCentre = 1, kAlignRight = 2 };

// One line of text for draw_text: its bytes (each byte picks a glyph), its
// alignment (0 left, 1 centred, any other value right) and its size in pixels
// as last measured with a font.
class Text {
 public:
  Text() = default;
  explicit Text(std::string chars, int32_t alignment = kAlignLeft)
      : chars_(std::move(chars)), alignment_(alignment) {}

  const char* data() const { return chars_.data(); }
  size_t length() const { return chars_.size(); }
  const std::string& get_chars() const { return chars_; }
  // New content forgets the old measurement.
  void set_chars(std::string chars) {
    chars_ = std::move(chars);
    pixel_width_ = 0;
    pixel_height_ = 0;
  }

  int32_t get_alignment() const { return alignment_; }
  void set_alignment(int32_t alignment) { alignment_ = alignment; }

  // Width (sum of the glyph widths) and height (glyph height) in the given font.
  void measure(const FontInterface& font);
  int32_t get_pixel_width() const { return pixel_width_; }
  int32_t get_pixel_height() const { return pixel_height_; }

 private:
  std::string chars_;
  int32_t alignment_ = kAlignLeft;
  int32_t pixel_width_ = 0;
  int32_t pixel_height_ = 0;
};

}  // namespace guikit
