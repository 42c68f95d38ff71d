#include "guikit/headless/offscreen_menu.h"

#include "guikit/messages.h"

namespace guikit {

int32_t OffscreenMenu::show(const MenuRequest& request) {
  if (!request.root) return -1;
  ++shows_;
  last_entries_ = flatten_menu(*request.root);
  int32_t chosen = next_choice_;
  next_choice_ = 0;
  if (chosen != 0) {
    MenuItem* item = find_menu_item(*request.root, chosen);
    if (item && !item->is_grayed() && item->get_listener()) item->get_listener()->on_select();
  }
  ++closes_;
  return 0;
}

int32_t OffscreenMenu::close() {
  ++closes_;
  return 0;
}

}  // namespace guikit
