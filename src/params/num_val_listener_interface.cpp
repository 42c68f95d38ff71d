#include "params/num_val_listener_interface.h"

#include "guikit/text_box.h"
#include "params/num_param_mgr_interface.h"
#include "params/param_text_buffer.h"

namespace plugcore {

double NumValListenerInterface::value_changed(double value, int32_t origin) {
  value = NumParamListener::value_changed(value, origin);
  NumParamMgrInterface* mgr = use_param_mgr();
  NormalizedParamInterface* param = use_param();
  guikit::TextBox* box = mgr != nullptr ? mgr->use_value_box() : nullptr;
  if (box != nullptr && param != nullptr) {
    box->set_text(param_value_text(*param, param->conv_norm_to_value(static_cast<float>(value))));
    box->request_redraw();
  }
  return value;
}

}  // namespace plugcore
