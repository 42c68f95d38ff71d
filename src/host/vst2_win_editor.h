#pragma once

#include <atomic>
#include <memory>

#include "host/aeff_editor.h"
#include "host/vst2_abi.h"

namespace guikit {
class WindowInterface;
}

namespace plugcore {

class GuiInterface;

// Shows the editor object in the window the host hands over: size, open,
// close and idle from the host's user-interface thread, and the tempo taken
// over from the audio thread.
class Vst2WinEditor : public AEffEditor {
 public:
  // window: the platform window (owned; may be null when the platform has none).
  Vst2WinEditor(AudioEffect* effect, GuiInterface* gui, std::unique_ptr<guikit::WindowInterface> window);
  ~Vst2WinEditor() override;

  bool getRect(ERect** rect) override;
  bool open(void* parent) override;
  void close() override;
  void idle() override;
  void update() override;
  void postUpdate() override;
  int32_t onKeyDown(int32_t key, int32_t virtual_key, int32_t modifier) override { return -1; }
  int32_t onKeyUp(int32_t key, int32_t virtual_key, int32_t modifier) override { return -1; }
  int32_t setKnobMode(int32_t mode) override { return 0; }
  bool onWheel(float distance) override { return false; }

  // Audio thread: remembered until the next idle.
  void set_tempo(double bpm);

  guikit::WindowInterface* use_window() { return window_.get(); }
  bool is_open() const { return open_; }

 private:
  std::unique_ptr<guikit::WindowInterface> window_;
  GuiInterface* gui_;
  ERect rect_{};
  std::atomic<double> pending_tempo_{0.0};
  std::atomic<int> update_pending_{0};
  bool open_ = false;
};

}  // namespace plugcore
