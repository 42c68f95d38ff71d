#include "guikit/messages.h"

#include <atomic>

namespace guikit {

namespace {
std::atomic<int32_t> g_last_timer_id{0};
}

SetTimer::SetTimer(float period, MessageHandlerInterface* handler, int32_t* id_out)
    : period(period), handler(handler), timer_id(g_last_timer_id.fetch_add(1, std::memory_order_relaxed) + 1) {
  if (id_out) *id_out = timer_id;
}

void SetTimer::reset_ids() { g_last_timer_id.store(0, std::memory_order_relaxed); }

}  // namespace guikit
