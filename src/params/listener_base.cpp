#include "params/listener_base.h"

#include "guikit/control_interface.h"
#include "host/host_gui_interface.h"
#include "params/normalized_param_interface.h"

namespace plugcore {

bool ListenerBase::can_change(int32_t origin) {
  return is_bound() && !refreshing_ ? host_gui_->can_set_param(index_, origin) : true;
}

void ListenerBase::hold_change(int32_t origin) {
  if (is_bound()) host_gui_->lock_param(index_, origin);
}

void ListenerBase::end_change(int32_t origin) {
  if (is_bound()) host_gui_->release_param(index_, origin);
}

double ListenerBase::filter_user_value(double value, int32_t origin) {
  if (is_bound()) host_gui_->set_param_automated(index_, static_cast<float>(value), origin);
  return value;
}

void ListenerBase::bind_param(int32_t index, NormalizedParamInterface* param) {
  index_ = index < 0 ? -1 : index;
  param_ = index < 0 ? nullptr : param;
}

bool ListenerBase::refresh() {
  guikit::ControlInterface* control = get_control();
  if (control == nullptr || param_ == nullptr) return false;
  refreshing_ = true;
  const bool shown = control->set_value(param_->get_norm(), guikit::kOriginSync);
  refreshing_ = false;
  return shown;
}

}  // namespace plugcore
