#include <windows.h>
#include <commdlg.h>
#include <shellapi.h>

#include <cstring>
#include <string>

#include "config/system_ui.h"

namespace sys {

namespace {

constexpr size_t kFileNameCapacity = 1024;

// "description\0pattern\0...\0\0", with ',' between patterns turned into the
// dialog's ';'.
std::string filter_text(const std::vector<FileFilter>& filters) {
  std::string text;
  for (const FileFilter& filter : filters) {
    text += filter.description;
    text += '\0';
    for (char c : filter.pattern) text += c == ',' ? ';' : c;
    text += '\0';
  }
  text += '\0';
  return text;
}

// By the toolkit's button-set and default-button numbers.
const UINT kButtonSets[] = {MB_OK, MB_OKCANCEL, MB_YESNO};
const UINT kDefaultButtons[] = {MB_DEFBUTTON1, MB_DEFBUTTON2, MB_DEFBUTTON3, MB_DEFBUTTON4};

// The common dialogs, message boxes and the shell of the Windows desktop.
class Win32SystemUi : public SystemUiInterface {
 public:
  FileDialogResult run_file_dialog(const FileDialogRequest& request) override {
    const std::string filters = filter_text(request.filters);
    char file[kFileNameCapacity] = {0};
    std::strncpy(file, request.file_name.c_str(), kFileNameCapacity - 1);
    OPENFILENAMEA ofn{};
    ofn.lStructSize = sizeof ofn;
    ofn.hwndOwner = nullptr;
    ofn.lpstrFilter = filters.c_str();
    ofn.nFilterIndex = static_cast<DWORD>(request.filter_index + 1);
    ofn.lpstrFile = file;
    ofn.nMaxFile = static_cast<DWORD>(kFileNameCapacity);
    ofn.lpstrInitialDir = request.directory.empty() ? nullptr : request.directory.c_str();
    ofn.lpstrTitle = request.title.c_str();
    ofn.Flags = OFN_HIDEREADONLY | OFN_NOCHANGEDIR | OFN_LONGNAMES | OFN_ENABLESIZING;
    const BOOL chosen = request.save ? GetSaveFileNameA(&ofn) : GetOpenFileNameA(&ofn);
    FileDialogResult result;
    if (!chosen) {
      result.status = CommDlgExtendedError() == 0 ? 1 : -1024;
      return result;
    }
    result.status = 0;
    result.path = file;
    result.filter_index = static_cast<int32_t>(ofn.nFilterIndex) - 1;
    return result;
  }

  int32_t show_message_box(const std::string& title, const std::string& text, int32_t buttons,
                           int32_t default_button) override {
    if (buttons < 0 || buttons > 2 || default_button < 0 || default_button > 3) return -1;
    const UINT style = kButtonSets[buttons] | kDefaultButtons[default_button] | MB_SETFOREGROUND;
    switch (MessageBoxA(nullptr, text.c_str(), title.c_str(), style)) {
      case IDOK:
      case IDYES:
        return 0;
      case IDCANCEL:
      case IDNO:
        return 1;
      default:
        return -1;
    }
  }

  int32_t open_url(const std::string& address) override {
    const HINSTANCE result = ShellExecuteA(nullptr, "open", address.c_str(), nullptr, ".", 0);
    return reinterpret_cast<INT_PTR>(result) > 32 ? 0 : -1;
  }
};

}  // namespace

SystemUiInterface& platform_system_ui() {
  static Win32SystemUi ui;
  return ui;
}

}  // namespace sys
