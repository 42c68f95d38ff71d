#pragma once

#include <string>
#include <vector>

#include "guikit/picture.h"
#include "guikit/rect.h"

namespace guikit {
class ControlInterface;
class CtrlGroupItem;
}  // namespace guikit

class BrakmorphGui;

// One area of the editor: builds its controls from the editor's pictures and
// places them in a control group.
class GuiPart {
 public:
  explicit GuiPart(BrakmorphGui& gui) : gui_(gui) {}
  GuiPart(const GuiPart&) = delete;
  GuiPart& operator=(const GuiPart&) = delete;
  virtual ~GuiPart() = default;

 protected:
  // "stem_0" .. "stem_<count-1>", each placed at placement from the control.
  std::vector<guikit::Picture> frame_slots(const std::string& stem, int count, guikit::Point placement) const;
  guikit::Picture slot(const std::string& name, guikit::Point placement) const;
  // Offset inside the group, hit rectangle relative to the control.
  static void place(guikit::CtrlGroupItem& group, guikit::ControlInterface& control, guikit::Point offset,
                    const guikit::Rect& box);

  BrakmorphGui& gui_;
};
