#include "editor/rc_mgr.h"

#include <algorithm>

#include "editor/param_control_finder_interface.h"
#include "guikit/default_event_listener.h"
#include "guikit/messages.h"
#include "guikit/pot_interface.h"

namespace {

const std::array<double, 2> kUnset{{-1.0, -1.0}};

}  // namespace

RcMgr::RcMgr(ParamControlFinderInterface* finder, int param_index) : finder_(finder), index_(param_index) {
  limits_.fill(kUnset);
}

int RcMgr::slot_of(int param_index) {
  const int slot = (param_index - kFirstBandParam) % kParamsPerBand;
  return slot < 0 ? slot + kParamsPerBand : slot;
}

guikit::ControlInterface* RcMgr::own_control() const { return owner_ != nullptr ? owner_->get_control() : nullptr; }

// The press that set the link is still under way: button held, or a pot
// finishing its glide after release.
bool RcMgr::gesture_live() const {
  guikit::ControlInterface* control = own_control();
  if (control == nullptr) return false;
  if (control->is_active()) return true;
  auto* pot = dynamic_cast<guikit::PotInterface*>(control);
  return pot != nullptr && pot->is_released();
}

void RcMgr::take_limits() {
  guikit::ControlInterface* control = own_control();
  const int own_band = band_of(index_);
  const int slot = slot_of(index_);
  for (int c = 0; c < kNbrBands; ++c) {
    limits_[c] = kUnset;
    if (c == own_band || control == nullptr || finder_ == nullptr) continue;
    guikit::ControlInterface* other = finder_->find_param_control(param_of(c, slot));
    if (other != nullptr) limits_[c] = {{control->get_value(), other->get_value()}};
  }
}

void RcMgr::release_linked() {
  if (finder_ == nullptr) return;
  const int own_band = band_of(index_);
  const int slot = slot_of(index_);
  for (int c = 0; c < kNbrBands; ++c) {
    if (c == own_band) continue;
    guikit::ControlInterface* other = finder_->find_param_control(param_of(c, slot));
    guikit::EventListenerInterface* listener = other != nullptr ? other->get_first_listener() : nullptr;
    if (listener != nullptr) listener->end_change(guikit::kOriginMouse);
  }
}

void RcMgr::on_before_message(guikit::MessageInterface& message) {
  auto* click = dynamic_cast<guikit::MouseClick*>(&message);
  if (click == nullptr) return;
  if (click->buttons == 0) {
    // A button going up keeps the mode, and gives the linked bands back like
    // the dragged one, so the glide after release reaches them too.
    if (linked_) release_linked();
    return;
  }
  linked_ = (click->buttons & guikit::kButtonRight) != 0;
  relative_ = (click->modifiers & guikit::kModShift) != 0;
  mirrored_ = (click->modifiers & guikit::kModControl) != 0;
  if (linked_) {
    take_limits();
  } else {
    limits_.fill(kUnset);
  }
}

void RcMgr::on_value(double value, int32_t origin) {
  if (!linked_ || busy_ || finder_ == nullptr) return;
  if (origin != guikit::kOriginMouse && origin != guikit::kOriginGlide) return;
  if (!gesture_live()) return;
  busy_ = true;
  const int own_band = band_of(index_);
  const int slot = slot_of(index_);
  for (int c = 0; c < kNbrBands; ++c) {
    if (c == own_band) continue;
    guikit::ControlInterface* other = finder_->find_param_control(param_of(c, slot));
    if (other == nullptr) continue;
    double target;
    if (!relative_) {
      target = mirrored_ ? 1.0 - value : value;
    } else {
      if (limits_[c][0] < 0.0) {
        // No press seen (the control was linked some other way): start here.
        guikit::ControlInterface* control = own_control();
        limits_[c] = {{control != nullptr ? control->get_value() : value, other->get_value()}};
      }
      const double change = value - limits_[c][0];
      target = std::min(1.0, std::max(0.0, limits_[c][1] + (mirrored_ ? -change : change)));
    }
    // The editor's echo of its own write may run this twice for one step.
    if (other->get_value() != target) other->set_value_by_user(target, origin);
  }
  busy_ = false;
}
