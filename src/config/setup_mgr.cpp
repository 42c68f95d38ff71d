#include "config/setup_mgr.h"

#include <cstdio>

#include "config/mouse_compatibility.h"
#include "config/web_site_jump.h"
#include "guikit/control_interface.h"
#include "guikit/messages.h"
#include "guikit/pot_behaviour.h"
#include "host/dsp_interface.h"
#include "host/gui_interface.h"
#include "host/host_gui_interface.h"
#include "midi/midi_dev_sel_dispatcher.h"
#include "midi/midi_mgr.h"
#include "params/normalized_param_interface.h"

namespace plugcore {

SetupMgr::SetupMgr(bool with_web_section, bool with_nrpn_entry)
    : ctrl_listener_(*this),
      setting_mgr_(std::make_unique<SettingMgr>()),
      about_listener_(*this),
      product_listener_(*this, 2),
      updates_listener_(*this, 3),
      documentation_listener_(*this, 5),
      presets_listener_(*this, 4),
      load_listener_(*this),
      save_listener_(*this),
      mouse_listener_(*this),
      auto_bind_listener_(*this),
      nrpn_listener_(*this),
      with_web_section_(with_web_section),
      with_nrpn_entry_(with_nrpn_entry) {
  about_item_.set_listener(&about_listener_);
  product_item_.set_listener(&product_listener_);
  updates_item_.set_listener(&updates_listener_);
  documentation_item_.set_listener(&documentation_listener_);
  presets_item_.set_listener(&presets_listener_);
  load_item_.set_listener(&load_listener_);
  save_item_.set_listener(&save_listener_);
  mouse_item_.set_listener(&mouse_listener_);
  auto_bind_item_.set_listener(&auto_bind_listener_);
  nrpn_item_.set_listener(&nrpn_listener_);
}

SetupMgr::~SetupMgr() {
  if (button_ != nullptr) button_->remove_listener(&ctrl_listener_);
}

int SetupMgr::init(GuiInterface& editor, MidiMgr* midi_mgr, guikit::ControlInterface& button,
                   WebSiteJumpInterface* web, int with_ports) {
  editor_ = &editor;
  midi_mgr_ = midi_mgr;
  web_ = web;
  ports_offered_ = with_ports != 0;
  if (button_ != nullptr && button_ != &button) button_->remove_listener(&ctrl_listener_);
  button_ = &button;
  button.add_unique_listener(&ctrl_listener_);

  build_tree();

  DspInterface* dsp = editor.get_dsp();
  // The auto-bind listeners sit on the editor's controls: made once.
  if (!auto_bind_.is_initialised() && dsp != nullptr) {
    std::vector<NormalizedParamInterface*> params;
    const int count = dsp->get_nbr_param();
    for (int i = 0; i < count; ++i) params.push_back(&dsp->use_param(i));
    auto_bind_.init(count, midi_mgr, params);
  }

  guikit::PotBehaviour::set_mouse_compatibility(sys::read_mouse_compatibility());

  const std::string pattern = std::string("*.") + kSettingExtension;
  file_selector_.set_filters({{std::string("Velmora plug-in setting file (") + pattern + ")", pattern}});

  setting_mgr_ = std::make_unique<SettingMgr>();
  int status = dsp != nullptr ? setting_mgr_->init(*dsp) : -1;
  if (status == 0 && midi_mgr != nullptr) status = setting_mgr_->add_client(midi_mgr);
  return status;
}

void SetupMgr::build_tree() {
  root_.remove_all();
  root_.add_child(&about_item_);
  if (with_web_section_) {
    root_.add_child(&web_delimiter_);
    root_.add_child(&product_item_);
    root_.add_child(&updates_item_);
    root_.add_child(&documentation_item_);
    root_.add_child(&presets_item_);
  }
  root_.add_child(&settings_delimiter_);
  root_.add_child(&load_item_);
  root_.add_child(&save_item_);
  root_.add_child(&mouse_item_);
  root_.add_child(&midi_delimiter_);
  root_.add_child(&auto_bind_item_);
  root_.add_child(&input_menu_);
  root_.add_child(&output_menu_);
  if (with_nrpn_entry_) root_.add_child(&nrpn_item_);
  nrpn_item_.set_grayed(midi_mgr_ == nullptr);
}

void SetupMgr::refresh() {
  const bool on = auto_bind_.is_autobind_on();
  auto_bind_item_.set_label(auto_bind_.get_menu_text());
  auto_bind_item_.set_checked(on);

  refresh_ports(input_ports_);
  refresh_ports(output_ports_);

  nrpn_item_.set_grayed(midi_mgr_ == nullptr);
  nrpn_item_.set_checked(midi_mgr_ != nullptr && midi_mgr_->use_settings().get_nrpn_compatibility() == 0);

  mouse_item_.set_checked(guikit::PotBehaviour::get_mouse_compatibility() == 0);
}

void SetupMgr::refresh_ports(PortMenu& menu) {
  menu.list->remove_all();
  MidiDevSelectorInterface* selection = use_port_selection();
  if (selection == nullptr) return;
  const int count = menu.output ? selection->get_nbr_outputs() : selection->get_nbr_inputs();
  const int current = menu.output ? selection->get_selected_output() : selection->get_selected_input();
  // Entry 0 is "None" (index -1), then one per port. The item objects stay
  // while the list does not shrink, so their ids stay valid between openings.
  const size_t needed = static_cast<size_t>(count) + 1;
  while (menu.items.size() < needed) {
    const int index = static_cast<int>(menu.items.size()) - 1;
    menu.items.push_back(std::make_unique<guikit::MenuItem>());
    menu.listeners.push_back(std::make_unique<SetupMLMidiDevice>(*this, menu.output, index));
    menu.items.back()->set_listener(menu.listeners.back().get());
  }
  for (size_t i = 0; i < needed; ++i) {
    const int index = static_cast<int>(i) - 1;
    guikit::MenuItem& item = *menu.items[i];
    item.set_label(index < 0 ? std::string("None")
                             : (menu.output ? selection->get_output_name(index) : selection->get_input_name(index)));
    item.set_checked(index == current);
    menu.list->add_child(&item);
  }
}

int SetupMgr::open_menu() {
  refresh();
  if (button_ == nullptr) return -1;
  guikit::MenuRequest request(&root_, 0, 0);
  return button_->process_message(request);
}

std::string SetupMgr::build_about_text() const {
  std::string name;
  double version = 0.0;
  if (editor_ != nullptr && editor_->get_dsp() != nullptr) {
    name = editor_->get_dsp()->get_property_str("plugin_name");
    version = editor_->get_dsp()->get_property_num("plugin_version");
  }
  char version_line[64];
  std::snprintf(version_line, sizeof(version_line), "\nVersion  %.2lf\n\n", version);
  std::string info;
  if (editor_ != nullptr && editor_->get_host_gui() != nullptr) {
    info = editor_->get_host_gui()->get_property_str("interface_info");
  }
  return name + version_line + WebSiteJump::kMakerName + "\n" + WebSiteJump::kMakerSite + "\n\n" + info;
}

}  // namespace plugcore
