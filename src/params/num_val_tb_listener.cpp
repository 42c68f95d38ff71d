#include "params/num_val_tb_listener.h"

#include <algorithm>

#include "guikit/text_box.h"
#include "params/num_param_mgr_interface.h"
#include "params/param_text_buffer.h"

namespace plugcore {

void NumValTbListener::on_event(int32_t code, int32_t argument) {
  if (code != kEventEditAccepted) {
    NumParamListener::on_event(code, argument);
    return;
  }
  auto* box = dynamic_cast<guikit::TextBox*>(get_control());
  NumParamMgrInterface* mgr = use_param_mgr();
  NormalizedParamInterface* param = use_param();
  guikit::ControlInterface* knob = mgr != nullptr ? mgr->use_knob() : nullptr;
  if (box == nullptr || knob == nullptr || param == nullptr) return;

  bool ok = false;
  const double value = param->conv_text_to_value(box->get_text().c_str(), ok);
  if (ok) {
    const double norm = std::min(1.0, std::max(0.0, static_cast<double>(param->conv_value_to_norm(value))));
    if (knob->set_value_by_user(norm, guikit::kOriginMouse)) return;
  }
  // Unreadable, or the parameter is held by a stronger writer: show what it is.
  box->set_text(param_value_text(*param, param->get_value()));
  box->request_redraw();
}

}  // namespace plugcore
