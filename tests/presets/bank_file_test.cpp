#include <gtest/gtest.h>

#include <cmath>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <random>
#include <set>
#include <string>
#include <vector>

#include "presets/bank_file.h"
#include "presets/bank_status.h"
#include "presets/factory_programs.h"
#include "presets/preset_test_util.h"

using namespace plugcore;
namespace fs = std::filesystem;

namespace {

class BankFileTest : public ::testing::Test {
 protected:
  void SetUp() override {
    const auto* info = ::testing::UnitTest::GetInstance()->current_test_info();
    dir_ = fs::temp_directory_path() / ("bank_file_test_" + std::to_string(std::random_device{}()) + "_" + info->name());
    fs::remove_all(dir_);
    fs::create_directories(dir_);
  }
  void TearDown() override {
    std::error_code ignored;
    fs::permissions(dir_, fs::perms::owner_all, fs::perm_options::add, ignored);
    fs::remove_all(dir_, ignored);
  }
  std::string path(const std::string& name) const { return (dir_ / name).string(); }

  static std::vector<uint8_t> read_all(const std::string& file) {
    std::ifstream in(file, std::ios::binary);
    return std::vector<uint8_t>(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
  }
  static void write_all(const std::string& file, const std::vector<uint8_t>& bytes) {
    std::ofstream out(file, std::ios::binary);
    out.write(reinterpret_cast<const char*>(bytes.data()), static_cast<std::streamsize>(bytes.size()));
  }
  // A complete file image: "VLPB", L, then the block.
  static std::vector<uint8_t> file_image(const std::vector<uint8_t>& block) {
    ByteBuilder image;
    image.raw({'V', 'L', 'P', 'B'}).u32(static_cast<uint32_t>(block.size())).raw(block);
    return image.bytes;
  }
  static BankManager make_bank(int programs, int values = 40) {
    BankManager bank;
    bank.resize(programs);
    for (int i = 0; i < programs; ++i) bank.set_program(i, make_slot(i + 3, values, 2));
    return bank;
  }

  fs::path dir_;
};

}  // namespace

TEST_F(BankFileTest, FactoryBankFileIs1904BytesAndReadsBack) {
  BankManager bank;
  make_factory_bank(bank);
  const std::string file = path("factory.pbk");
  ASSERT_EQ(save_bank_file(file, bank), kBankOk);
  const std::vector<uint8_t> bytes = read_all(file);
  ASSERT_EQ(bytes.size(), 1904u);
  EXPECT_EQ(std::string(bytes.begin(), bytes.begin() + 4), "VLPB");
  EXPECT_EQ(std::vector<uint8_t>(bytes.begin() + 4, bytes.begin() + 16),
            (std::vector<uint8_t>{0x00, 0x00, 0x07, 0x68, 0, 0, 0, 8, 0, 0, 0, 236}));
  EXPECT_FALSE(fs::exists(bank_temp_path(file)));

  BankManager strict_target;
  strict_target.resize(8);
  for (int i = 0; i < 8; ++i) strict_target.use_program(i).set_nbr_values(40);
  ASSERT_EQ(load_bank_file(file, strict_target, true), kBankOk);
  EXPECT_TRUE(same_bank(strict_target, bank));

  BankManager from_memory;
  ASSERT_EQ(load_bank_mem(bytes.data(), static_cast<int>(bytes.size()), from_memory, false), kBankOk);
  EXPECT_TRUE(same_bank(from_memory, bank));
}

TEST_F(BankFileTest, RoundTripOfAnyShapeNonStrict) {
  const BankManager bank = make_bank(5, 12);
  ASSERT_EQ(save_bank_file(path("b.pbk"), bank), kBankOk);
  BankManager target = make_bank(2);
  ASSERT_EQ(load_bank_file(path("b.pbk"), target, false), kBankOk);
  EXPECT_TRUE(same_bank(target, bank));
}

TEST_F(BankFileTest, SavingReplacesAnExistingFile) {
  write_all(path("b.pbk"), std::vector<uint8_t>(5000, 0x55));
  const BankManager bank = make_bank(2);
  ASSERT_EQ(save_bank_file(path("b.pbk"), bank), kBankOk);
  EXPECT_EQ(read_all(path("b.pbk")), file_image(image_of(bank)));
}

TEST_F(BankFileTest, ReadErrorsLeaveTheTargetUnchanged) {
  const BankManager original = make_bank(8);
  const std::vector<uint8_t> good = file_image(image_of(make_bank(8)));

  struct Case {
    const char* label;
    std::vector<uint8_t> bytes;
    int status;
  };
  std::vector<uint8_t> bad_magic = good;
  bad_magic[3] = 'X';
  std::vector<uint8_t> truncated(good.begin(), good.end() - 1);
  std::vector<uint8_t> lying_length = good;
  lying_length[4] = 0x7F;  // promises ~2 GiB
  std::vector<uint8_t> inconsistent = good;
  inconsistent[11] = 9;  // N = 9 records of R bytes do not fit in L
  const Case cases[] = {
      {"bad magic", bad_magic, kBankBadMagic},
      {"truncated block", truncated, kBankBlockReadShort},
      {"lying length", lying_length, kBankBlockReadShort},
      {"short header", std::vector<uint8_t>(good.begin(), good.begin() + 5), kBankHeaderShort},
      {"empty file", {}, kBankHeaderShort},
      {"inconsistent block", inconsistent, kBankParseFailed},
  };
  for (const Case& c : cases) {
    write_all(path("bad.pbk"), c.bytes);
    BankManager target = original;
    EXPECT_EQ(load_bank_file(path("bad.pbk"), target, false), c.status) << c.label;
    EXPECT_TRUE(same_bank(target, original)) << c.label;
  }
  BankManager target = original;
  EXPECT_EQ(load_bank_file(path("missing.pbk"), target, false), kBankCannotOpen);
  EXPECT_TRUE(same_bank(target, original));
}

TEST_F(BankFileTest, StrictReadInsistsOnTheTargetsShape) {
  BankManager editor_bank = make_bank(8);
  const BankManager original = editor_bank;

  ASSERT_EQ(save_bank_file(path("seven.pbk"), make_bank(7)), kBankOk);
  EXPECT_EQ(load_bank_file(path("seven.pbk"), editor_bank, true), kBankCountMismatch);
  EXPECT_TRUE(same_bank(editor_bank, original));

  // Programs 3 and 5 have another value count; all records keep one size
  // through extra bytes, so the file itself is well formed.
  BankManager odd = make_bank(8);
  ProgramSlot shorter = make_slot(1, 39, 4);
  odd.set_program(3, shorter);
  odd.set_program(5, shorter);
  for (int i = 0; i < 8; ++i) {
    if (i != 3 && i != 5) odd.set_program(i, make_slot(i, 40, 0));
  }
  ASSERT_EQ(save_bank_file(path("odd.pbk"), odd), kBankOk);
  EXPECT_EQ(load_bank_file(path("odd.pbk"), editor_bank, true), kBankValueCountMismatch);
  EXPECT_TRUE(same_bank(editor_bank, original));

  // Read without insisting, both files are accepted and the bank takes their shape.
  ASSERT_EQ(load_bank_file(path("seven.pbk"), editor_bank, false), kBankOk);
  EXPECT_EQ(editor_bank.get_nbr_programs(), 7);
  ASSERT_EQ(load_bank_file(path("odd.pbk"), editor_bank, false), kBankOk);
  EXPECT_EQ(editor_bank.use_program(3).get_nbr_values(), 39);
}

TEST_F(BankFileTest, MemoryImageIsBoundedByItsSize) {
  const BankManager original = make_bank(2);
  const std::vector<uint8_t> image = file_image(image_of(make_bank(3)));
  BankManager target = original;
  EXPECT_EQ(load_bank_mem(image.data(), static_cast<int>(image.size()) - 1, target, false), kBankParseFailed);
  EXPECT_TRUE(same_bank(target, original));
  EXPECT_EQ(load_bank_mem(image.data(), 7, target, false), kBankHeaderShort);
  EXPECT_EQ(load_bank_mem(nullptr, 100, target, false), kBankHeaderShort);
  std::vector<uint8_t> bad = image;
  bad[0] = 'v';
  EXPECT_EQ(load_bank_mem(bad.data(), static_cast<int>(bad.size()), target, false), kBankBadMagic);
  EXPECT_TRUE(same_bank(target, original));
  EXPECT_EQ(load_bank_mem(image.data(), static_cast<int>(image.size()), target, true), kBankCountMismatch);
  EXPECT_TRUE(same_bank(target, original));
  // The length field is not what bounds a memory image.
  std::vector<uint8_t> wrong_length = image;
  wrong_length[7] = 0;
  EXPECT_EQ(load_bank_mem(wrong_length.data(), static_cast<int>(wrong_length.size()), target, false), kBankOk);
  EXPECT_EQ(target.get_nbr_programs(), 3);
}

TEST_F(BankFileTest, FailedSaveLeavesTheOldFileIntact) {
  const std::string file = path("keep.pbk");
  const BankManager old_bank = make_bank(4);
  ASSERT_EQ(save_bank_file(file, old_bank), kBankOk);
  const std::vector<uint8_t> old_bytes = read_all(file);

  // A bank the writer cannot lay out (records of two sizes).
  BankManager mixed = make_bank(3);
  mixed.set_program(1, make_slot(1, 10));
  EXPECT_EQ(save_bank_file(file, mixed), kBankSerializeFailed);
  EXPECT_EQ(read_all(file), old_bytes);
  EXPECT_FALSE(fs::exists(bank_temp_path(file)));

  // The temporary file cannot be created.
  fs::create_directory(bank_temp_path(file));
  EXPECT_EQ(save_bank_file(file, make_bank(8)), kBankCannotOpen);
  EXPECT_EQ(read_all(file), old_bytes);
  fs::remove(bank_temp_path(file));

  // Into a folder that does not exist.
  EXPECT_EQ(save_bank_file(path("no/such/folder.pbk"), old_bank), kBankCannotOpen);
}

TEST_F(BankFileTest, SaveIntoReadOnlyFolderLeavesTheOldFileIntact) {
  const std::string file = path("keep.pbk");
  ASSERT_EQ(save_bank_file(file, make_bank(4)), kBankOk);
  const std::vector<uint8_t> old_bytes = read_all(file);
  fs::permissions(dir_, fs::perms::owner_read | fs::perms::owner_exec, fs::perm_options::replace);
  // A privileged user writes anyway; then the folder cannot be made read-only.
  const std::string probe = path("probe");
  if (std::FILE* f = std::fopen(probe.c_str(), "wb")) {
    std::fclose(f);
    std::remove(probe.c_str());
    GTEST_SKIP() << "folder permissions are not enforced for this user";
  }
  EXPECT_EQ(save_bank_file(file, make_bank(8)), kBankCannotOpen);
  EXPECT_EQ(read_all(file), old_bytes);
}

TEST(BankStatus, EachCodeHasItsOwnSentence) {
  const int codes[] = {kBankCannotOpen,      kBankHeaderWriteFailed, kBankHeaderShort,  kBankSerializeFailed,
                       kBankParseFailed,     kBankBlockWriteShort,   kBankBlockReadShort, kBankBadMagic,
                       kBankCountMismatch,   kBankValueCountMismatch};
  const std::string unknown = describe_bank_status(-1003);
  std::set<std::string> seen;
  for (int code : codes) {
    const std::string text = describe_bank_status(code);
    EXPECT_FALSE(text.empty());
    EXPECT_NE(text, unknown) << code;
    EXPECT_TRUE(seen.insert(text).second) << code;
  }
  EXPECT_EQ(kBankCannotOpen, -1002);
  EXPECT_EQ(kBankValueCountMismatch, -1012);
  EXPECT_NE(std::string(describe_bank_status(0)), unknown);
}
