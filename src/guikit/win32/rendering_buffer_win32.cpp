#include "guikit/win32/rendering_buffer_win32.h"

namespace guikit {

bool RenderingBufferWin32::create(HWND window, int32_t width, int32_t height) {
  release();
  if (width <= 0 || height <= 0) return false;
  BITMAPINFO info{};
  info.bmiHeader.biSize = sizeof(BITMAPINFOHEADER);
  info.bmiHeader.biWidth = width;
  info.bmiHeader.biHeight = -height;  // negative: the top row comes first
  info.bmiHeader.biPlanes = 1;
  info.bmiHeader.biBitCount = 32;
  info.bmiHeader.biCompression = BI_RGB;
  HDC dc = GetDC(window);
  void* bits = nullptr;
  HBITMAP bitmap = CreateDIBSection(dc, &info, DIB_RGB_COLORS, &bits, nullptr, 0);
  if (dc) ReleaseDC(window, dc);
  if (!bitmap || !bits) {
    if (bitmap) DeleteObject(bitmap);
    return false;
  }
  bitmap_ = bitmap;
  pixels_ = static_cast<uint32_t*>(bits);
  width_ = width;
  height_ = height;
  return true;
}

void RenderingBufferWin32::release() {
  if (bitmap_) DeleteObject(bitmap_);
  bitmap_ = nullptr;
  pixels_ = nullptr;
  width_ = 0;
  height_ = 0;
}

void RenderingBufferWin32::blit(Point position, Size size) {
  if (!target_ || !bitmap_) return;
  HDC memory = CreateCompatibleDC(target_);
  if (!memory) return;
  HGDIOBJ previous = SelectObject(memory, bitmap_);
  BitBlt(target_, position.x, position.y, size.width, size.height, memory, 0, 0, SRCCOPY);
  SelectObject(memory, previous);
  DeleteDC(memory);
}

}  // namespace guikit
