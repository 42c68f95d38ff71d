#pragma once

#include <windows.h>

#include <cstdint>

#include "guikit/rendering_buffer_interface.h"

namespace guikit {

// The window's drawing surface: a top-down 32-bit DIB section, copied to the
// device context of the paint in progress.
class RenderingBufferWin32 : public RenderingBufferInterface {
 public:
  RenderingBufferWin32() = default;
  RenderingBufferWin32(const RenderingBufferWin32&) = delete;
  RenderingBufferWin32& operator=(const RenderingBufferWin32&) = delete;
  ~RenderingBufferWin32() override { release(); }

  // Makes the bitmap for the window's device context; false when the system refused.
  bool create(HWND window, int32_t width, int32_t height);
  void release();
  bool exists() const { return bitmap_ != nullptr; }

  int32_t get_width() const override { return width_; }
  int32_t get_height() const override { return height_; }
  uint32_t* get_pixels() override { return pixels_; }
  void blit(Point position, Size size) override;

  // The paint's device context; nullptr after the paint.
  void set_target(HDC dc) { target_ = dc; }

 private:
  int32_t width_ = 0;
  int32_t height_ = 0;
  HBITMAP bitmap_ = nullptr;
  uint32_t* pixels_ = nullptr;
  HDC target_ = nullptr;
};

}  // namespace guikit
