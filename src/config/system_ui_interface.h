#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace sys {

// One entry of a file dialog's type list, e.g. {"Preset bank (*.pbk)", "*.pbk"}.
struct FileFilter {
  std::string description;
  std::string pattern;
};

// What a file dialog is shown with.
struct FileDialogRequest {
  bool save = false;
  std::string title;
  std::string directory;  // the folder it opens in, may be empty
  std::string file_name;  // name and extension proposed, may be empty
  std::vector<FileFilter> filters;
  int32_t filter_index = 0;  // selected filter, from 0
};

// What the user did with it. status: 0 chosen, 1 cancelled, -1024 the dialog failed.
struct FileDialogResult {
  int32_t status = 1;
  std::string path;
  int32_t filter_index = 0;
};

// The modal services of the user's desktop: file dialogs, message boxes and
// the web browser. The platform provides one; tests install a scripted one.
class SystemUiInterface {
 public:
  virtual ~SystemUiInterface() = default;
  virtual FileDialogResult run_file_dialog(const FileDialogRequest& request) = 0;
  // buttons: 0 OK, 1 OK+Cancel, 2 Yes+No; default_button 0 first, 1 second.
  // Answers 0 for the first button, 1 for the second, -1 when no box could be shown.
  virtual int32_t show_message_box(const std::string& title, const std::string& text, int32_t buttons,
                                   int32_t default_button) = 0;
  // 0 when the browser was started, -1 otherwise.
  virtual int32_t open_url(const std::string& address) = 0;
};

}  // namespace sys
