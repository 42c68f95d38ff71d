#include "editor/gui_part.h"

#include "editor/brakmorph_gui.h"
#include "guikit/control_interface.h"
#include "guikit/ctrl_group_item.h"

std::vector<guikit::Picture> GuiPart::frame_slots(const std::string& stem, int count, guikit::Point placement) const {
  std::vector<guikit::Picture> frames;
  for (int k = 0; k < count; ++k) frames.push_back(slot(stem + "_" + std::to_string(k), placement));
  return frames;
}

guikit::Picture GuiPart::slot(const std::string& name, guikit::Point placement) const {
  return gui_.use_pictures().slot(name, placement);
}

void GuiPart::place(guikit::CtrlGroupItem& group, guikit::ControlInterface& control, guikit::Point offset,
                    const guikit::Rect& box) {
  control.set_offset(offset);
  control.set_bounding_box(box);
  control.set_placed(true);
  group.add_control(&control);
}
