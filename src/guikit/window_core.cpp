#include "guikit/window_core.h"

#include <cmath>
#include <vector>

#include "guikit/menu_interface.h"
#include "guikit/rendering_buffer_interface.h"
#include "guikit/text_line_editor_interface.h"

namespace guikit {

namespace {

// Every platform timer of every editor window, shared process-wide.
struct TimerRecord {
  uintptr_t platform_id;
  int32_t toolkit_id;
  WindowCore* window;
};
std::vector<TimerRecord>& timer_records() {
  static std::vector<TimerRecord> records;
  return records;
}

int32_t clamp(int32_t v, int32_t lo, int32_t hi) { return v < lo ? lo : (v > hi ? hi : v); }

// Relative-mode warps: the cursor goes back to the anchor at most this often,
// and not before the capture has settled.
constexpr uint32_t kWarpIntervalMs = 100;
constexpr uint32_t kCaptureSettleMs = 250;

}  // namespace

WindowCore::~WindowCore() { close_timers(); }

int32_t WindowCore::process_message(MessageInterface& message) {
  if (!dynamic_cast<MessageUp*>(&message) || !platform_.window_exists()) return -1;
  if (auto* m = dynamic_cast<Invalidate*>(&message)) {
    Rect r{clamp(m->rect.left, 0, editor_size_.width), clamp(m->rect.top, 0, editor_size_.height),
           clamp(m->rect.right, 0, editor_size_.width), clamp(m->rect.bottom, 0, editor_size_.height)};
    platform_.invalidate_area(r);
    return 0;
  }
  if (auto* m = dynamic_cast<MouseCapture*>(&message)) return on_capture(*m);
  if (auto* m = dynamic_cast<MouseRelease*>(&message)) return on_release(*m);
  if (auto* m = dynamic_cast<SetTimer*>(&message)) return on_set_timer(*m);
  if (auto* m = dynamic_cast<ClearTimer*>(&message)) return on_clear_timer(*m);
  if (auto* m = dynamic_cast<TextInputRequest*>(&message)) {
    if (!line_editor_) return -1;
    if (line_editor_->is_active()) line_editor_->stop(false);
    return line_editor_->start(*m);
  }
  if (auto* m = dynamic_cast<TextInputStop*>(&message)) {
    if (!line_editor_ || !line_editor_->is_active()) return -1;
    return line_editor_->stop(m->accept);
  }
  if (auto* m = dynamic_cast<MenuRequest*>(&message)) return menu_ ? menu_->show(*m) : -1;
  if (dynamic_cast<MenuStop*>(&message)) return menu_ ? menu_->close() : -1;
  return -1;
}

int32_t WindowCore::on_capture(const MouseCapture& msg) {
  if (!platform_.take_capture()) return -1;
  capture_thread_ = platform_.current_thread();
  if (msg.mode == 1 || msg.mode == 2) {
    if (!cursor_hidden_) {
      platform_.show_cursor(false);
      cursor_hidden_ = true;
    }
    capture_start_ms_ = platform_.milliseconds();
    last_warp_ms_ = capture_start_ms_;
  }
  Point cursor = platform_.get_cursor();
  if (capture_handler_ && capture_handler_ != msg.handler) {
    MessageHandlerInterface* previous = capture_handler_;
    capture_handler_ = nullptr;
    MouseCaptureLost lost;
    previous->process_message(lost);
  }
  capture_handler_ = msg.handler;
  capture_mode_ = msg.mode;
  anchor_ = msg.mode == 2 ? cursor : Point{0, 0};
  last_raw_ = cursor;
  return 0;
}

int32_t WindowCore::on_release(const MouseRelease& msg) {
  if (platform_.current_thread() != capture_thread_) return -1;
  if (capture_handler_ && capture_mode_ == 2 && platform_.milliseconds() - capture_start_ms_ >= kCaptureSettleMs) {
    platform_.set_cursor(msg.restore);
  }
  platform_.release_capture();
  return platform_.holds_capture() ? -1 : 0;
}

int32_t WindowCore::on_set_timer(const SetTimer& msg) {
  uintptr_t platform_id = 0;
  auto period_ms = static_cast<uint32_t>(std::floor(static_cast<double>(msg.period) * 1000.0 + 0.5));
  if (!platform_.start_timer(period_ms, platform_id)) return -1;
  timer_records().push_back(TimerRecord{platform_id, msg.timer_id, this});
  timer_handlers_[msg.timer_id] = msg.handler;
  return 0;
}

int32_t WindowCore::on_clear_timer(const ClearTimer& msg) {
  auto& records = timer_records();
  bool found = false;
  bool refused = false;
  for (size_t i = 0; i < records.size();) {
    if (records[i].window == this && records[i].toolkit_id == msg.timer_id) {
      found = true;
      uintptr_t platform_id = records[i].platform_id;
      records.erase(records.begin() + static_cast<std::ptrdiff_t>(i));
      if (!platform_.kill_timer(platform_id)) refused = true;
    } else {
      ++i;
    }
  }
  timer_handlers_.erase(msg.timer_id);
  return found && !refused ? 0 : -1;
}

void WindowCore::close_timers() {
  auto& records = timer_records();
  for (size_t i = 0; i < records.size();) {
    if (records[i].window == this) {
      uintptr_t platform_id = records[i].platform_id;
      records.erase(records.begin() + static_cast<std::ptrdiff_t>(i));
      platform_.kill_timer(platform_id);
    } else {
      ++i;
    }
  }
  timer_handlers_.clear();
}

void WindowCore::timer_tick(uintptr_t platform_id) {
  for (const TimerRecord& r : timer_records()) {
    if (r.platform_id == platform_id) {
      WindowCore* window = r.window;
      int32_t toolkit_id = r.toolkit_id;
      window->notify_timer(toolkit_id);  // may change the records
      return;
    }
  }
}

void WindowCore::notify_timer(int32_t toolkit_id) {
  auto it = timer_handlers_.find(toolkit_id);
  if (it == timer_handlers_.end() || !it->second) return;
  Notify notify(toolkit_id, platform_.milliseconds() * 0.001);
  it->second->process_message(notify);
}

MessageHandlerInterface* WindowCore::mouse_target() const {
  return capture_handler_ ? capture_handler_ : control_root_;
}

void WindowCore::mouse_move(int32_t x, int32_t y) {
  MessageHandlerInterface* target = mouse_target();
  if (capture_handler_ && capture_mode_ == 2) {
    int32_t dx = x - last_raw_.x;
    int32_t dy = y - last_raw_.y;
    last_raw_ = Point{x, y};
    uint32_t now = platform_.milliseconds();
    if (now - last_warp_ms_ >= kWarpIntervalMs && now - capture_start_ms_ >= kCaptureSettleMs) {
      platform_.set_cursor(anchor_);
      last_raw_ = anchor_;
      last_warp_ms_ = now;
    }
    MouseMove move(dx, dy);
    target->process_message(move);
    return;
  }
  last_raw_ = Point{x, y};
  if (!target) return;
  MouseMove move(x, y);
  target->process_message(move);
}

void WindowCore::mouse_button(int32_t x, int32_t y, uint32_t buttons, uint32_t modifiers, uint32_t double_click) {
  MessageHandlerInterface* target = mouse_target();
  if (!target) return;
  MouseClick click(x, y, buttons, modifiers, double_click);
  target->process_message(click);
}

void WindowCore::show_cursor_again() {
  if (cursor_hidden_) {
    platform_.show_cursor(true);
    cursor_hidden_ = false;
  }
}

void WindowCore::capture_changed() {
  show_cursor_again();
  MessageHandlerInterface* handler = capture_handler_;
  capture_handler_ = nullptr;
  capture_mode_ = 0;
  if (handler) {
    MouseCaptureLost lost;
    handler->process_message(lost);
  }
}

void WindowCore::forget_capture() {
  show_cursor_again();
  capture_handler_ = nullptr;
  capture_mode_ = 0;
}

void WindowCore::destroyed() { show_cursor_again(); }

void WindowCore::paint(const Rect& dirty, RenderingBufferInterface& buffer, Size window_size) {
  Rect area = dirty.intersect(Rect{0, 0, editor_size_.width, editor_size_.height});
  int32_t bw = buffer.get_width();
  int32_t bh = buffer.get_height();
  if (!area.empty() && bw > 0 && bh > 0) {
    for (int32_t x = area.left; x < area.right; x += bw) {
      for (int32_t y = area.top; y < area.bottom; y += bh) {
        Rect tile = Rect{x, y, x + bw, y + bh}.intersect(area);
        Redraw redraw(tile, buffer);
        if (background_root_) background_root_->process_message(redraw);
        if (control_root_) control_root_->process_message(redraw);
        buffer.blit(Point{tile.left, tile.top}, Size{tile.width(), tile.height()});
      }
    }
  }
  if (window_size.width > editor_size_.width)
    platform_.fill_face(Rect{editor_size_.width, 0, window_size.width, window_size.height});
  if (window_size.height > editor_size_.height)
    platform_.fill_face(Rect{0, editor_size_.height, editor_size_.width, window_size.height});
}

}  // namespace guikit
