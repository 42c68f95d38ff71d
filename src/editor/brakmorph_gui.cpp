#include "editor/brakmorph_gui.h"

#include <exception>
#include <stdexcept>

#include "dsp/brakmorph_dsp.h"
#include "editor/thread_token.h"
#include "guikit/control_interface.h"
#include "guikit/window_interface.h"
#include "host/dsp_interface.h"
#include "host/host_gui_interface.h"
#include "params/listener_base.h"
#include "skin/skin_anchors.h"

BrakmorphGui::BrakmorphGui()
    : meta_(kNbrParams), master_(*this), presets_(*this), web_(*this), follower_(kNbrParams, *this) {}

BrakmorphGui::~BrakmorphGui() {
  follower_.stop();
  if (window_ != nullptr) window_->set_roots(nullptr, nullptr);
  trees_.set_parent(nullptr);
}

void BrakmorphGui::set_host_gui(plugcore::HostGuiInterface* host_gui) {
  if (host_gui != host_gui_.get()) host_gui_.reset(host_gui);
}

void BrakmorphGui::set_dsp(plugcore::DspInterface* dsp) {
  dsp_ = dsp;
  engine_ = dynamic_cast<BrakmorphDsp*>(dsp);
}

void BrakmorphGui::init() {
  if (!pictures_.load_all()) throw std::runtime_error("BrakmorphGui::init() : Cannot initialize GUI.");
}

void BrakmorphGui::set_default_state() {
  if (built_) return;
  try {
    build();
  } catch (const std::exception&) {
    throw std::runtime_error("BrakmorphGui::set_default_state() : Cannot build GUI.");
  }
  // The host builds its instances on its user-interface thread; opening confirms it.
  editor_thread_.store(current_thread_token(), std::memory_order_relaxed);
  built_ = true;
}

void BrakmorphGui::build() {
  if (!pictures_.is_loaded() || dsp_ == nullptr || host_gui_ == nullptr || dsp_->get_nbr_param() < kNbrParams) {
    throw std::runtime_error("BrakmorphGui::build() : Missing pictures, engine or host.");
  }
  // Every bound control shows marker 0 (none), 1 or 2 beside it.
  markers_ = {guikit::Picture(), pictures_.slot("tl_01_0", guikit::Point{kSkinMarker.anchor_x, kSkinMarker.anchor_y}),
              pictures_.slot("tl_01_1", guikit::Point{kSkinMarker.anchor_x, kSkinMarker.anchor_y})};
  trees_.build(pictures_);
  master_.build(trees_);
  presets_.build(trees_);
  web_.build(trees_);
  for (int b = 0; b < GuiMaster::kNbrBands; ++b) master_.show_band(b, true);
}

void BrakmorphGui::bind(int index, guikit::ControlInterface& control, plugcore::ListenerBase& listener) {
  if (index < 0 || index >= kNbrParams || dsp_ == nullptr) {
    throw std::runtime_error("BrakmorphGui::bind() : No such parameter.");
  }
  listener.set_host_gui(host_gui_.get());
  listener.bind_param(index, &dsp_->use_param(index));
  control.set_listener(&listener);
  control.set_markers(markers_);
  meta_[static_cast<size_t>(index)] = MetaControl{&control, &listener};
}

guikit::ControlInterface* BrakmorphGui::get_bound_control(int index) const {
  return index >= 0 && index < kNbrParams ? meta_[static_cast<size_t>(index)].control : nullptr;
}

void BrakmorphGui::set_control_marker(int index, int marker) {
  guikit::ControlInterface* control = get_bound_control(index);
  if (control != nullptr) control->set_marker(marker);
}

void BrakmorphGui::notify_param_change(int index, float norm, int priority) {
  if (index < 0 || index >= kNbrParams || !built_) return;
  if (current_thread_token() == editor_thread_.load(std::memory_order_relaxed)) {
    follow_param(index, norm, priority);
  } else {
    follower_.post(index, norm, priority);
  }
}

// The writer's priority is the origin: the control asks the arbitration whether
// that writer may move it, and a change from outside never writes back.
void BrakmorphGui::follow_param(int index, float norm, int priority) {
  guikit::ControlInterface* control = meta_[static_cast<size_t>(index)].control;
  if (control != nullptr) control->set_value(norm, priority);
}

void BrakmorphGui::refresh_all() {
  for (const MetaControl& m : meta_) {
    if (m.listener != nullptr) m.listener->refresh();
  }
}

void BrakmorphGui::set_window(guikit::WindowInterface* window) {
  if (window_ != nullptr && window != window_) {
    follower_.stop();
    window_->set_roots(nullptr, nullptr);
    trees_.set_parent(nullptr);
  }
  window_ = window;
  if (window_ != nullptr) {
    window_->set_editor_size(guikit::Size{kWidth, kHeight});
    window_->set_window_size(guikit::Size{kWidth, kHeight});
  }
}

void BrakmorphGui::get_size(int& width, int& height) {
  width = kWidth;
  height = kHeight;
}

// The editor has one size; a host that can resize gets the same.
void BrakmorphGui::get_resizable_size(int& width, int& height) { get_size(width, height); }

int BrakmorphGui::open_window(void* parent) {
  if (window_ == nullptr || !built_ || open_.load(std::memory_order_relaxed)) return -1;
  const bool can_resize = host_gui_->get_property_num("can_resize_window") != 0.0;
  window_->set_can_resize(can_resize);
  window_->set_editor_size(guikit::Size{kWidth, kHeight});
  trees_.set_parent(window_);
  window_->set_roots(&trees_.background_root(), &trees_.control_root());

  editor_thread_.store(current_thread_token(), std::memory_order_relaxed);
  open_.store(true, std::memory_order_release);
  // Changes that other threads made while the window was closed first, with
  // their writers' priorities (a refresh is refused for 0.5 s after a write).
  follower_.collect();
  refresh_all();
  presets_.init();
  web_.init();
  if (engine_ != nullptr) {
    engine_->set_metering(true);
    engine_->set_clip_detection(true);
  }
  if (window_->open(parent) != 0) {
    close_window();
    return -1;
  }
  trees_.show(true);
  follower_.start(*window_);
  return 0;
}

void BrakmorphGui::close_window() {
  presets_.deinit();
  follower_.stop();
  open_.store(false, std::memory_order_release);
  if (engine_ != nullptr) {
    engine_->set_metering(false);
    engine_->set_clip_detection(false);
  }
  trees_.show(false);
  if (window_ != nullptr) window_->close();
}

void BrakmorphGui::close() {
  if (open_.load(std::memory_order_relaxed)) close_window();
}
