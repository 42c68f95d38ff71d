#pragma once

#include <memory>
#include <string>
#include <vector>

#include "config/file_selector.h"
#include "config/setting_mgr.h"
#include "config/setup_ctrl_listener.h"
#include "config/setup_ml_about.h"
#include "config/setup_ml_compatible_mouse.h"
#include "config/setup_ml_load_settings.h"
#include "config/setup_ml_midi_auto_bind.h"
#include "config/setup_ml_midi_device.h"
#include "config/setup_ml_midi_nrpn_comp.h"
#include "config/setup_ml_save_settings.h"
#include "config/setup_ml_web_site.h"
#include "guikit/menu_nodes.h"
#include "midi/midi_auto_bind_mgr.h"

namespace guikit {
class ControlInterface;
}

namespace plugcore {

class GuiInterface;
class MidiDevSelectorInterface;
class MidiMgr;
class WebSiteJumpInterface;

// The setup menu behind the editor's setup button: About, the maker's web
// pages, setting files, the mouse mode and the MIDI options. It owns the menu
// tree with one listener per entry, the setting manager with its file
// dialog and the auto-bind manager. Editor thread only.
class SetupMgr {
 public:
  static constexpr const char* kSettingExtension = "cfg.txt";

  SetupMgr(bool with_web_section, bool with_nrpn_entry);
  ~SetupMgr();
  SetupMgr(const SetupMgr&) = delete;
  SetupMgr& operator=(const SetupMgr&) = delete;

  // Attaches the button's listener, builds the tree, prepares the setting
  // manager from the editor's engine (with the MIDI manager as client when
  // there is one) and the setting dialog, and takes the stored mouse mode.
  // midi_mgr and web may be null. with_ports: the host bridge offers MIDI
  // ports, so the port submenus are filled (from the selection given with
  // set_port_selection). Answers 0, or the setting manager's status.
  // Calling it again (the editor reopened) rebuilds the tree; the auto-bind
  // manager keeps its listeners and state. The button must outlive the
  // manager, which takes its listener off the button when it goes.
  int init(GuiInterface& editor, MidiMgr* midi_mgr, guikit::ControlInterface& button, WebSiteJumpInterface* web,
           int with_ports);
  // The MIDI port selection the port submenus show and change; null: none.
  void set_port_selection(MidiDevSelectorInterface* selection) { port_selection_ = selection; }

  // The button was pressed: refresh the live parts, then ask the window for the menu.
  int open_menu();
  // Texts, ticks and port submenus from the live state.
  void refresh();

  // What the entries act on.
  GuiInterface* use_editor() const { return editor_; }
  MidiMgr* use_midi_mgr() const { return midi_mgr_; }
  MidiAutoBindMgr& use_auto_bind_mgr() { return auto_bind_; }
  SettingMgr& use_setting_mgr() { return *setting_mgr_; }
  sys::FileSelector& use_file_selector() { return file_selector_; }
  WebSiteJumpInterface* use_web_site_jump() const { return web_; }
  MidiDevSelectorInterface* use_port_selection() const { return ports_offered_ ? port_selection_ : nullptr; }

  // The tree as built, for the window and for inspection.
  guikit::MenuList& use_root_menu() { return root_; }
  guikit::MenuList& use_input_menu() { return input_menu_; }
  guikit::MenuList& use_output_menu() { return output_menu_; }
  guikit::MenuItem& use_auto_bind_item() { return auto_bind_item_; }
  guikit::MenuItem& use_nrpn_item() { return nrpn_item_; }
  guikit::MenuItem& use_mouse_item() { return mouse_item_; }

  // The About box's text, from the engine's and the host adapter's properties.
  std::string build_about_text() const;

 private:
  struct PortMenu {
    guikit::MenuList* list;
    bool output;
    std::vector<std::unique_ptr<guikit::MenuItem>> items;
    std::vector<std::unique_ptr<SetupMLMidiDevice>> listeners;
  };
  void build_tree();
  void refresh_ports(PortMenu& menu);

  GuiInterface* editor_ = nullptr;
  MidiAutoBindMgr auto_bind_;
  SetupCtrlListener ctrl_listener_;
  std::unique_ptr<SettingMgr> setting_mgr_;
  sys::FileSelector file_selector_;

  guikit::MenuList root_;
  guikit::MenuItem about_item_{"About..."};
  guikit::MenuDelimiter web_delimiter_{"Velmora on the web"};
  guikit::MenuItem product_item_{"Product info..."};
  guikit::MenuItem updates_item_{"Updates..."};
  guikit::MenuItem documentation_item_{"Documentation..."};
  guikit::MenuItem presets_item_{"Presets..."};
  guikit::MenuDelimiter settings_delimiter_{"Settings"};
  guikit::MenuItem load_item_{"Load..."};
  guikit::MenuItem save_item_{"Save..."};
  guikit::MenuItem mouse_item_{"Enhanced mouse mode"};
  guikit::MenuDelimiter midi_delimiter_{"MIDI"};
  guikit::MenuItem auto_bind_item_{"Auto-bind"};
  guikit::MenuList input_menu_{"Input device"};
  guikit::MenuList output_menu_{"Output device"};
  guikit::MenuItem nrpn_item_{"Old erroneous nrpn behaviour"};

  SetupMLAbout about_listener_;
  SetupMLWebSite product_listener_;
  SetupMLWebSite updates_listener_;
  SetupMLWebSite documentation_listener_;
  SetupMLWebSite presets_listener_;
  SetupMLLoadSettings load_listener_;
  SetupMLSaveSettings save_listener_;
  SetupMLCompatibleMouse mouse_listener_;
  SetupMLMidiAutoBind auto_bind_listener_;
  SetupMLMidiNrpnComp nrpn_listener_;

  PortMenu input_ports_{&input_menu_, false, {}, {}};
  PortMenu output_ports_{&output_menu_, true, {}, {}};

  WebSiteJumpInterface* web_ = nullptr;
  MidiMgr* midi_mgr_ = nullptr;
  MidiDevSelectorInterface* port_selection_ = nullptr;
  guikit::ControlInterface* button_ = nullptr;
  bool ports_offered_ = false;
  bool with_web_section_;
  bool with_nrpn_entry_;
};

}  // namespace plugcore
