#pragma once

#include <atomic>
#include <cstdint>
#include <memory>
#include <vector>

#include "editor/editor_trees.h"
#include "editor/gui_master.h"
#include "editor/gui_presets.h"
#include "editor/gui_web.h"
#include "editor/param_control_finder_interface.h"
#include "editor/param_follower.h"
#include "editor/skin_pictures.h"
#include "host/gui_interface.h"

class BrakmorphDsp;

namespace guikit {
class ControlInterface;
}
namespace plugcore {
class ListenerBase;
}

// The plug-in's editor: the skin's pictures, the background and control trees,
// the panels with their controls, and the table that joins each parameter to
// its control.
//
// Parameter changes from other writers reach notify_param_change on whatever
// thread the writer runs on. On the editor's own thread (the one that built the
// editor and opens its window) the bound control follows at once. From any
// other thread (audio, MIDI, a host's automation thread) the change only waits
// in atomics (ParamFollower): no lock, no allocation, no system call. The editor
// thread takes the waiting changes over on a 20 ms toolkit timer while the
// window is open, and when it opens the window.
class BrakmorphGui : public plugcore::GuiInterface,
                     public ParamControlFinderInterface,
                     private ParamFollower::TargetInterface {
 public:
  static constexpr int kWidth = 609;
  static constexpr int kHeight = 282;
  static constexpr int kNbrParams = 40;

  BrakmorphGui();
  ~BrakmorphGui() override;

  // GuiInterface
  void init() override;
  void set_default_state() override;
  void close() override;
  plugcore::HostGuiInterface* get_host_gui() override { return host_gui_.get(); }
  // Owned from here on.
  void set_host_gui(plugcore::HostGuiInterface* host_gui) override;
  plugcore::DspInterface* get_dsp() override { return dsp_; }
  void set_dsp(plugcore::DspInterface* dsp) override;
  void notify_param_change(int index, float norm, int priority) override;
  void set_window(guikit::WindowInterface* window) override;
  void get_size(int& width, int& height) override;
  void get_resizable_size(int& width, int& height) override;
  int open_window(void* parent) override;
  void close_window() override;
  void set_tempo(float bpm) override { tempo_ = bpm; }
  void set_control_marker(int index, int marker) override;

  // For the panels.
  SkinPictures& use_pictures() { return pictures_; }
  BrakmorphDsp* use_engine() const { return engine_; }
  guikit::WindowInterface* use_window() const { return window_; }
  // Joins a control to parameter index through its listener (which becomes the
  // control's only listener so far) and gives the control its marker slots.
  void bind(int index, guikit::ControlInterface& control, plugcore::ListenerBase& listener);

  // Inspection.
  guikit::ControlInterface* get_bound_control(int index) const;
  guikit::ControlInterface* find_param_control(int index) override { return get_bound_control(index); }
  bool is_built() const { return built_; }
  bool is_window_open() const { return open_.load(std::memory_order_acquire); }
  float get_tempo() const { return tempo_; }
  EditorTrees& use_trees() { return trees_; }
  GuiMaster& use_master() { return master_; }
  GuiPresets& use_presets() { return presets_; }
  GuiWeb& use_web() { return web_; }
  ParamFollower& use_follower() { return follower_; }

 private:
  struct MetaControl {
    guikit::ControlInterface* control = nullptr;
    plugcore::ListenerBase* listener = nullptr;
  };

  void build();
  void refresh_all();
  void follow_param(int index, float norm, int priority) override;

  // Destroyed last: every listener below holds it.
  std::unique_ptr<plugcore::HostGuiInterface> host_gui_;
  plugcore::DspInterface* dsp_ = nullptr;
  BrakmorphDsp* engine_ = nullptr;
  guikit::WindowInterface* window_ = nullptr;
  SkinPictures pictures_;
  EditorTrees trees_;
  std::vector<MetaControl> meta_;
  std::vector<guikit::Picture> markers_;
  GuiMaster master_;
  GuiPresets presets_;
  GuiWeb web_;
  ParamFollower follower_;
  std::atomic<bool> open_{false};
  std::atomic<uint64_t> editor_thread_{0};
  float tempo_ = 0.0f;
  bool built_ = false;
};
