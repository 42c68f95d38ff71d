// The window a host gives a plug-in's editor as its parent: a top-level
// window of the editor's size on the desktop, pumped by the host's own loop
// (nothing runs by itself). Implemented once per platform.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace plugcore {

// A grab of a window: 0x00RRGGBB pixels, top row first.
struct PixelImage {
  int width = 0;
  int height = 0;
  std::vector<uint32_t> pixels;
  uint32_t at(int x, int y) const { return pixels[static_cast<size_t>(y) * width + x]; }
};

class EditorParentInterface {
 public:
  virtual ~EditorParentInterface() = default;
  // What effEditOpen receives: the X window id, or the window handle.
  virtual void* native_handle() = 0;
  virtual void resize(int width, int height) = 0;
  // Handles whatever arrived for this window, without waiting.
  virtual void pump_events() = 0;
  // The user closed the window.
  virtual bool close_requested() const = 0;
  // Windows directly inside this one (the editor's own).
  virtual int child_count() = 0;
  // The window's contents as shown, the editor's included.
  virtual PixelImage grab() = 0;
};

// Why no parent window can be made here ("DISPLAY is not set"); empty when one can.
std::string editor_desktop_unavailable();

// Throws std::runtime_error when the desktop cannot be reached.
std::unique_ptr<EditorParentInterface> create_editor_parent(int width, int height,
                                                            const std::string& title);

}  // namespace plugcore
