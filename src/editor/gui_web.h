#pragma once

#include "config/setup_mgr.h"
#include "config/web_site_jump.h"
#include "editor/gui_part.h"
#include "guikit/push_button.h"

class EditorTrees;

// The info panel: the setup button with the setup menu behind it and the web jumps.
class GuiWeb : public GuiPart {
 public:
  explicit GuiWeb(BrakmorphGui& gui) : GuiPart(gui) {}

  void build(EditorTrees& trees);
  // Answers the setup manager's status.
  int init();

  guikit::PushButton& setup_button() { return setup_button_; }
  plugcore::SetupMgr& use_setup() { return setup_; }

 private:
  guikit::PushButton setup_button_;
  plugcore::SetupMgr setup_{true, true};
  WebSiteJump web_;
};
