#include "midi/midi_auto_bind_mgr.h"

#include "host/dsp_interface.h"
#include "host/host_gui_interface.h"
#include "midi/midi_mgr.h"
#include "params/normalized_param_interface.h"

namespace plugcore {

void MidiAutoBindListener::clicked() { mgr_.on_param_touched(index_); }

void MidiAutoBindMgr::init(int nbr_params, HostGuiInterface* host_gui) {
  host_gui_ = host_gui;
  init(nbr_params, nullptr, {});
}

void MidiAutoBindMgr::init(int nbr_params, MidiMgr* mgr, std::vector<NormalizedParamInterface*> params) {
  if (mgr != nullptr) direct_mgr_ = mgr;
  params_ = std::move(params);
  listeners_.clear();
  for (int i = 0; i < nbr_params; ++i) listeners_.push_back(std::make_unique<MidiAutoBindListener>(*this, i));
  initialised_ = true;
}

MidiMgr* MidiAutoBindMgr::use_midi_mgr() {
  if (direct_mgr_ != nullptr) return direct_mgr_;
  return host_gui_ != nullptr ? host_gui_->use_midi_mgr() : nullptr;
}

void MidiAutoBindMgr::apply_one_shot_rule(MidiMgr& mgr) {
  int index = -1;
  int32_t key = 0;
  if (mgr.get_last_binding(index, key) && autobind_on_ && mgr.use_settings().get_autobind_mode() == 0) {
    autobind_on_ = false;
    mgr.clear_last_binding();
  }
}

void MidiAutoBindMgr::update() {
  MidiMgr* mgr = use_midi_mgr();
  if (mgr == nullptr) return;
  apply_one_shot_rule(*mgr);
  if (autobind_on_ && mgr->use_settings().get_autobind_mode() == 0) mgr->clear_last_binding();
  if (autobind_on_ && selected_ >= 0) {
    mgr->set_autobind_target(selected_);
  } else {
    mgr->clear_autobind_target();
  }
}

void MidiAutoBindMgr::on_param_touched(int index) {
  selected_ = index;
  update();
}

void MidiAutoBindMgr::set_autobind(bool on) {
  autobind_on_ = on;
  update();
}

bool MidiAutoBindMgr::is_autobind_on() {
  if (MidiMgr* mgr = use_midi_mgr()) apply_one_shot_rule(*mgr);
  return autobind_on_;
}

NormalizedParamInterface* MidiAutoBindMgr::get_target_param() {
  if (selected_ < 0 || selected_ >= get_nbr_listeners()) return nullptr;
  if (static_cast<size_t>(selected_) < params_.size()) return params_[static_cast<size_t>(selected_)];
  return nullptr;
}

std::string MidiAutoBindMgr::get_menu_text() {
  std::string text = "Auto-bind";
  NormalizedParamInterface* target = get_target_param();
  if (target != nullptr) {
    char name[128];
    target->get_name(name, sizeof(name));
    text += std::string(" [target : ") + name + "]";
  } else if (is_autobind_on()) {
    text += " [now select a parameter]";
  }
  return text;
}

}  // namespace plugcore
