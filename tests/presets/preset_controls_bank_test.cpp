// The bank-load and bank-save buttons: dialogs, strict round trips, the
// conflict question and the error boxes.
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include "presets/bank_file.h"
#include "presets/bank_status.h"
#include "presets/preset_manager_fixture.h"
#include "presets/preset_test_util.h"

namespace {

using preset_test::BankDir;
using preset_test::PresetRig;

std::string file_text(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  return std::string(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
}

void press_save(PresetRig& rig) { rig.stage.click(preset_test::kSavePoint); }
void press_load(PresetRig& rig) { rig.stage.click(preset_test::kLoadPoint); }

// Makes the editor bank differ from the default: a sound of our own stored in
// program 3 and a renamed program 6.
void personalise(PresetRig& rig) {
  rig.effect->setParameter(rig.effect, 11, 0.3141f);
  rig.effect->setParameter(rig.effect, 30, 0.7071f);
  rig.stage.click(preset_test::kSwitchPoint);
  rig.press(3);
  rig.manager.use_bank().use_program(6).set_name("Mine, renamed");
}

TEST(PresetBankButtons, SaveThenLoadRoundTripsTheEditorBankExactly) {
  BankDir dir;
  PresetRig rig;
  personalise(rig);
  const std::vector<uint8_t> saved = image_of(rig.manager.use_bank());
  ASSERT_FALSE(saved.empty());

  const std::string path = dir.file("live.pbk");
  rig.ui.choose(path);
  press_save(rig);
  ASSERT_EQ(rig.ui.dialogs.size(), 1u);
  EXPECT_TRUE(rig.ui.dialogs[0].save);
  EXPECT_EQ(rig.ui.dialogs[0].title, "Save preset bank");
  ASSERT_EQ(rig.ui.dialogs[0].filters.size(), 1u);
  EXPECT_EQ(rig.ui.dialogs[0].filters[0].pattern, "*.pbk");
  EXPECT_TRUE(rig.ui.boxes.empty()) << "a new file is written without asking";
  EXPECT_EQ(std::filesystem::file_size(path), 1904u);

  // Spoil the bank, then load the file back.
  rig.manager.use_bank().use_program(3).set_value(11, 0.9f);
  rig.manager.use_bank().use_program(6).set_name("other");
  ASSERT_NE(image_of(rig.manager.use_bank()), saved);
  const std::vector<float> sound = rig.params();
  rig.ui.choose(path);
  press_load(rig);
  ASSERT_EQ(rig.ui.dialogs.size(), 2u);
  EXPECT_FALSE(rig.ui.dialogs[1].save);
  EXPECT_EQ(rig.ui.dialogs[1].title, "Load preset bank");
  EXPECT_EQ(rig.ui.dialogs[1].file_name, "live.pbk") << "the dialog remembers the last file";
  EXPECT_TRUE(rig.ui.boxes.empty());
  EXPECT_EQ(image_of(rig.manager.use_bank()), saved);
  EXPECT_EQ(rig.manager.use_bank().use_program(3).get_value(11), 0.3141f);
  // Loading a bank changes neither the sound nor the current program.
  EXPECT_EQ(rig.params(), sound);
  EXPECT_EQ(rig.manager.use_hub().get_current_program(), 3);
}

TEST(PresetBankButtons, ASevenProgramBankIsRefusedWithAnErrorBox) {
  BankDir dir;
  PresetRig rig;
  plugcore::BankManager seven;
  seven.resize(7);
  for (int i = 0; i < 7; ++i) seven.set_program(i, rig.manager.use_bank().use_program(7 - i));
  const std::string path = dir.file("seven.pbk");
  ASSERT_EQ(plugcore::save_bank_file(path, seven), 0);
  // What the strict reader says about it, on a bank of the editor's shape.
  plugcore::BankManager probe = rig.manager.use_bank();
  const int code = plugcore::load_bank_file(path, probe, true);
  EXPECT_EQ(code, plugcore::kBankCountMismatch);
  EXPECT_EQ(code, -1011);

  const std::vector<uint8_t> before = image_of(rig.manager.use_bank());
  rig.ui.choose(path);
  press_load(rig);
  ASSERT_EQ(rig.ui.boxes.size(), 1u);
  EXPECT_EQ(rig.ui.boxes[0].title, "Error");
  EXPECT_EQ(rig.ui.boxes[0].text, "Can't load bank file\n" + path + "\n\nCode -1011");
  EXPECT_EQ(rig.ui.boxes[0].buttons, 0) << "OK only";
  EXPECT_EQ(image_of(rig.manager.use_bank()), before);
}

TEST(PresetBankButtons, ALoadOfAMissingOrForeignFileShowsItsCode) {
  BankDir dir;
  PresetRig rig;
  const std::string missing = dir.file("missing.pbk");
  const std::string foreign = dir.file("foreign.pbk");
  { std::ofstream(foreign, std::ios::binary) << "RIFF....not a bank at all"; }
  const std::vector<uint8_t> before = image_of(rig.manager.use_bank());
  for (const std::string& path : {missing, foreign}) {
    plugcore::BankManager probe = rig.manager.use_bank();
    const int code = plugcore::load_bank_file(path, probe, true);
    ASSERT_NE(code, 0);
    rig.ui.boxes.clear();
    rig.ui.choose(path);
    press_load(rig);
    ASSERT_EQ(rig.ui.boxes.size(), 1u) << path;
    EXPECT_EQ(rig.ui.boxes[0].text, "Can't load bank file\n" + path + "\n\nCode " + std::to_string(code));
    EXPECT_EQ(image_of(rig.manager.use_bank()), before);
  }
  EXPECT_EQ(plugcore::load_bank_file(foreign, rig.manager.use_bank(), true), plugcore::kBankBadMagic);
}

TEST(PresetBankButtons, SavingOverAFileAsksAndCancelLeavesItUntouched) {
  BankDir dir;
  PresetRig rig;
  const std::string path = dir.file("existing.pbk");
  { std::ofstream(path, std::ios::binary) << "keep me"; }

  rig.ui.choose(path);
  rig.ui.box_answer = 1;  // Cancel
  press_save(rig);
  ASSERT_EQ(rig.ui.boxes.size(), 1u);
  EXPECT_EQ(rig.ui.boxes[0].title, "Conflict");
  EXPECT_EQ(rig.ui.boxes[0].text, path + "\nalready exists. Overwrite ?");
  EXPECT_EQ(rig.ui.boxes[0].buttons, 1) << "OK and Cancel";
  EXPECT_EQ(rig.ui.boxes[0].default_button, 1) << "Cancel preselected";
  EXPECT_EQ(file_text(path), "keep me");

  // A box that cannot be shown is no permission either.
  rig.ui.box_answer = -1;
  press_save(rig);
  EXPECT_EQ(file_text(path), "keep me");

  rig.ui.box_answer = 0;  // OK
  rig.ui.boxes.clear();
  press_save(rig);
  ASSERT_EQ(rig.ui.boxes.size(), 1u);
  EXPECT_EQ(rig.ui.boxes[0].title, "Conflict");
  plugcore::BankManager back = rig.manager.use_bank();
  EXPECT_EQ(plugcore::load_bank_file(path, back, true), 0);
  EXPECT_EQ(image_of(back), image_of(rig.manager.use_bank()));
}

TEST(PresetBankButtons, AFailedSaveShowsAnErrorBoxWithTheWritersCode) {
  BankDir dir;
  PresetRig rig;
  const std::string path = dir.file("no_such_folder/bank.pbk");
  const int code = plugcore::save_bank_file(path, rig.manager.use_bank());
  ASSERT_NE(code, 0);
  rig.ui.choose(path);
  press_save(rig);
  ASSERT_EQ(rig.ui.boxes.size(), 1u);
  EXPECT_EQ(rig.ui.boxes[0].title, "Error");
  EXPECT_EQ(rig.ui.boxes[0].text, "Can't save bank file\n" + path + "\n\nCode " + std::to_string(code));
  EXPECT_EQ(rig.ui.boxes[0].buttons, 0);
}

TEST(PresetBankButtons, CancelledOrFailedDialogsDoNothingAndShowNothing) {
  BankDir dir;
  PresetRig rig;
  const std::vector<uint8_t> before = image_of(rig.manager.use_bank());
  const std::string remembered = rig.manager.use_bank_dialog().get_path();
  for (int32_t status : {1, -1024}) {
    rig.ui.next.status = status;
    rig.ui.next.path = dir.file("never.pbk");
    press_save(rig);
    press_load(rig);
  }
  EXPECT_EQ(rig.ui.dialogs.size(), 4u);
  EXPECT_TRUE(rig.ui.boxes.empty());
  EXPECT_FALSE(std::filesystem::exists(dir.file("never.pbk")));
  EXPECT_EQ(image_of(rig.manager.use_bank()), before);
  EXPECT_EQ(rig.manager.use_bank_dialog().get_path(), remembered);
}

TEST(PresetBankButtons, ANameWithoutExtensionIsSavedAsAPbkFile) {
  BankDir dir;
  PresetRig rig;
  rig.ui.choose(dir.file("plain"));
  press_save(rig);
  EXPECT_TRUE(std::filesystem::exists(dir.file("plain.pbk")));
  EXPECT_TRUE(rig.ui.boxes.empty());
}

}  // namespace
