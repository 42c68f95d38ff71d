// Start-up of the preset manager: the editor bank from the engine and the
// default bank, the fade-time knob at one second, the bank dialog's set-up.
#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "config/system_services.h"
#include "presets/bank_file.h"
#include "presets/preset_manager_fixture.h"

namespace {

using preset_test::kParams;
using preset_test::PresetRig;

const char* const kFactoryNames[] = {"Light distortion", "Distortion + Compression", "Distortion + Expansion",
                                     "Lipo-flatulence"};

// The module's default bank, read on its own.
plugcore::BankManager resource_bank() {
  const sys::Resource resource = sys::get_resource("VLPB", "DEFAULT_PRESET_BANK");
  plugcore::BankManager bank;
  EXPECT_TRUE(static_cast<bool>(resource));
  EXPECT_EQ(plugcore::load_bank_mem(resource.data, static_cast<int>(resource.size), bank, false), 0);
  return bank;
}

void expect_values(const plugcore::ProgramSlot& slot, const std::vector<float>& values, const std::string& what) {
  ASSERT_EQ(slot.get_nbr_values(), kParams) << what;
  for (int i = 0; i < kParams; ++i) EXPECT_EQ(slot.get_value(i), values[i]) << what << ", value " << i;
}

void expect_same_program(const plugcore::ProgramSlot& a, const plugcore::ProgramSlot& b, int index) {
  EXPECT_EQ(a.get_name(), b.get_name()) << "program " << index;
  ASSERT_EQ(a.get_nbr_values(), b.get_nbr_values());
  for (int i = 0; i < a.get_nbr_values(); ++i) EXPECT_EQ(a.get_value(i), b.get_value(i)) << "program " << index;
}

TEST(PresetInit, TheDefaultBankFillsTheEditorBankAndTheFadeTimeIsOneSecond) {
  PresetRig rig;
  EXPECT_EQ(rig.init_status, 0);
  EXPECT_TRUE(rig.manager.is_initialised());
  const plugcore::BankManager expected = resource_bank();
  ASSERT_EQ(rig.manager.use_bank().get_nbr_programs(), 8);
  for (int i = 0; i < 8; ++i) expect_same_program(rig.manager.use_bank().use_program(i), expected.use_program(i), i);
  for (int i = 0; i < 4; ++i) EXPECT_EQ(rig.manager.use_bank().use_program(i).get_name(), kFactoryNames[i]);

  EXPECT_NEAR(rig.stage.knob.get_value(), std::log10(2.0) / 2.0, 1e-15);
  EXPECT_NEAR(rig.fade_time(), 1.0, 1e-12);
  EXPECT_EQ(rig.stage.display.get_text(), "1");
  // Opening the editor does not change the sound.
  EXPECT_TRUE(rig.host.automations.empty());
  EXPECT_EQ(rig.manager.use_hub().get_current_program(), -1);
}

TEST(PresetInit, EveryControlGetsOneListenerAndEachButtonItsIndex) {
  PresetRig rig;
  for (int i = 0; i < 8; ++i) {
    EXPECT_EQ(rig.stage.buttons[i].get_listener_count(), 1u);
    EXPECT_EQ(rig.stage.buttons[i].get_first_listener(), rig.manager.use_number_listener(i));
    EXPECT_EQ(rig.number(i).get_index(), i);
    EXPECT_EQ(rig.manager.use_hub().use_number_listener(i), rig.manager.use_number_listener(i));
  }
  EXPECT_EQ(rig.manager.use_number_listener(8), nullptr);
  EXPECT_EQ(rig.manager.use_number_listener(-1), nullptr);
  EXPECT_EQ(rig.stage.mode_switch.get_first_listener(), &rig.manager.use_mem_listener());
  EXPECT_EQ(rig.stage.knob.get_first_listener(), &rig.manager.use_time_fader_listener());
  EXPECT_EQ(rig.stage.display.get_first_listener(), &rig.manager.use_time_display_listener());
  EXPECT_EQ(rig.stage.load_button.get_listener_count(), 1u);
  EXPECT_EQ(rig.stage.save_button.get_listener_count(), 1u);

  // A second init does nothing: no listener twice, the bank as it is.
  rig.manager.use_bank().use_program(2).set_name("kept");
  EXPECT_EQ(rig.manager.init(*rig.editor, nullptr, rig.stage.buttons.get(), rig.stage.mode_switch,
                             rig.stage.load_button, rig.stage.save_button, rig.stage.knob, rig.stage.display,
                             "no_such_bank"),
            0);
  EXPECT_EQ(rig.stage.buttons[0].get_listener_count(), 1u);
  EXPECT_EQ(rig.stage.knob.get_listener_count(), 1u);
  EXPECT_EQ(rig.manager.use_bank().use_program(2).get_name(), "kept");
}

TEST(PresetInit, ASmallerEditorTakesTheFirstProgramsOfTheDefaultBank) {
  PresetRig rig(4);
  EXPECT_EQ(rig.init_status, 0);
  const plugcore::BankManager expected = resource_bank();
  ASSERT_EQ(rig.manager.use_bank().get_nbr_programs(), 4);
  for (int i = 0; i < 4; ++i) expect_same_program(rig.manager.use_bank().use_program(i), expected.use_program(i), i);
}

TEST(PresetInit, ALargerEditorKeepsTheEnginesSoundBeyondTheDefaultBank) {
  PresetRig rig(12);
  EXPECT_EQ(rig.init_status, 0);
  const plugcore::BankManager expected = resource_bank();
  const std::vector<float> engine = rig.params();
  ASSERT_EQ(rig.manager.use_bank().get_nbr_programs(), 12);
  for (int i = 0; i < 8; ++i) expect_same_program(rig.manager.use_bank().use_program(i), expected.use_program(i), i);
  for (int i = 8; i < 12; ++i) {
    EXPECT_EQ(rig.manager.use_bank().use_program(i).get_name(), rig.plugin->use_dsp()->get_program_name());
    expect_values(rig.manager.use_bank().use_program(i), engine, "program " + std::to_string(i));
  }
  // The programs beyond are usable like the others.
  rig.set_fade_seconds(0.0);
  rig.press(11);
  rig.tick();
  EXPECT_EQ(rig.params(), engine);
}

TEST(PresetInit, AMissingOrNoDefaultBankLeavesTheEnginesSoundEverywhere) {
  for (const char* name : {"no_such_bank", static_cast<const char*>(nullptr)}) {
    PresetRig rig(8, name);
    EXPECT_EQ(rig.init_status, name ? -1 : 0);
    const std::vector<float> engine = rig.params();
    for (int i = 0; i < 8; ++i) {
      EXPECT_EQ(rig.manager.use_bank().use_program(i).get_name(), rig.plugin->use_dsp()->get_program_name());
      expect_values(rig.manager.use_bank().use_program(i), engine, "program " + std::to_string(i));
    }
    EXPECT_TRUE(rig.ui.boxes.empty()) << "nothing is shown to the user";
    EXPECT_EQ(rig.stage.display.get_text(), "1");
  }
}

TEST(PresetInit, TheBankDialogHasOneFilterAndTakesTheSettingDirectory) {
  PresetRig rig;
  const std::vector<sys::FileFilter>& filters = rig.manager.use_bank_dialog().get_filters();
  ASSERT_EQ(filters.size(), 1u);
  EXPECT_EQ(filters[0].description, "Velmora plug-in preset bank (*.pbk)");
  EXPECT_EQ(filters[0].pattern, "*.pbk");

  rig.manager.set_bank_directory("C:\\Users\\me\\Settings");
  EXPECT_EQ(rig.manager.use_bank_dialog().get_path(), "C:\\Users\\me\\Settings\\");
  rig.manager.use_bank_dialog().set_path("/home/me/banks/live set.pbk");
  rig.manager.set_bank_directory("D:\\presets");
  EXPECT_EQ(rig.manager.use_bank_dialog().get_path(), "D:\\presets\\live set.pbk");
}

TEST(PresetStrategy, MixIsLinearForContinuousParametersAndCopiesTheExtraData) {
  PresetRig rig;
  plugcore::ProgStLdDefault strategy;
  strategy.set_context(&rig.manager.use_bank(), &rig.host_gui, rig.plugin->use_dsp());
  plugcore::ProgramSlot from;
  plugcore::ProgramSlot to;
  from.set_nbr_values(kParams);
  to.set_nbr_values(kParams);
  for (int i = 0; i < kParams; ++i) {
    from.set_value(i, static_cast<float>(i) / 80.0f);
    to.set_value(i, 1.0f - static_cast<float>(i) / 50.0f);
  }
  to.set_extra_size(3);
  to.use_extra_data()[0] = 7;
  to.use_extra_data()[2] = 9;
  for (double position : {0.0, 0.25, 0.6180339887, 1.0}) {
    plugcore::ProgramSlot out;
    strategy.mix(out, from, to, position);
    ASSERT_EQ(out.get_nbr_values(), kParams);
    for (int i = 0; i < kParams; ++i) {
      const double a = from.get_value(i);
      const double b = to.get_value(i);
      const float expected = rig.stepped(i) ? to.get_value(i) : static_cast<float>(a + (b - a) * position);
      EXPECT_NEAR(out.get_value(i), expected, 1e-7) << "value " << i << " at " << position;
    }
    ASSERT_EQ(out.get_extra_size(), 3);
    EXPECT_EQ(out.use_extra_data()[0], 7);
    EXPECT_EQ(out.use_extra_data()[2], 9);
  }

  // apply_mix names the program like its target and writes it through the host.
  to.set_name("Target");
  rig.host.automations.clear();
  strategy.apply_mix(from, to, 0.5);
  EXPECT_EQ(rig.plugin->use_dsp()->get_program_name(), "Target");
  EXPECT_EQ(rig.host.automations.size(), static_cast<size_t>(kParams));

  // apply goes straight to the engine, unreported.
  plugcore::ProgramSlot direct;
  strategy.store_current(direct);
  direct.set_name("Direct");
  direct.set_value(9, 0.25f);
  rig.host.automations.clear();
  strategy.apply(direct);
  EXPECT_EQ(rig.plugin->use_dsp()->get_program_name(), "Direct");
  EXPECT_EQ(rig.param(9), 0.25f);
  EXPECT_TRUE(rig.host.automations.empty());

  EXPECT_THROW(strategy.write_to_bank(8, direct), std::runtime_error);
  plugcore::ProgStLdDefault unset;
  EXPECT_THROW(unset.store_current(direct), std::runtime_error);
}

}  // namespace
