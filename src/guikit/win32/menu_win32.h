#pragma once

#include <windows.h>

#include <cstdint>

#include "guikit/menu_interface.h"

namespace guikit {

class MenuList;

// Pop-up menus at the cursor: the menu tree becomes a system pop-up menu,
// tracked modally under a small helper window; the chosen item's listener is
// called once the menu has closed.
class MenuWin32 : public MenuInterface {
 public:
  MenuWin32() = default;
  MenuWin32(const MenuWin32&) = delete;
  MenuWin32& operator=(const MenuWin32&) = delete;
  ~MenuWin32() override;

  void set_owner(HWND owner) { owner_ = owner; }
  int32_t show(const MenuRequest& request) override;
  int32_t close() override;

  // The system menu of the tree, as show builds it; nullptr when it cannot be
  // built. The caller destroys it.
  static HMENU build_popup(const MenuList& root);

 private:
  void destroy_parts();

  HWND owner_ = nullptr;
  HWND host_window_ = nullptr;
  HMENU popup_ = nullptr;
  bool tracking_ = false;
};

}  // namespace guikit
