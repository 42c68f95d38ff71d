#include "guikit/win32/menu_win32.h"

#include <string>
#include <vector>

#include "guikit/menu_nodes.h"
#include "guikit/messages.h"
#include "guikit/win32/module_instance_win32.h"

namespace guikit {

namespace {

const char kHelperClass[] = "VelmoraAudioPluginMenu";

LRESULT CALLBACK helper_procedure(HWND hwnd, UINT message, WPARAM wparam, LPARAM lparam) {
  return DefWindowProcA(hwnd, message, wparam, lparam);
}

bool register_helper_class() {
  WNDCLASSA wc{};
  wc.lpfnWndProc = &helper_procedure;
  wc.hInstance = module_instance();
  wc.hCursor = LoadCursorA(nullptr, reinterpret_cast<LPCSTR>(IDC_ARROW));
  wc.lpszClassName = kHelperClass;
  return RegisterClassA(&wc) != 0 || GetLastError() == ERROR_CLASS_ALREADY_EXISTS;
}

}  // namespace

MenuWin32::~MenuWin32() { destroy_parts(); }

HMENU MenuWin32::build_popup(const MenuList& root) {
  // The portable flattening gives the entries' texts and nesting; a stack of
  // open sub-menus turns it back into system menus.
  struct Open {
    HMENU menu;
    std::string label;
  };
  HMENU top = CreatePopupMenu();
  if (!top) return nullptr;
  std::vector<Open> stack{Open{top, std::string()}};
  bool ok = true;
  for (const MenuEntry& entry : flatten_menu(root)) {
    HMENU current = stack.back().menu;
    switch (entry.kind) {
      case MenuEntry::kSubMenuBegin: {
        HMENU sub = CreatePopupMenu();
        if (!sub) {
          ok = false;
          break;
        }
        stack.push_back(Open{sub, entry.text});
        break;
      }
      case MenuEntry::kSubMenuEnd: {
        if (stack.size() < 2) break;
        Open sub = stack.back();
        stack.pop_back();
        HMENU parent = stack.back().menu;
        if (!InsertMenuA(parent, static_cast<UINT>(GetMenuItemCount(parent)), MF_BYPOSITION | MF_POPUP | MF_STRING,
                         reinterpret_cast<UINT_PTR>(sub.menu), sub.label.c_str())) {
          DestroyMenu(sub.menu);
          ok = false;
        }
        break;
      }
      case MenuEntry::kItem: {
        UINT flags = MF_STRING;
        if (entry.grayed) flags |= MF_GRAYED | MF_DISABLED;
        if (entry.checked) flags |= MF_CHECKED;
        ok = AppendMenuA(current, flags, static_cast<UINT_PTR>(entry.id), entry.text.c_str()) && ok;
        break;
      }
      case MenuEntry::kSeparator:
        ok = AppendMenuA(current, MF_SEPARATOR, 0, nullptr) && ok;
        break;
      case MenuEntry::kLabel:
        ok = AppendMenuA(current, MF_STRING | MF_GRAYED | MF_DISABLED, 0, entry.text.c_str()) && ok;
        break;
    }
    if (!ok) break;
  }
  // Sub-menus left open by a failure are not attached anywhere yet.
  while (stack.size() > 1) {
    DestroyMenu(stack.back().menu);
    stack.pop_back();
  }
  if (!ok) {
    DestroyMenu(top);
    return nullptr;
  }
  return top;
}

int32_t MenuWin32::show(const MenuRequest& request) {
  if (!request.root || tracking_) return -1;
  POINT cursor{0, 0};
  GetCursorPos(&cursor);
  if (!register_helper_class()) return -1;
  host_window_ = CreateWindowExA(0, kHelperClass, "ze menu", WS_CHILD | WS_VISIBLE, 0, 0, 200, 200, owner_, nullptr,
                                 module_instance(), nullptr);
  if (!host_window_) return -1;
  SetWindowLongPtrA(host_window_, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(this));
  popup_ = build_popup(*request.root);
  if (!popup_) {
    destroy_parts();
    return -1;
  }
  tracking_ = true;
  const BOOL chosen = TrackPopupMenu(popup_, TPM_RETURNCMD | TPM_LEFTALIGN | TPM_TOPALIGN | TPM_LEFTBUTTON,
                                     cursor.x, cursor.y, 0, host_window_, nullptr);
  tracking_ = false;
  destroy_parts();
  if (chosen != 0) {
    MenuItem* item = find_menu_item(*request.root, static_cast<int32_t>(chosen));
    if (item && item->get_listener()) item->get_listener()->on_select();
  }
  return 0;
}

int32_t MenuWin32::close() {
  // While tracking, ending the menu makes show return and clean up.
  if (tracking_) {
    EndMenu();
    return 0;
  }
  destroy_parts();
  return 0;
}

void MenuWin32::destroy_parts() {
  if (popup_) DestroyMenu(popup_);
  popup_ = nullptr;
  if (host_window_) DestroyWindow(host_window_);
  host_window_ = nullptr;
}

}  // namespace guikit
