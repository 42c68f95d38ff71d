// The editor's parent on a Windows desktop: a top-level window of a class of
// our own, pumped with PeekMessage from the host's loop.
#include <windows.h>

#include <cstdlib>
#include <stdexcept>
#include <string>

#include "cli/editor_parent.h"

namespace plugcore {
namespace {

constexpr wchar_t kClassName[] = L"BrakmorphHostEditorParent";

LRESULT CALLBACK parent_procedure(HWND window, UINT message, WPARAM wparam, LPARAM lparam) {
  if (message == WM_CLOSE) {
    SetWindowLongPtrW(window, GWLP_USERDATA, 1);  // closing is the host's business
    return 0;
  }
  return DefWindowProcW(window, message, wparam, lparam);
}

void register_class() {
  static bool registered = false;
  if (registered) return;
  WNDCLASSEXW window_class{};
  window_class.cbSize = sizeof(window_class);
  window_class.lpfnWndProc = parent_procedure;
  window_class.hInstance = GetModuleHandleW(nullptr);
  window_class.hCursor = LoadCursor(nullptr, IDC_ARROW);
  window_class.hbrBackground = static_cast<HBRUSH>(GetStockObject(BLACK_BRUSH));
  window_class.lpszClassName = kClassName;
  if (RegisterClassExW(&window_class) == 0) throw std::runtime_error("cannot register the window class");
  registered = true;
}

struct ChildCount {
  HWND parent;
  int count;
};

// Direct children only: EnumChildWindows walks every descendant.
BOOL CALLBACK count_direct_child(HWND child, LPARAM data) {
  ChildCount& found = *reinterpret_cast<ChildCount*>(data);
  if (GetAncestor(child, GA_PARENT) == found.parent) ++found.count;
  return TRUE;
}

class EditorParentWin32 : public EditorParentInterface {
 public:
  EditorParentWin32(int width, int height, const std::string& title) {
    register_class();
    const DWORD style = WS_OVERLAPPED | WS_CAPTION | WS_SYSMENU | WS_MINIMIZEBOX;
    RECT frame{0, 0, width, height};
    AdjustWindowRect(&frame, style, FALSE);
    window_ = CreateWindowExW(0, kClassName, std::wstring(title.begin(), title.end()).c_str(), style, CW_USEDEFAULT,
                              CW_USEDEFAULT, frame.right - frame.left, frame.bottom - frame.top, nullptr,
                              nullptr, GetModuleHandleW(nullptr), nullptr);
    if (window_ == nullptr) throw std::runtime_error("cannot create the parent window");
    width_ = width;
    height_ = height;
    ShowWindow(window_, SW_SHOWNORMAL);
    UpdateWindow(window_);
    pump_events();
  }

  ~EditorParentWin32() override {
    DestroyWindow(window_);
    pump_events();
  }

  void* native_handle() override { return window_; }

  void resize(int width, int height) override {
    width_ = width;
    height_ = height;
    const DWORD style = static_cast<DWORD>(GetWindowLongPtrW(window_, GWL_STYLE));
    RECT frame{0, 0, width, height};
    AdjustWindowRect(&frame, style, FALSE);
    SetWindowPos(window_, nullptr, 0, 0, frame.right - frame.left, frame.bottom - frame.top,
                 SWP_NOMOVE | SWP_NOZORDER);
  }

  void pump_events() override {
    MSG message;
    while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) {
      TranslateMessage(&message);
      DispatchMessageW(&message);
    }
  }

  bool close_requested() const override { return GetWindowLongPtrW(window_, GWLP_USERDATA) != 0; }

  int child_count() override {
    ChildCount found{window_, 0};
    EnumChildWindows(window_, count_direct_child, reinterpret_cast<LPARAM>(&found));
    return found.count;
  }

  PixelImage grab() override {
    HDC window_dc = GetDC(window_);
    HDC memory_dc = CreateCompatibleDC(window_dc);
    BITMAPINFO info{};
    info.bmiHeader.biSize = sizeof(info.bmiHeader);
    info.bmiHeader.biWidth = width_;
    info.bmiHeader.biHeight = -height_;  // top row first
    info.bmiHeader.biPlanes = 1;
    info.bmiHeader.biBitCount = 32;
    info.bmiHeader.biCompression = BI_RGB;
    void* bits = nullptr;
    HBITMAP bitmap = CreateDIBSection(window_dc, &info, DIB_RGB_COLORS, &bits, nullptr, 0);
    PixelImage image;
    if (bitmap != nullptr) {
      HGDIOBJ previous = SelectObject(memory_dc, bitmap);
      BitBlt(memory_dc, 0, 0, width_, height_, window_dc, 0, 0, SRCCOPY);
      GdiFlush();
      image.width = width_;
      image.height = height_;
      const uint32_t* source = static_cast<const uint32_t*>(bits);
      image.pixels.assign(source, source + static_cast<size_t>(width_) * height_);
      for (uint32_t& pixel : image.pixels) pixel &= 0x00FFFFFFu;
      SelectObject(memory_dc, previous);
      DeleteObject(bitmap);
    }
    DeleteDC(memory_dc);
    ReleaseDC(window_, window_dc);
    if (image.pixels.empty()) throw std::runtime_error("cannot read the window's pixels");
    return image;
  }

 private:
  HWND window_ = nullptr;
  int width_ = 0;
  int height_ = 0;
};

}  // namespace

std::string editor_desktop_unavailable() {
  // Under Wine a desktop needs an X display behind it.
  const HMODULE ntdll = GetModuleHandleA("ntdll.dll");
  const bool under_wine = ntdll != nullptr && GetProcAddress(ntdll, "wine_get_version") != nullptr;
  if (under_wine) {
    const char* display = std::getenv("DISPLAY");
    if (display == nullptr || *display == '\0') return "no X display behind Wine (DISPLAY is not set)";
  }
  return "";
}

std::unique_ptr<EditorParentInterface> create_editor_parent(int width, int height,
                                                            const std::string& title) {
  if (width <= 0 || height <= 0 || width > 8192 || height > 8192) {
    throw std::runtime_error("editor size " + std::to_string(width) + "x" + std::to_string(height) +
                             " out of range");
  }
  const std::string unavailable = editor_desktop_unavailable();
  if (!unavailable.empty()) throw std::runtime_error(unavailable);
  return std::make_unique<EditorParentWin32>(width, height, title);
}

}  // namespace plugcore
