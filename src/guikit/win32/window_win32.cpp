#include "guikit/win32/window_win32.h"

#include <mmsystem.h>

#include <atomic>
#include <cstdio>

#include "config/system_services.h"
#include "guikit/win32/module_instance_win32.h"

namespace guikit {

namespace {

const char kWindowTitle[] = "Velmora Audio Plug-in";

// Process-wide window state; the user-interface thread alone touches it.
bool g_class_registered = false;
int g_open_windows = 0;
int g_window_objects = 0;

// Timer ids of our windows' thread timers, unique in the process so that the
// shared timer records can tell every window's timers apart.
std::atomic<uintptr_t> g_last_timer_id{0};

int32_t signed_low(LPARAM value) { return static_cast<int16_t>(static_cast<uint16_t>(value & 0xFFFF)); }
int32_t signed_high(LPARAM value) { return static_cast<int16_t>(static_cast<uint16_t>((value >> 16) & 0xFFFF)); }

// The key-state word of a mouse message as the toolkit's button and modifier bits.
struct KeyBit {
  WPARAM system;
  uint32_t toolkit;
};
const KeyBit kButtonBits[] = {{MK_LBUTTON, kButtonLeft}, {MK_RBUTTON, kButtonRight}, {MK_MBUTTON, kButtonMiddle}};
const KeyBit kModifierBits[] = {{MK_CONTROL, kModControl}, {MK_SHIFT, kModShift}};

template <size_t N>
uint32_t toolkit_bits(WPARAM keys, const KeyBit (&table)[N]) {
  uint32_t bits = 0;
  for (const KeyBit& bit : table) {
    if (keys & bit.system) bits |= bit.toolkit;
  }
  return bits;
}

void report_last_error(const char* what) {
  char* text = nullptr;
  FormatMessageA(FORMAT_MESSAGE_ALLOCATE_BUFFER | FORMAT_MESSAGE_FROM_SYSTEM | FORMAT_MESSAGE_IGNORE_INSERTS, nullptr,
                 GetLastError(), 0, reinterpret_cast<LPSTR>(&text), 0, nullptr);
  std::string line = std::string("guikit::WindowWin32::open() : ") + what + ": " + (text ? text : "unknown error") + "\n";
  if (text) LocalFree(text);
  sys::debug_output(line.c_str());
}

}  // namespace

const std::string& WindowWin32::window_class_name() {
  // Formatted once with this copy's window procedure, so two loaded copies of
  // the module register two classes.
  static const std::string name = [] {
    char text[64];
    std::snprintf(text, sizeof text, "VelmoraAudioPlugin%08X",
                  static_cast<unsigned>(reinterpret_cast<uintptr_t>(&WindowWin32::window_procedure)));
    return std::string(text);
  }();
  return name;
}

bool WindowWin32::is_class_registered() { return g_class_registered; }
int WindowWin32::get_open_count() { return g_open_windows; }

WindowWin32::WindowWin32(Size initial_size) : core_(*this), window_size_(initial_size) {
  core_.set_editor_size(initial_size);
  core_.set_line_editor(&line_editor_);
  core_.set_menu(&menu_);
  ++g_window_objects;
}

WindowWin32::~WindowWin32() {
  // The controls may be gone before the window: drop the capture unannounced.
  core_.forget_capture();
  if (holds_capture()) ReleaseCapture();
  close();
  buffer_.release();
  if (--g_window_objects == 0 && g_class_registered) {
    UnregisterClassA(window_class_name().c_str(), module_instance());
    g_class_registered = false;
  }
}

int32_t WindowWin32::open(void* parent) {
  if (hwnd_) return 0;
  if (!g_class_registered && g_open_windows == 0) {
    WNDCLASSA wc{};
    wc.style = CS_VREDRAW | CS_HREDRAW | CS_DBLCLKS;
    wc.lpfnWndProc = &WindowWin32::window_procedure;
    wc.hInstance = module_instance();
    wc.hCursor = LoadCursorA(nullptr, reinterpret_cast<LPCSTR>(IDC_ARROW));
    wc.hbrBackground = nullptr;
    wc.lpszClassName = window_class_name().c_str();
    if (!RegisterClassA(&wc)) {
      report_last_error("Cannot register the window class");
      return -1;
    }
    g_class_registered = true;
  }
  const Size size = current_size();
  parent_ = static_cast<HWND>(parent);
  HWND hwnd = CreateWindowExA(0, window_class_name().c_str(), kWindowTitle, WS_CHILD | WS_VISIBLE, 0, 0, size.width,
                              size.height, parent_, nullptr, module_instance(), this);
  if (!hwnd) {
    report_last_error("Cannot create the window");
    return -1;
  }
  hwnd_ = hwnd;
  const Size editor = core_.get_editor_size();
  if (!buffer_.exists() || buffer_.get_width() != editor.width || buffer_.get_height() != editor.height) {
    buffer_.create(hwnd_, editor.width, editor.height);
  }
  line_editor_.set_owner(hwnd_);
  menu_.set_owner(hwnd_);
  SetWindowLongPtrA(hwnd_, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(this));
  ++g_open_windows;
  return 0;
}

void WindowWin32::close() {
  core_.close_timers();
  if (hwnd_) DestroyWindow(hwnd_);
}

void WindowWin32::resize() {
  if (!hwnd_) return;
  const Size size = current_size();
  SetWindowPos(hwnd_, nullptr, 0, 0, size.width, size.height, SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE);
  InvalidateRect(hwnd_, nullptr, FALSE);
}

void WindowWin32::set_roots(MessageHandlerInterface* background, MessageHandlerInterface* controls) {
  core_.set_background_root(background);
  core_.set_control_root(controls);
}

void WindowWin32::set_editor_size(Size size) {
  core_.set_editor_size(size);
  // A larger editor gets a buffer of its size; a smaller one paints in tiles of the old.
  if (hwnd_ && (size.width > buffer_.get_width() || size.height > buffer_.get_height())) {
    buffer_.create(hwnd_, size.width, size.height);
  }
}

LRESULT CALLBACK WindowWin32::window_procedure(HWND hwnd, UINT message, WPARAM wparam, LPARAM lparam) {
  if (message == WM_NCCREATE) {
    // Messages of the creation already reach the window object.
    auto* create = reinterpret_cast<CREATESTRUCTA*>(lparam);
    SetWindowLongPtrA(hwnd, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(create->lpCreateParams));
  }
  auto* window = reinterpret_cast<WindowWin32*>(GetWindowLongPtrA(hwnd, GWLP_USERDATA));
  if (message == WM_NCDESTROY) SetWindowLongPtrA(hwnd, GWLP_USERDATA, 0);
  if (!window || (window->hwnd_ && window->hwnd_ != hwnd)) return DefWindowProcA(hwnd, message, wparam, lparam);
  return window->on_message(hwnd, message, wparam, lparam);
}

LRESULT WindowWin32::on_message(HWND hwnd, UINT message, WPARAM wparam, LPARAM lparam) {
  switch (message) {
    case WM_MOUSEMOVE:
      core_.mouse_move(signed_low(lparam), signed_high(lparam));
      return 0;
    case WM_LBUTTONDOWN:
    case WM_LBUTTONUP:
    case WM_RBUTTONDOWN:
    case WM_RBUTTONUP:
    case WM_MBUTTONDOWN:
    case WM_MBUTTONUP:
      on_button(lparam, wparam, 0);
      return 0;
    case WM_LBUTTONDBLCLK:
      on_button(lparam, wparam, kDoubleLeft);
      return 0;
    case WM_RBUTTONDBLCLK:
      on_button(lparam, wparam, kDoubleRight);
      return 0;
    case WM_MBUTTONDBLCLK:
      on_button(lparam, wparam, kDoubleMiddle);
      return 0;
    case WM_CAPTURECHANGED:
      core_.capture_changed();
      return 0;
    case WM_TIMER:
      WindowCore::timer_tick(static_cast<uintptr_t>(wparam));
      return 0;
    case WM_PAINT:
      on_paint();
      return 0;
    case WM_DESTROY:
      core_.destroyed();
      // The host may destroy our window with its own; its thread timers die with it.
      core_.close_timers();
      if (hwnd_) {
        hwnd_ = nullptr;
        --g_open_windows;
      }
      return 0;
    default:
      break;
  }
  return DefWindowProcA(hwnd, message, wparam, lparam);
}

void WindowWin32::on_button(LPARAM lparam, WPARAM wparam, uint32_t double_click) {
  core_.mouse_button(signed_low(lparam), signed_high(lparam), toolkit_bits(wparam, kButtonBits),
                     toolkit_bits(wparam, kModifierBits), double_click);
}

void WindowWin32::on_paint() {
  PAINTSTRUCT ps;
  HDC dc = BeginPaint(hwnd_, &ps);
  if (!dc) return;
  paint_dc_ = dc;
  buffer_.set_target(dc);
  const Rect dirty{ps.rcPaint.left, ps.rcPaint.top, ps.rcPaint.right, ps.rcPaint.bottom};
  RECT client;
  GetClientRect(hwnd_, &client);
  core_.paint(dirty, buffer_, Size{client.right - client.left, client.bottom - client.top});
  buffer_.set_target(nullptr);
  paint_dc_ = nullptr;
  EndPaint(hwnd_, &ps);
}

void WindowWin32::invalidate_area(const Rect& rect) {
  RECT r{rect.left, rect.top, rect.right, rect.bottom};
  InvalidateRect(hwnd_, &r, FALSE);
}

bool WindowWin32::take_capture() {
  // Taking it again would tell the holder it lost it.
  if (GetCapture() != hwnd_) SetCapture(hwnd_);
  return GetCapture() == hwnd_;
}

bool WindowWin32::holds_capture() const { return hwnd_ != nullptr && GetCapture() == hwnd_; }

void WindowWin32::release_capture() {
  // The system then sends WM_CAPTURECHANGED, which tells WindowCore.
  if (holds_capture()) ReleaseCapture();
}

Point WindowWin32::get_cursor() const {
  POINT p{0, 0};
  GetCursorPos(&p);
  if (hwnd_) ScreenToClient(hwnd_, &p);
  return Point{p.x, p.y};
}

void WindowWin32::set_cursor(Point position) {
  POINT p{position.x, position.y};
  if (hwnd_) ClientToScreen(hwnd_, &p);
  SetCursorPos(p.x, p.y);
}

uint32_t WindowWin32::milliseconds() const { return static_cast<uint32_t>(timeGetTime()); }

bool WindowWin32::start_timer(uint32_t period_ms, uintptr_t& platform_id) {
  if (!hwnd_) return false;
  const uintptr_t id = g_last_timer_id.fetch_add(1, std::memory_order_relaxed) + 1;
  if (::SetTimer(hwnd_, id, period_ms, nullptr) == 0) return false;
  platform_id = id;
  return true;
}

bool WindowWin32::kill_timer(uintptr_t platform_id) { return hwnd_ != nullptr && KillTimer(hwnd_, platform_id) != 0; }

void WindowWin32::fill_face(const Rect& rect) {
  if (!paint_dc_) return;
  RECT r{rect.left, rect.top, rect.right, rect.bottom};
  FillRect(paint_dc_, &r, GetSysColorBrush(COLOR_BTNFACE));
}

}  // namespace guikit
