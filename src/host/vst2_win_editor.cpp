#include "host/vst2_win_editor.h"

#include "guikit/window_interface.h"
#include "host/audio_effect.h"
#include "host/gui_interface.h"
#include "host/host_gui_interface.h"

namespace plugcore {

Vst2WinEditor::Vst2WinEditor(AudioEffect* effect, GuiInterface* gui, std::unique_ptr<guikit::WindowInterface> window)
    : AEffEditor(effect), window_(std::move(window)), gui_(gui) {
  gui_->set_window(window_.get());
  effect->setEditor(this);
}

Vst2WinEditor::~Vst2WinEditor() {
  close();
  gui_->set_window(nullptr);
}

bool Vst2WinEditor::getRect(ERect** rect) {
  if (rect == nullptr) {
    return false;
  }
  int width = 0;
  int height = 0;
  HostGuiInterface* host_gui = gui_->get_host_gui();
  if (host_gui != nullptr && host_gui->get_property_num("can_resize_window") != 0.0) {
    gui_->get_resizable_size(width, height);
  } else {
    gui_->get_size(width, height);
  }
  rect_.top = 0;
  rect_.left = 0;
  rect_.bottom = static_cast<int16_t>(height);
  rect_.right = static_cast<int16_t>(width);
  *rect = &rect_;
  return true;
}

bool Vst2WinEditor::open(void* parent) {
  AEffEditor::open(parent);
  if (window_ == nullptr) {
    return false;
  }
  open_ = gui_->open_window(parent) == 0;
  return open_;
}

void Vst2WinEditor::close() {
  if (open_) {
    gui_->close_window();
    open_ = false;
  }
  AEffEditor::close();
}

void Vst2WinEditor::idle() {
  if (update_pending_.exchange(0, std::memory_order_acquire) != 0) {
    update();
  }
  if (open_ && window_ != nullptr) {
    window_->idle();
  }
}

void Vst2WinEditor::update() {
  const double tempo = pending_tempo_.exchange(0.0, std::memory_order_relaxed);
  if (tempo > 0.0) {
    gui_->set_tempo(static_cast<float>(tempo));
  }
}

void Vst2WinEditor::postUpdate() { update_pending_.store(1, std::memory_order_release); }

void Vst2WinEditor::set_tempo(double bpm) {
  pending_tempo_.store(bpm, std::memory_order_relaxed);
  postUpdate();
}

}  // namespace plugcore
