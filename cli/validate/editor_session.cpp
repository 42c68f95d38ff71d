#include "cli/validate/editor_session.h"

#include <chrono>
#include <stdexcept>
#include <string>
#include <thread>

namespace plugcore {

EditorSize query_editor_size(HostedPlugin& plugin) {
  if ((plugin.flags() & effFlagsHasEditor) == 0) {
    throw std::runtime_error("plug-in " + plugin.path() + " has no editor");
  }
  ERect* rect = nullptr;
  plugin.dispatch(effEditGetRect, 0, 0, &rect);
  if (rect == nullptr) throw std::runtime_error("the editor reported no size (effEditGetRect)");
  EditorSize size;
  size.width = rect->right - rect->left;
  size.height = rect->bottom - rect->top;
  if (size.width <= 0 || size.height <= 0) {
    throw std::runtime_error("the editor reported an empty size " + std::to_string(size.width) + "x" +
                             std::to_string(size.height));
  }
  return size;
}

EditorSession::EditorSession(HostedPlugin& plugin, EditorParentInterface& parent)
    : plugin_(plugin), parent_(parent) {
  // The answer of effEditOpen is not meaningful across plug-ins; a refusal
  // shows as an editor that made no window.
  plugin_.dispatch(effEditOpen, 0, 0, parent_.native_handle());
  parent_.pump_events();
}

EditorSession::~EditorSession() {
  plugin_.dispatch(effEditClose);
  parent_.pump_events();
}

void EditorSession::idle() {
  plugin_.dispatch(effEditIdle);
  parent_.pump_events();
}

void EditorSession::run_for(double seconds, int period_ms) {
  using Clock = std::chrono::steady_clock;
  const auto period = std::chrono::milliseconds(period_ms);
  const bool until_closed = seconds <= 0.0;
  const auto end = Clock::now() + std::chrono::microseconds(static_cast<long long>(seconds * 1e6));
  auto next = Clock::now();
  while (!parent_.close_requested()) {
    idle();
    next += period;
    if (!until_closed && next >= end) break;
    std::this_thread::sleep_until(next);
  }
}

}  // namespace plugcore
