#pragma once

#include <cstdint>
#include <string>

#include "config/system_ui_interface.h"
#include "guikit/rect.h"

namespace sys {

// The dialogs we draw ourselves when the desktop has no dialog program. Each runs
// a modal loop of its own on a display connection of its own.

// A path typed into a one-line field: status 0 with the path, 1 cancelled,
// -1024 when no window could be shown. filter_index is the request's.
FileDialogResult run_fallback_file_dialog(const FileDialogRequest& request);

// Answers as SystemUiInterface::show_message_box: 0 first button, 1 second, -1
// when no window could be shown.
int32_t show_fallback_message_box(const std::string& title, const std::string& text, int32_t buttons,
                                  int32_t default_button);

// Where the message box puts button index of count in a window of this size: a
// row of equal buttons at the bottom right, whatever the font.
guikit::Rect message_box_button_rect(guikit::Size window, int32_t count, int32_t index);

}  // namespace sys
