#include "editor/gui_web.h"

#include "editor/brakmorph_gui.h"
#include "editor/editor_trees.h"
#include "host/host_gui_interface.h"

void GuiWeb::build(EditorTrees& trees) {
  setup_button_.set_frames({slot("pb_53_0", guikit::Point{0, 0}), slot("pb_53_1", guikit::Point{0, 0})});
  place(trees.info_group(), setup_button_, guikit::Point{181, 40}, guikit::Rect{0, 0, 57, 14});
}

int GuiWeb::init() {
  plugcore::HostGuiInterface* host_gui = gui_.get_host_gui();
  plugcore::MidiMgr* midi = host_gui != nullptr ? host_gui->use_midi_mgr() : nullptr;
  // The port submenus list what the plug-in's port choice offers.
  setup_.set_port_selection(host_gui != nullptr ? host_gui->use_midi_dev_selector() : nullptr);
  return setup_.init(gui_, midi, setup_button_, &web_, 1);
}
