#include "guikit/diode.h"

#include <cmath>

namespace guikit {

double Diode::get_shown_level() const { return override_ ? level_ : std::floor(value_ + 0.5); }

int32_t Diode::on_show_object(ShowObject& msg) {
  if (msg.visible && timer_id_ < 0) start_timer(refresh_);
  return 0;
}

int32_t Diode::on_notify(Notify& msg) {
  if (msg.timer_id != timer_id_) return -1;
  each_event(2, 0);
  if (override_) {
    update_level();
    invalidate_self();
  }
  return 0;
}

}  // namespace guikit
