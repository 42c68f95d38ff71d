// What the window test does on the desktop: host windows, message pumping,
// input posted as the system would deliver it, screenshots and BMP files.
#pragma once

#include <windows.h>

#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

#include "guikit/rect.h"

namespace win_test {

inline std::string build_name() { return sizeof(void*) == 8 ? "win64" : "win32"; }

// <build folder>\screenshots, the program being <build folder>\bin\*.exe.
inline std::string default_screenshot_folder() {
  char path[MAX_PATH] = {0};
  GetModuleFileNameA(nullptr, path, MAX_PATH);
  std::string text = path;
  for (int i = 0; i < 2; ++i) {
    const size_t slash = text.find_last_of("\\/");
    text = slash == std::string::npos ? std::string(".") : text.substr(0, slash);
  }
  return text + "\\screenshots";
}

// 24-bit bottom-up BMP of 0x00RRGGBB pixels, top row first.
inline bool write_bmp(const std::string& path, const std::vector<uint32_t>& pixels, guikit::Size size) {
  const int row = (size.width * 3 + 3) & ~3;
  BITMAPFILEHEADER file{};
  BITMAPINFOHEADER info{};
  file.bfType = 0x4D42;
  file.bfOffBits = sizeof file + sizeof info;
  file.bfSize = file.bfOffBits + static_cast<DWORD>(row * size.height);
  info.biSize = sizeof info;
  info.biWidth = size.width;
  info.biHeight = size.height;
  info.biPlanes = 1;
  info.biBitCount = 24;
  info.biCompression = BI_RGB;
  FILE* out = std::fopen(path.c_str(), "wb");
  if (!out) return false;
  bool ok = std::fwrite(&file, sizeof file, 1, out) == 1 && std::fwrite(&info, sizeof info, 1, out) == 1;
  std::vector<uint8_t> line(static_cast<size_t>(row), 0);
  for (int y = size.height - 1; ok && y >= 0; --y) {
    for (int x = 0; x < size.width; ++x) {
      const uint32_t p = pixels[static_cast<size_t>(y) * size.width + x];
      line[x * 3] = static_cast<uint8_t>(p);
      line[x * 3 + 1] = static_cast<uint8_t>(p >> 8);
      line[x * 3 + 2] = static_cast<uint8_t>(p >> 16);
    }
    ok = std::fwrite(line.data(), line.size(), 1, out) == 1;
  }
  return std::fclose(out) == 0 && ok;
}

class Desktop {
 public:
  // false when no window can be made (no display).
  bool start() {
    WNDCLASSA wc{};
    wc.lpfnWndProc = &DefWindowProcA;
    wc.hInstance = GetModuleHandleA(nullptr);
    wc.hCursor = LoadCursorA(nullptr, reinterpret_cast<LPCSTR>(IDC_ARROW));
    wc.hbrBackground = reinterpret_cast<HBRUSH>(COLOR_WINDOW + 1);
    wc.lpszClassName = kHostClass;
    if (!RegisterClassA(&wc)) return false;
    HWND probe = CreateWindowExA(0, kHostClass, "probe", WS_OVERLAPPEDWINDOW, 0, 0, 100, 100, nullptr, nullptr,
                                 GetModuleHandleA(nullptr), nullptr);
    if (!probe) return false;
    DestroyWindow(probe);
    HDC screen = GetDC(nullptr);
    const bool colour = screen && GetDeviceCaps(screen, BITSPIXEL) >= 24;
    if (screen) ReleaseDC(nullptr, screen);
    return colour;
  }

  // A visible top-level window whose client area can hold the editor, kept on top.
  HWND make_host(const char* title, int x, int y) {
    RECT r{0, 0, 640, 300};
    AdjustWindowRect(&r, WS_OVERLAPPEDWINDOW, FALSE);
    HWND host = CreateWindowExA(WS_EX_TOPMOST, kHostClass, title, WS_OVERLAPPEDWINDOW | WS_VISIBLE | WS_CLIPCHILDREN,
                                x, y, r.right - r.left, r.bottom - r.top, nullptr, nullptr, GetModuleHandleA(nullptr),
                                nullptr);
    if (host) {
      SetForegroundWindow(host);
      UpdateWindow(host);
      pump(100);
    }
    return host;
  }

  // Delivers messages (timers included) for about ms milliseconds.
  void pump(DWORD ms) {
    const DWORD start = GetTickCount();
    do {
      MSG msg;
      while (PeekMessageA(&msg, nullptr, 0, 0, PM_REMOVE)) {
        TranslateMessage(&msg);
        DispatchMessageA(&msg);
      }
      MsgWaitForMultipleObjects(0, nullptr, FALSE, 2, QS_ALLINPUT);
    } while (GetTickCount() - start < ms);
  }

  // The real cursor at a point of the window (relative mode measures from it).
  void set_cursor(HWND window, int x, int y) {
    POINT p{x, y};
    ClientToScreen(window, &p);
    SetCursorPos(p.x, p.y);
  }

  void press(HWND window, int x, int y) {
    set_cursor(window, x, y);
    PostMessageA(window, WM_LBUTTONDOWN, MK_LBUTTON, MAKELPARAM(x, y));
  }
  void move(HWND window, int x, int y, bool held) {
    PostMessageA(window, WM_MOUSEMOVE, held ? MK_LBUTTON : 0, MAKELPARAM(x, y));
  }
  void release(HWND window, int x, int y) { PostMessageA(window, WM_LBUTTONUP, 0, MAKELPARAM(x, y)); }
  void click(HWND window, int x, int y) {
    press(window, x, y);
    pump(30);
    release(window, x, y);
    pump(30);
  }

  void key_char(HWND window, WPARAM ch) {
    PostMessageA(window, WM_CHAR, ch, 1);
    pump(30);
  }
  void type(HWND window, const std::string& text) {
    for (char c : text) PostMessageA(window, WM_CHAR, static_cast<unsigned char>(c), 1);
    pump(30);
  }

  // The window's pixels as the screen shows them, 0x00RRGGBB, top row first.
  std::vector<uint32_t> screenshot(HWND window, guikit::Size size) {
    UpdateWindow(window);
    std::vector<uint32_t> pixels;
    BITMAPINFO info{};
    info.bmiHeader.biSize = sizeof(BITMAPINFOHEADER);
    info.bmiHeader.biWidth = size.width;
    info.bmiHeader.biHeight = -size.height;
    info.bmiHeader.biPlanes = 1;
    info.bmiHeader.biBitCount = 32;
    info.bmiHeader.biCompression = BI_RGB;
    HDC dc = GetDC(window);
    HDC memory = CreateCompatibleDC(dc);
    void* bits = nullptr;
    HBITMAP bitmap = CreateDIBSection(dc, &info, DIB_RGB_COLORS, &bits, nullptr, 0);
    if (dc && memory && bitmap) {
      HGDIOBJ previous = SelectObject(memory, bitmap);
      BitBlt(memory, 0, 0, size.width, size.height, dc, 0, 0, SRCCOPY);
      GdiFlush();
      const auto* p = static_cast<const uint32_t*>(bits);
      pixels.assign(p, p + static_cast<size_t>(size.width) * size.height);
      for (uint32_t& v : pixels) v &= 0x00FFFFFFu;
      SelectObject(memory, previous);
    }
    if (bitmap) DeleteObject(bitmap);
    if (memory) DeleteDC(memory);
    if (dc) ReleaseDC(window, dc);
    return pixels;
  }

 private:
  static constexpr const char* kHostClass = "BrakmorphTestHost";
};

}  // namespace win_test
