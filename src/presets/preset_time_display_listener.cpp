#include "presets/preset_time_display_listener.h"

#include <cmath>
#include <cstdio>

#include "guikit/control_interface.h"
#include "guikit/event_listener_interface.h"
#include "guikit/text_box.h"
#include "presets/preset_listener_ref_list.h"
#include "presets/preset_time_fader_listener.h"

namespace plugcore {

std::string PresetTimeDisplayListener::format(double seconds) const {
  char text[64];
  if (precision_ <= 0) {
    std::snprintf(text, sizeof(text), "%d", static_cast<int>(std::floor(seconds + 0.5)));
  } else {
    std::snprintf(text, sizeof(text), "%.*lf", precision_, seconds);
  }
  return text;
}

void PresetTimeDisplayListener::show(double seconds) {
  auto* box = dynamic_cast<guikit::TextBox*>(get_control());
  if (box == nullptr) return;
  box->set_text(format(seconds));
  box->request_redraw();
}

void PresetTimeDisplayListener::on_event(int32_t code, int32_t) {
  auto* box = dynamic_cast<guikit::TextBox*>(get_control());
  if (code != 2 || box == nullptr || hub_ == nullptr) return;
  double seconds = 0.0;
  if (std::sscanf(box->get_text().c_str(), "%lf", &seconds) == 1) {
    if (!(seconds >= 0.0)) seconds = 0.0;  // also catches a typed "nan"
    if (seconds > PresetTimeFaderListener::kMaxFadeTime) seconds = PresetTimeFaderListener::kMaxFadeTime;
  } else {
    seconds = 0.0;
  }
  PresetTimeFaderListener* fader = hub_->use_time_fader_listener();
  if (fader == nullptr || fader->get_control() == nullptr) return;
  fader->get_control()->set_value_by_user(PresetTimeFaderListener::position_from_time(seconds),
                                          guikit::kOriginMouse);
}

}  // namespace plugcore
