#include <gtest/gtest.h>

#include <stdexcept>
#include <vector>

#include "presets/bank_manager.h"
#include "presets/preset_test_util.h"

using plugcore::BankManager;
using plugcore::ProgramSlot;

namespace {

BankManager make_bank(int programs, int values = 40, int extra = 0) {
  BankManager bank;
  bank.resize(programs);
  for (int i = 0; i < programs; ++i) bank.set_program(i, make_slot(i + 1, values, extra));
  return bank;
}

uint32_t be32_at(const std::vector<uint8_t>& bytes, size_t at) {
  return (uint32_t(bytes[at]) << 24) | (uint32_t(bytes[at + 1]) << 16) | (uint32_t(bytes[at + 2]) << 8) |
         uint32_t(bytes[at + 3]);
}

}  // namespace

TEST(BankManager, ResizeAndProgramAccess) {
  BankManager bank;
  EXPECT_EQ(bank.get_nbr_programs(), 0);
  bank.resize(3);
  EXPECT_EQ(bank.use_program(2).get_name(), "Default");
  bank.set_program(1, make_slot(7));
  ProgramSlot out;
  bank.get_program(1, out);
  EXPECT_TRUE(same_slot(out, make_slot(7)));
  bank.use_program(1).set_name("Changed");
  EXPECT_EQ(bank.use_program(1).get_name(), "Changed");
  bank.resize(1);
  EXPECT_EQ(bank.get_nbr_programs(), 1);
  EXPECT_THROW(bank.use_program(1), std::runtime_error);
  EXPECT_THROW(bank.set_program(-1, out), std::runtime_error);
  EXPECT_THROW(bank.get_program(5, out), std::runtime_error);
}

TEST(BankManager, EmptyBankIsEightZeroBytes) {
  BankManager bank;
  EXPECT_EQ(bank.get_serialized_size(), 8);
  EXPECT_EQ(image_of(bank), std::vector<uint8_t>(8, 0));
  BankManager back = make_bank(2);
  ASSERT_EQ(back.unserialize(image_of(bank).data(), 8), 0);
  EXPECT_EQ(back.get_nbr_programs(), 0);
}

TEST(BankManager, BlockLayoutAndRoundTrip) {
  const BankManager bank = make_bank(8, 40, 3);
  const std::vector<uint8_t> bytes = image_of(bank);
  const uint32_t record = 76 + 4 * 40 + 3;
  ASSERT_EQ(bytes.size(), 8 + 8 * record);
  EXPECT_EQ(be32_at(bytes, 0), 8u);
  EXPECT_EQ(be32_at(bytes, 4), record);
  for (int i = 0; i < 8; ++i) {
    // Each record starts at 8 + i R with its tag, then the standard name field.
    EXPECT_EQ(be32_at(bytes, 8 + i * record), bank.use_program(i).get_tag());
    EXPECT_EQ(bytes[8 + i * record + 4], 0);
    EXPECT_EQ(bytes[8 + i * record + 5], 64);
  }
  BankManager back;
  ASSERT_EQ(back.unserialize(bytes.data(), static_cast<int>(bytes.size())), 0);
  EXPECT_TRUE(same_bank(back, bank));
  EXPECT_EQ(image_of(back), bytes);
  EXPECT_EQ(make_bank(8).get_serialized_size(), 1896);
}

TEST(BankManager, ReadsRecordsAtTheirStrideEvenWithPadding) {
  ByteBuilder block;
  block.u32(2).u32(40);
  for (int i = 0; i < 2; ++i) {
    ByteBuilder record;
    record.u32(i).u16(8).u16(3).u32(0).text("p" + std::to_string(i), 8).f32(0.1f * i).f32(0.5f).f32(1.0f);
    record.text("", 40 - record.size());  // padding up to R
    block.raw(record.bytes);
  }
  BankManager bank;
  ASSERT_EQ(bank.unserialize(block.bytes.data(), block.size()), 0);
  ASSERT_EQ(bank.get_nbr_programs(), 2);
  EXPECT_EQ(bank.use_program(1).get_name(), "p1");
  EXPECT_EQ(bank.use_program(1).get_tag(), 1u);
  EXPECT_EQ(bank.use_program(1).get_value(0), 0.1f);
}

TEST(BankManager, RefusesInconsistentBlocksAndStaysUnchanged) {
  const BankManager original = make_bank(3);
  const std::vector<uint8_t> before = image_of(original);
  const std::vector<uint8_t> good = image_of(make_bank(2));

  // Every cut of a valid block.
  for (size_t size = 0; size < good.size(); ++size) {
    BankManager bank = original;
    EXPECT_NE(bank.unserialize(good.data(), static_cast<int>(size)), 0) << size;
    EXPECT_EQ(image_of(bank), before);
  }

  std::vector<std::vector<uint8_t>> bad;
  // N x R past the block.
  bad.push_back(ByteBuilder().u32(3).u32(236).raw(std::vector<uint8_t>(good.begin() + 8, good.end())).bytes);
  // R cannot hold a record header.
  bad.push_back(ByteBuilder().u32(2).u32(11).text("", 22).bytes);
  bad.push_back(ByteBuilder().u32(1).u32(0).bytes);
  // A record that overflows R although the block is long enough.
  bad.push_back(ByteBuilder().u32(2).u32(16).u32(0).u16(0).u16(2).u32(0).f32(0.5f).text("", 40).bytes);
  // Counts whose 32-bit product wraps to something small.
  bad.push_back(ByteBuilder().u32(0x10000001u).u32(16).text("", 16 + 16).bytes);
  bad.push_back(ByteBuilder().u32(0xFFFFFFFFu).u32(0xFFFFFFFFu).text("", 16).bytes);
  for (size_t k = 0; k < bad.size(); ++k) {
    BankManager bank = original;
    EXPECT_NE(bank.unserialize(bad[k].data(), static_cast<int>(bad[k].size())), 0) << k;
    EXPECT_EQ(image_of(bank), before) << k;
  }
}

TEST(BankManager, WriterRefusesProgramsOfDifferentShapes) {
  BankManager bank = make_bank(3);
  bank.set_program(2, make_slot(9, 39));
  std::vector<uint8_t> block(static_cast<size_t>(bank.get_serialized_size()) + 1024);
  EXPECT_NE(bank.serialize(block.data()), 0);
}
