#pragma once

#include <X11/Xlib.h>

#include <cstdint>
#include <string>
#include <vector>

#include "guikit/menu_interface.h"
#include "guikit/menu_nodes.h"

namespace guikit {

class X11OwnerInterface;

// Pop-up menus drawn by the toolkit in undecorated windows at the pointer: items
// with ticks, greyed entries, plain and labelled delimiters, sub-menus opening to
// the side. show() holds the pointer and the keyboard and runs its own event loop
// (the editor keeps painting and its timers keep running) until an item is
// chosen, Escape closes the last level or a click lands outside; then it calls
// the chosen item's listener.
class MenuX11 : public MenuInterface {
 public:
  // Every menu window carries this name, so other programs (and tests) can find it.
  static constexpr const char* kWindowName = "Brakmorph menu";
  static constexpr int32_t kRowHeight = 18;
  static constexpr int32_t kSeparatorHeight = 8;
  static constexpr int32_t kBorder = 2;

  // One line of a menu level, with its place in the level's window.
  struct Row {
    MenuEntry entry;
    MenuList* sub_menu;  // for sub-menu entries
    int32_t top;
    int32_t height;
  };

  MenuX11() = default;
  ~MenuX11() override;
  MenuX11(const MenuX11&) = delete;
  MenuX11& operator=(const MenuX11&) = delete;

  void set_owner(X11OwnerInterface* owner) { owner_ = owner; }
  int32_t show(const MenuRequest& request) override;
  int32_t close() override;
  bool is_shown() const { return shown_; }

  // The lines of one level of the tree, as shown.
  static std::vector<Row> layout(const MenuList& list);

 private:
  struct Level {
    MenuList* list;
    std::vector<Row> rows;
    Window window;
    int32_t x, y, width, height;
    int hover;
  };

  void open_level(MenuList* list, int32_t x, int32_t y);
  void close_levels_from(size_t index);
  void draw(const Level& level);
  int level_of(Window window) const;
  int row_at(const Level& level, int32_t y) const;
  void hover(size_t level, int row);
  // Chooses or opens the row; answers whether the loop ends.
  bool activate(size_t level, int row);
  void move_hover(int step);
  void handle(XEvent& event);

  X11OwnerInterface* owner_ = nullptr;
  Display* display_ = nullptr;
  GC gc_ = nullptr;
  XFontStruct* font_ = nullptr;
  std::vector<Level> levels_;
  bool shown_ = false;
  bool done_ = false;
  int32_t chosen_ = 0;
};

}  // namespace guikit
