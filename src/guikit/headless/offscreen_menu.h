#pragma once

#include <vector>

#include "guikit/menu_interface.h"
#include "guikit/menu_nodes.h"

namespace guikit {

// Menus without a screen: the choice is arranged before the menu opens (a
// shown menu blocks until it is chosen from), and the last menu's lines are kept.
class OffscreenMenu : public MenuInterface {
 public:
  int32_t show(const MenuRequest& request) override;
  int32_t close() override;

  // The id the next show picks; 0 picks nothing (escape).
  void choose_next(int32_t id) { next_choice_ = id; }
  const std::vector<MenuEntry>& get_last_entries() const { return last_entries_; }
  int get_show_count() const { return shows_; }
  int get_close_count() const { return closes_; }

 private:
  int32_t next_choice_ = 0;
  std::vector<MenuEntry> last_entries_;
  int shows_ = 0;
  int closes_ = 0;
};

}  // namespace guikit
