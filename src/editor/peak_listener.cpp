#include "editor/peak_listener.h"

#include "dsp/brakmorph_dsp.h"
#include "editor/fading_diode.h"

void PeakListener::on_event(int32_t code, int32_t argument) {
  if (code != kEventTick || engine_ == nullptr) return;
  auto* diode = dynamic_cast<FadingDiode*>(get_control());
  if (diode == nullptr) return;
  const bool clip = engine_->read_clip();
  if (clip == last_clip_) return;
  diode->set_value_by_user(clip ? 1.0 : 0.0, guikit::kOriginMeter);
  diode->start_fade();
  last_clip_ = clip;
}
