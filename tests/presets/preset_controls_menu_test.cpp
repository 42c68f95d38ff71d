// The selector menu and the name box, bound to controls of the test's own
// (this editor binds neither).
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "presets/preset_manager_fixture.h"

namespace {

using preset_test::kParams;
using preset_test::PresetRig;

class SelectorRig : public PresetRig {
 public:
  SelectorRig() { stage.selector_button.push_back_listener(&manager.use_selector_listener()); }
  const std::vector<guikit::MenuEntry>& open_menu(int32_t choose_id = 0) {
    stage.window.menu().choose_next(choose_id);
    stage.click(preset_test::kSelectorPoint);
    return stage.window.menu().get_last_entries();
  }
  std::vector<float> bank_values(int program) {
    std::vector<float> v;
    for (int i = 0; i < kParams; ++i) v.push_back(manager.use_bank().use_program(program).get_value(i));
    return v;
  }
};

std::string expected_label(int i, const std::string& name) {
  return std::string(i + 1 < 10 ? " " : "") + std::to_string(i + 1) + " - " + name;
}

TEST(PresetSelectorMenu, ListsEveryProgramUnderTheModeTitleAndTicksTheCurrentOne) {
  SelectorRig rig;
  const std::vector<guikit::MenuEntry> entries = rig.open_menu();
  ASSERT_EQ(entries.size(), 10u);
  EXPECT_EQ(entries[0].text, "Load preset");
  EXPECT_TRUE(entries[0].grayed);
  EXPECT_EQ(entries[1].kind, guikit::MenuEntry::kSeparator);
  for (int i = 0; i < 8; ++i) {
    const guikit::MenuEntry& e = entries[2 + i];
    EXPECT_EQ(e.kind, guikit::MenuEntry::kItem);
    EXPECT_EQ(e.text, expected_label(i, rig.manager.use_bank().use_program(i).get_name()));
    EXPECT_FALSE(e.checked) << "nothing selected yet";
  }
  EXPECT_EQ(entries[2].text, " 1 - Light distortion");

  rig.press(4);
  rig.manager.use_bank().use_program(0).set_name("Renamed");
  const std::vector<guikit::MenuEntry> again = rig.open_menu();
  ASSERT_EQ(again.size(), 10u);
  for (int i = 0; i < 8; ++i) EXPECT_EQ(again[2 + i].checked, i == 4) << "item " << i;
  EXPECT_EQ(again[2].text, " 1 - Renamed") << "built anew on every press";

  rig.stage.click(preset_test::kSwitchPoint);
  EXPECT_EQ(rig.open_menu()[0].text, "Store preset");
  EXPECT_EQ(rig.stage.window.menu().get_show_count(), 3);
}

TEST(PresetSelectorMenu, ChoosingAnItemFadesToItsProgram) {
  SelectorRig rig;
  rig.set_fade_seconds(0.0);
  const std::vector<guikit::MenuEntry> entries = rig.open_menu();
  rig.open_menu(entries[2 + 6].id);
  EXPECT_EQ(rig.manager.use_hub().get_current_program(), 6);
  EXPECT_TRUE(rig.manager.use_selector_listener().is_fading());
  rig.tick();
  EXPECT_EQ(rig.params(), rig.bank_values(6));
  EXPECT_FALSE(rig.manager.use_selector_listener().is_fading());
  EXPECT_EQ(rig.open_menu()[2 + 6].checked, true);
}

TEST(PresetSelectorMenu, ChoosingInStoreModeStoresAndGoesBackToLoad) {
  SelectorRig rig;
  rig.effect->setParameter(rig.effect, 14, 0.4242f);
  const std::vector<float> sound = rig.params();
  rig.stage.click(preset_test::kSwitchPoint);
  const std::vector<guikit::MenuEntry> entries = rig.open_menu();
  rig.open_menu(entries[2 + 1].id);
  EXPECT_EQ(rig.bank_values(1), sound);
  EXPECT_EQ(rig.manager.use_mem_listener().get_mode(), plugcore::PresetMemListener::kLoad);
  EXPECT_FALSE(rig.manager.use_selector_listener().is_fading());
  EXPECT_EQ(rig.manager.use_hub().get_current_program(), 1);
}

TEST(PresetSelectorMenu, ASecondChoiceReplacesTheSelectorsRunningFade) {
  SelectorRig rig;
  rig.set_fade_seconds(50.0);
  const std::vector<guikit::MenuEntry> entries = rig.open_menu();
  rig.open_menu(entries[2 + 2].id);
  rig.stage.window.advance_ms(300);  // the button's flash is over, the fade runs
  const int32_t first = rig.manager.use_selector_listener().get_timer_id();
  const size_t timers = rig.stage.window.get_running_timer_count();
  rig.open_menu(entries[2 + 3].id);
  rig.stage.window.advance_ms(300);
  EXPECT_NE(rig.manager.use_selector_listener().get_timer_id(), first);
  EXPECT_EQ(rig.stage.window.get_running_timer_count(), timers) << "the first fade's timer was cleared";
  EXPECT_EQ(rig.manager.use_hub().get_current_program(), 3);
}

TEST(PresetSelectorMenu, TheTitleItemCannotBeChosen) {
  SelectorRig rig;
  const std::vector<guikit::MenuEntry> entries = rig.open_menu();
  rig.open_menu(entries[0].id);
  EXPECT_EQ(rig.manager.use_hub().get_current_program(), -1);
  EXPECT_FALSE(rig.manager.use_selector_listener().is_fading());
}

class NameBoxRig : public PresetRig {
 public:
  NameBoxRig() {
    box.set_offset(guikit::Point{150, 85});
    box.set_bounding_box(guikit::Rect{-40, -5, 40, 10});
    box.set_placed(true);
    box.set_editable(true);
    stage.group.add_control(&box);
    box.push_back_listener(&manager.use_name_listener());
  }
  void type_name(const std::string& name) {
    stage.click(guikit::Point{150, 85});
    stage.window.line_editor().type(name);
    stage.window.line_editor().stop(true);
  }
  guikit::TextBox box;
};

TEST(PresetNameBox, RenamesTheCurrentProgramOrElseTheEnginesProgram) {
  NameBoxRig rig;
  const std::vector<float> sound = rig.params();
  rig.type_name("First sound");
  EXPECT_EQ(rig.plugin->use_dsp()->get_program_name(), "First sound");
  EXPECT_EQ(rig.params(), sound) << "the engine keeps its values";
  for (int i = 0; i < 8; ++i) EXPECT_NE(rig.manager.use_bank().use_program(i).get_name(), "First sound");

  rig.set_fade_seconds(0.0);
  rig.press(2);
  rig.tick();
  const std::string engine_name = rig.plugin->use_dsp()->get_program_name();
  rig.type_name("Second");
  EXPECT_EQ(rig.manager.use_bank().use_program(2).get_name(), "Second");
  EXPECT_EQ(rig.plugin->use_dsp()->get_program_name(), engine_name) << "the sound does not change";
  EXPECT_FALSE(rig.manager.use_name_listener().is_fading());
}

TEST(PresetNameBox, AProgramButtonWithANameBoxShowsTheProgramsName) {
  NameBoxRig rig;
  rig.number(5).set_name_box(&rig.box);
  rig.press(5);
  EXPECT_EQ(rig.box.get_text(), rig.manager.use_bank().use_program(5).get_name());
}

}  // namespace
