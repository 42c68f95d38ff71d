#include "params/num_param_mgr.h"

#include "guikit/text_box.h"
#include "params/param_text_buffer.h"

namespace plugcore {

void NumParamMgr::show_texts() {
  if (param_ == nullptr) return;
  guikit::TextBox* const boxes[3] = {name_, unit_, value_};
  const std::string texts[3] = {param_name_text(*param_), param_unit_text(*param_),
                                param_value_text(*param_, param_->get_value())};
  for (int i = 0; i < 3; ++i) {
    if (boxes[i] == nullptr) continue;
    boxes[i]->set_text(texts[i]);
    boxes[i]->request_redraw();
  }
}

}  // namespace plugcore
