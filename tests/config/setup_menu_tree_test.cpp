// The setup menu's tree, the About box, the web entries and the two per-user
// switches, driven through the setup button of an off-screen window.
#include <string>
#include <vector>

#include "config/mouse_compatibility.h"
#include "config/persistent_key_list.h"
#include "guikit/pot_behaviour.h"
#include "host/dsp_interface.h"
#include "midi/midi_mgr.h"
#include "setup_test_support.h"

namespace {

using guikit::MenuEntry;
using setup_test::SetupStage;

struct Line {
  MenuEntry::Kind kind;
  std::string text;
  int depth;
};

std::vector<Line> lines_of(const std::vector<MenuEntry>& entries) {
  std::vector<Line> lines;
  for (const MenuEntry& e : entries) lines.push_back(Line{e.kind, e.text, e.depth});
  return lines;
}

void expect_lines(const std::vector<MenuEntry>& shown, const std::vector<Line>& expected) {
  const std::vector<Line> got = lines_of(shown);
  ASSERT_EQ(got.size(), expected.size());
  for (size_t i = 0; i < got.size(); ++i) {
    EXPECT_EQ(got[i].kind, expected[i].kind) << i;
    EXPECT_EQ(got[i].text, expected[i].text) << i;
    EXPECT_EQ(got[i].depth, expected[i].depth) << i;
  }
}

std::string stored_text(const std::string& path, const std::string& name) {
  sys::PersistentKeyList key(path, true);
  std::string text;
  key.get_string(name, text);
  return text;
}

// The pots' mode is process-wide; every test leaves it and its stored value as found.
class SetupMenu : public SetupStage {
 protected:
  void SetUp() override {
    SetupStage::SetUp();
    saved_mode_ = guikit::PotBehaviour::get_mouse_compatibility();
    saved_stored_ = sys::read_mouse_compatibility();
  }
  void TearDown() override {
    sys::write_mouse_compatibility(saved_stored_);
    guikit::PotBehaviour::set_mouse_compatibility(saved_mode_);
    SetupStage::TearDown();
  }
  int saved_mode_ = 0;
  int saved_stored_ = 0;
};

}  // namespace

TEST_F(SetupMenu, ButtonOpensTheWholeTreeInOrder) {
  plugcore::SetupMgr setup(true, true);
  init_setup(setup);
  EXPECT_EQ(shows(), 0);
  press_choosing(0);
  ASSERT_EQ(shows(), 1);
  const std::vector<Line> head = {
      {MenuEntry::kItem, "About...", 0},
      {MenuEntry::kLabel, "--- Velmora on the web ", 0},
      {MenuEntry::kItem, "Product info...", 0},
      {MenuEntry::kItem, "Updates...", 0},
      {MenuEntry::kItem, "Documentation...", 0},
      {MenuEntry::kItem, "Presets...", 0},
      {MenuEntry::kLabel, "--- Settings ", 0},
      {MenuEntry::kItem, "Load...", 0},
      {MenuEntry::kItem, "Save...", 0},
      {MenuEntry::kItem, "Enhanced mouse mode", 0},
      {MenuEntry::kLabel, "--- MIDI ", 0},
      {MenuEntry::kItem, "Auto-bind", 0},
      {MenuEntry::kSubMenuBegin, "Input device", 0},
  };
  const std::vector<MenuEntry>& entries = shown();
  ASSERT_GT(entries.size(), head.size());
  expect_lines(std::vector<MenuEntry>(entries.begin(), entries.begin() + static_cast<long>(head.size())), head);
  // The port submenus sit between "Auto-bind" and the NRPN entry, which ends the menu.
  size_t output_begin = 0;
  for (size_t i = 0; i < entries.size(); ++i) {
    if (entries[i].kind == MenuEntry::kSubMenuBegin && entries[i].text == "Output device") output_begin = i;
  }
  ASSERT_GT(output_begin, head.size());
  EXPECT_EQ(entries[output_begin - 1].kind, MenuEntry::kSubMenuEnd);
  EXPECT_EQ(entries.back().text, "Old erroneous nrpn behaviour");
  EXPECT_EQ(entries.back().depth, 0);
  EXPECT_FALSE(entries.back().grayed);
  EXPECT_EQ(entries[entries.size() - 2].kind, MenuEntry::kSubMenuEnd);
  // Nothing but the delimiters is greyed.
  for (const MenuEntry& e : entries) EXPECT_EQ(e.grayed, e.kind == MenuEntry::kLabel) << e.text;
}

TEST_F(SetupMenu, WithoutWebSectionAndNrpnEntryOrMidi) {
  plugcore::SetupMgr setup(false, false);
  ASSERT_EQ(setup.init(editor_, nullptr, button_, nullptr, 0), 0);
  press_choosing(0);
  expect_lines(shown(), {
                            {MenuEntry::kItem, "About...", 0},
                            {MenuEntry::kLabel, "--- Settings ", 0},
                            {MenuEntry::kItem, "Load...", 0},
                            {MenuEntry::kItem, "Save...", 0},
                            {MenuEntry::kItem, "Enhanced mouse mode", 0},
                            {MenuEntry::kLabel, "--- MIDI ", 0},
                            {MenuEntry::kItem, "Auto-bind", 0},
                            {MenuEntry::kSubMenuBegin, "Input device", 0},
                            {MenuEntry::kSubMenuEnd, "", 0},
                            {MenuEntry::kSubMenuBegin, "Output device", 0},
                            {MenuEntry::kSubMenuEnd, "", 0},
                        });
}

TEST_F(SetupMenu, NrpnEntryGreyedAndInertWithoutMidiManager) {
  plugcore::SetupMgr setup(true, true);
  init_setup(setup, false);
  const int before = plugin_->use_midi_mgr()->use_settings().get_nrpn_compatibility();
  press_choosing(0);
  const int32_t id = shown_id("Old erroneous nrpn behaviour");
  ASSERT_NE(id, 0);
  EXPECT_TRUE(shown_entry(id)->grayed);
  EXPECT_FALSE(shown_entry(id)->checked);
  press_choosing(id);
  press_choosing(0);
  EXPECT_TRUE(shown_entry(id)->grayed);
  EXPECT_EQ(plugin_->use_midi_mgr()->use_settings().get_nrpn_compatibility(), before);
}

TEST_F(SetupMenu, InitAgainKeepsOneButtonListenerAndOneTree) {
  plugcore::SetupMgr setup(true, true);
  init_setup(setup);
  const size_t listeners = button_.get_listener_count();
  const size_t children = setup.use_root_menu().get_child_count();
  init_setup(setup);
  EXPECT_EQ(button_.get_listener_count(), listeners);
  EXPECT_EQ(setup.use_root_menu().get_child_count(), children);
  press_choosing(0);
  EXPECT_EQ(shows(), 1);  // one press, one menu
  // The auto-bind listeners the editor's controls carry survive a second init.
  plugcore::MidiAutoBindListener* first = &setup.use_auto_bind_mgr().use_listener(0);
  init_setup(setup);
  EXPECT_EQ(&setup.use_auto_bind_mgr().use_listener(0), first);
  EXPECT_EQ(setup.use_auto_bind_mgr().get_nbr_listeners(), plugin_->use_dsp()->get_nbr_param());
}

TEST_F(SetupMenu, DestroyedManagerLeavesTheButtonWithoutItsListener) {
  const size_t before = button_.get_listener_count();
  {
    plugcore::SetupMgr setup(true, true);
    init_setup(setup);
    EXPECT_EQ(button_.get_listener_count(), before + 1);
  }
  EXPECT_EQ(button_.get_listener_count(), before);
  press_choosing(0);
  EXPECT_EQ(shows(), 0);
}

TEST_F(SetupMenu, AboutBoxText) {
  plugcore::SetupMgr setup(true, true);
  init_setup(setup);
  choose("About...");
  ASSERT_EQ(ui_.boxes.size(), 1u);
  EXPECT_EQ(ui_.boxes[0].title, "About...");
  EXPECT_EQ(ui_.boxes[0].buttons, 0);
  EXPECT_EQ(ui_.boxes[0].default_button, 0);
  const std::string info = host_gui_.get_property_str("interface_info");
  ASSERT_FALSE(info.empty());
  EXPECT_EQ(ui_.boxes[0].text,
            "Brakmorph\nVersion  1.24\n\nVelmora\nhttps://www.velmora-audio.example\n\n" + info);
}

TEST_F(SetupMenu, WebEntriesOpenTheirAddresses) {
  plugcore::SetupMgr setup(true, true);
  init_setup(setup);
  const std::string base = "https://www.velmora-audio.example/jump.php?type=product&productid=22&version=292&skin=1";
  choose("Product info...");
  choose("Updates...");
  choose("Documentation...");
  choose("Presets...");
  EXPECT_EQ(ui_.urls, (std::vector<std::string>{base, base + "&action=update", base + "&action=documentation",
                                                 base + "&action=preset"}));
  // A browser that does not start shows nothing to the user.
  ui_.url_answer = -1;
  choose("Product info...");
  EXPECT_EQ(ui_.urls.size(), 5u);
  EXPECT_TRUE(ui_.boxes.empty());
}

TEST_F(SetupMenu, MouseModeTickFollowsAndFlipsTheStoredMode) {
  // init takes the stored mode: "1" (compatible) shows the entry unticked.
  ASSERT_TRUE(sys::write_mouse_compatibility(1));
  guikit::PotBehaviour::set_mouse_compatibility(0);
  plugcore::SetupMgr setup(true, true);
  init_setup(setup);
  EXPECT_EQ(guikit::PotBehaviour::get_mouse_compatibility(), 1);
  press_choosing(0);
  const int32_t id = shown_id("Enhanced mouse mode");
  ASSERT_NE(id, 0);
  EXPECT_FALSE(shown_entry(id)->checked);

  press_choosing(id);
  EXPECT_EQ(guikit::PotBehaviour::get_mouse_compatibility(), 0);
  EXPECT_EQ(stored_text(sys::kMouseCompatibilityPath, sys::kMouseCompatibilityName), "0");
  press_choosing(0);
  EXPECT_TRUE(shown_entry(id)->checked);

  press_choosing(id);
  EXPECT_EQ(guikit::PotBehaviour::get_mouse_compatibility(), 1);
  EXPECT_EQ(stored_text(sys::kMouseCompatibilityPath, sys::kMouseCompatibilityName), "1");
  press_choosing(0);
  EXPECT_FALSE(shown_entry(id)->checked);

  // The tick shows the live mode, also when something else changed it.
  guikit::PotBehaviour::set_mouse_compatibility(0);
  press_choosing(0);
  EXPECT_TRUE(shown_entry(id)->checked);
}

TEST_F(SetupMenu, UnrecognisedStoredMouseModeReadsAsOffAndIsReplaced) {
  {
    sys::PersistentKeyList key(sys::kMouseCompatibilityPath, true);
    ASSERT_EQ(key.set_string(sys::kMouseCompatibilityName, "yes"), 0);
  }
  guikit::PotBehaviour::set_mouse_compatibility(1);
  plugcore::SetupMgr setup(true, true);
  init_setup(setup);
  EXPECT_EQ(guikit::PotBehaviour::get_mouse_compatibility(), 0);
  EXPECT_EQ(stored_text(sys::kMouseCompatibilityPath, sys::kMouseCompatibilityName), "0");
}

TEST_F(SetupMenu, NrpnTickFollowsTheValueAndEachChoiceFlipsIt) {
  plugcore::SetupMgr setup(true, true);
  init_setup(setup);
  plugcore::MidiSettings& settings = plugin_->use_midi_mgr()->use_settings();
  const int original = settings.get_nrpn_compatibility();
  press_choosing(0);
  const int32_t id = shown_id("Old erroneous nrpn behaviour");
  ASSERT_NE(id, 0);
  for (int round = 0; round < 3; ++round) {
    const int value = settings.get_nrpn_compatibility();
    press_choosing(0);
    EXPECT_EQ(shown_entry(id)->checked, value == 0) << round;
    press_choosing(id);
    EXPECT_EQ(settings.get_nrpn_compatibility(), 1 - value) << round;
    // Written at once to the store the manager reads at start-up.
    EXPECT_EQ(stored_text("Velmora/Brakmorph", "NRPN Compatibility"), 1 - value == 1 ? "1" : "0") << round;
    press_choosing(0);
    EXPECT_EQ(shown_entry(id)->checked, value == 1) << round;
  }
  settings.set_nrpn_compatibility(original);
}
