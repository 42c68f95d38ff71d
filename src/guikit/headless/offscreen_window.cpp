#include "guikit/headless/offscreen_window.h"

#include <atomic>
#include <functional>
#include <thread>

namespace guikit {

namespace {
// Platform timer ids are unique across all windows, as the system's are.
std::atomic<uintptr_t> g_last_platform_timer{0};

Size or_default(Size s, Size fallback) { return s.width > 0 && s.height > 0 ? s : fallback; }

Rect unite(const Rect& a, const Rect& b) {
  if (a.empty()) return b;
  if (b.empty()) return a;
  return Rect{a.left < b.left ? a.left : b.left, a.top < b.top ? a.top : b.top,
              a.right > b.right ? a.right : b.right, a.bottom > b.bottom ? a.bottom : b.bottom};
}
}  // namespace

OffscreenWindow::OffscreenWindow(Size editor_size, Size tile)
    : previous_clock_(install_clock(&clock_)),
      core_(*this),
      editor_size_(editor_size),
      window_size_(editor_size),
      tile_size_(or_default(tile, editor_size)),
      tile_buffer_(*this, or_default(tile, editor_size)),
      screen_(static_cast<size_t>(editor_size.width > 0 ? editor_size.width : 0) *
                  static_cast<size_t>(editor_size.height > 0 ? editor_size.height : 0),
              0) {
  core_.set_editor_size(editor_size);
  core_.set_line_editor(&line_editor_);
  core_.set_menu(&menu_);
}

OffscreenWindow::~OffscreenWindow() {
  // The controls may be destroyed before the window that showed them.
  if (captured_) {
    captured_ = false;
    core_.forget_capture();
  }
  close();
  install_clock(previous_clock_);
}

int32_t OffscreenWindow::open(void*) {
  open_ = true;
  open_size_ = can_resize_ ? core_.get_editor_size() : window_size_;
  return 0;
}

void OffscreenWindow::close() {
  if (!open_) return;
  core_.close_timers();
  if (captured_) release_capture();
  core_.destroyed();
  open_ = false;
}

void OffscreenWindow::set_roots(MessageHandlerInterface* background, MessageHandlerInterface* controls) {
  core_.set_background_root(background);
  core_.set_control_root(controls);
}

// The simulated screen keeps the size it was made with.
void OffscreenWindow::set_editor_size(Size size) { core_.set_editor_size(size); }

void OffscreenWindow::mouse_move(int32_t x, int32_t y) {
  cursor_ = Point{x, y};
  core_.mouse_move(x, y);
}

void OffscreenWindow::button_down(uint32_t button, uint32_t modifiers) {
  buttons_ |= button;
  core_.mouse_button(cursor_.x, cursor_.y, buttons_, modifiers, 0);
}

void OffscreenWindow::button_up(uint32_t button, uint32_t modifiers) {
  buttons_ &= ~button;
  core_.mouse_button(cursor_.x, cursor_.y, buttons_, modifiers, 0);
}

void OffscreenWindow::double_click(uint32_t button) {
  buttons_ |= button;
  uint32_t code = button == kButtonLeft ? kDoubleLeft : (button == kButtonRight ? kDoubleRight : kDoubleMiddle);
  core_.mouse_button(cursor_.x, cursor_.y, buttons_, 0, code);
}

void OffscreenWindow::lose_capture() {
  if (captured_) release_capture();
}

bool OffscreenWindow::take_capture() {
  if (refuse_capture_) return captured_;
  captured_ = true;
  return true;
}

void OffscreenWindow::release_capture() {
  if (!captured_) return;
  captured_ = false;
  core_.capture_changed();
}

uint64_t OffscreenWindow::current_thread() const {
  return static_cast<uint64_t>(std::hash<std::thread::id>()(std::this_thread::get_id()));
}

bool OffscreenWindow::start_timer(uint32_t period_ms, uintptr_t& platform_id) {
  if (refuse_timers_) return false;
  platform_id = g_last_platform_timer.fetch_add(1) + 1;
  uint32_t period = period_ms > 0 ? period_ms : 1;  // the system rounds tiny periods up too
  timers_.push_back(Timer{platform_id, period, clock_.now_ms() + period});
  return true;
}

bool OffscreenWindow::kill_timer(uintptr_t platform_id) {
  for (size_t i = 0; i < timers_.size(); ++i) {
    if (timers_[i].platform_id == platform_id) {
      timers_.erase(timers_.begin() + static_cast<std::ptrdiff_t>(i));
      return true;
    }
  }
  return false;
}

void OffscreenWindow::advance_ms(uint32_t ms) {
  uint32_t end = clock_.now_ms() + ms;
  for (;;) {
    // The earliest due timer, the older one first on a tie; handlers may add
    // or kill timers, so look afresh each time.
    size_t best = timers_.size();
    for (size_t i = 0; i < timers_.size(); ++i) {
      if (timers_[i].due_ms <= end && (best == timers_.size() || timers_[i].due_ms < timers_[best].due_ms)) best = i;
    }
    if (best == timers_.size()) break;
    clock_.set_ms(timers_[best].due_ms);
    timers_[best].due_ms += timers_[best].period_ms;
    WindowCore::timer_tick(timers_[best].platform_id);
  }
  clock_.set_ms(end);
}

void OffscreenWindow::invalidate_area(const Rect& rect) {
  invalidated_.push_back(rect);
  pending_ = unite(pending_, rect);
}

void OffscreenWindow::paint_pending() {
  Rect area = pending_;
  pending_ = Rect{};
  if (!area.empty()) paint(area);
}

void OffscreenWindow::paint_all() {
  pending_ = Rect{};
  paint(Rect{0, 0, window_size_.width, window_size_.height});
}

void OffscreenWindow::paint(const Rect& area) { core_.paint(area, tile_buffer_, window_size_); }

uint32_t OffscreenWindow::pixel(int32_t x, int32_t y) const {
  if (x < 0 || y < 0 || x >= editor_size_.width || y >= editor_size_.height) return 0;
  return screen_[static_cast<size_t>(y) * static_cast<size_t>(editor_size_.width) + static_cast<size_t>(x)];
}

void OffscreenWindow::fill_face(const Rect& rect) {
  // Outside the editor there is no simulated screen to fill; only count it.
  (void)rect;
}

void OffscreenWindow::TileBuffer::blit(Point position, Size size) {
  MemoryRenderingBuffer::blit(position, size);
  const uint32_t* src = get_pixels();
  for (int32_t y = 0; y < size.height; ++y) {
    for (int32_t x = 0; x < size.width; ++x) {
      int32_t sx = position.x + x;
      int32_t sy = position.y + y;
      if (sx < 0 || sy < 0 || sx >= owner_.editor_size_.width || sy >= owner_.editor_size_.height) continue;
      owner_.screen_[static_cast<size_t>(sy) * static_cast<size_t>(owner_.editor_size_.width) + static_cast<size_t>(sx)] =
          src[static_cast<size_t>(y) * static_cast<size_t>(get_width()) + static_cast<size_t>(x)];
    }
  }
}

}  // namespace guikit
