#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <stdexcept>
#include <string>
#include <vector>

#include "presets/program_slot.h"
#include "presets/preset_test_util.h"

using plugcore::ProgramSlot;

TEST(ProgramSlot, NewSlotAndResizing) {
  ProgramSlot slot;
  EXPECT_EQ(slot.get_name(), "Default");
  EXPECT_EQ(slot.get_tag(), 0u);
  EXPECT_EQ(slot.get_nbr_values(), 0);
  EXPECT_EQ(slot.get_extra_size(), 0);
  EXPECT_EQ(slot.get_serialized_size(), 76);

  slot.set_nbr_values(3);
  slot.set_value(2, 0.75f);
  slot.set_nbr_values(5);
  EXPECT_EQ(slot.get_value(2), 0.75f);
  EXPECT_EQ(slot.get_value(4), 0.0f);
  slot.set_nbr_values(2);
  EXPECT_EQ(slot.get_nbr_values(), 2);
  EXPECT_THROW(slot.get_value(2), std::runtime_error);
  EXPECT_THROW(slot.set_value(-1, 0.0f), std::runtime_error);

  slot.set_extra_size(2);
  slot.use_extra_data()[1] = 9;
  slot.set_extra_size(4);
  EXPECT_EQ(slot.use_extra_data()[1], 9);
  EXPECT_EQ(slot.use_extra_data()[3], 0);
  EXPECT_EQ(slot.get_serialized_size(), 76 + 4 * 2 + 4);

  ProgramSlot copy(slot);
  EXPECT_TRUE(same_slot(copy, slot));
  ProgramSlot assigned = make_slot(3, 5, 2);
  assigned = slot;
  EXPECT_TRUE(same_slot(assigned, slot));
}

TEST(ProgramSlot, RecordLayoutIsBigEndian) {
  ProgramSlot slot;
  slot.set_tag(0x01020304u);
  slot.set_name("Ab");
  slot.set_nbr_values(3);
  slot.set_value(0, 0.5f);
  slot.set_value(1, -2.0f);
  slot.set_value(2, 1.0f);
  slot.set_extra_size(2);
  slot.use_extra_data()[0] = 9;
  slot.use_extra_data()[1] = 8;

  ByteBuilder expected;
  expected.u32(0x01020304u).u16(64).u16(3).u32(2).text("Ab", 64);
  expected.raw({0x3F, 0x00, 0x00, 0x00, 0xC0, 0x00, 0x00, 0x00, 0x3F, 0x80, 0x00, 0x00, 9, 8});
  ASSERT_EQ(slot.get_serialized_size(), expected.size());
  EXPECT_EQ(image_of(slot), expected.bytes);
}

TEST(ProgramSlot, RoundTripKeepsEveryFloatBitExact) {
  const float unusual[] = {0.0f, -0.0f, 1.0f, 0.50012f, std::numeric_limits<float>::denorm_min(),
                            std::numeric_limits<float>::infinity(), std::numeric_limits<float>::quiet_NaN(),
                            1.0f / 3.0f};
  ProgramSlot slot = make_slot(5, 40, 3);
  for (int i = 0; i < 8; ++i) {
    slot.set_value(i, unusual[i]);
  }
  const std::vector<uint8_t> bytes = image_of(slot);
  ProgramSlot back;
  ASSERT_EQ(back.unserialize(bytes.data(), static_cast<int>(bytes.size())), 0);
  EXPECT_TRUE(same_slot(back, slot));
  EXPECT_EQ(image_of(back), bytes);
}

TEST(ProgramSlot, NamesUpTo63CharactersAreKeptLongerOnesCut) {
  for (size_t length : {size_t(0), size_t(1), size_t(62), size_t(63), size_t(64), size_t(100)}) {
    std::string name;
    for (size_t i = 0; i < length; ++i) name += static_cast<char>('a' + i % 26);
    ProgramSlot slot = make_slot(1);
    slot.set_name(name);
    const std::vector<uint8_t> bytes = image_of(slot);
    ASSERT_EQ(bytes.size(), 236u);
    // The field always ends in zeros after the stored name.
    for (size_t i = 12 + std::min<size_t>(length, 63); i < 76; ++i) EXPECT_EQ(bytes[i], 0) << length;
    ProgramSlot back;
    ASSERT_EQ(back.unserialize(bytes.data(), 236), 0);
    EXPECT_EQ(back.get_name(), name.substr(0, 63)) << length;
  }
}

TEST(ProgramSlot, ReadsRecordsWithOtherNameFieldSizes) {
  for (uint16_t field : {uint16_t(0), uint16_t(4), uint16_t(10), uint16_t(64), uint16_t(200)}) {
    ByteBuilder record;
    record.u32(42).u16(field).u16(2).u32(1).text("abcd", field).f32(0.25f).f32(0.75f).raw({77});
    ProgramSlot slot;
    ASSERT_EQ(slot.unserialize(record.bytes.data(), record.size()), 0) << field;
    EXPECT_EQ(slot.get_tag(), 42u);
    EXPECT_EQ(slot.get_name(), std::string("abcd").substr(0, field)) << field;
    ASSERT_EQ(slot.get_nbr_values(), 2);
    EXPECT_EQ(slot.get_value(0), 0.25f);
    EXPECT_EQ(slot.get_value(1), 0.75f);
    ASSERT_EQ(slot.get_extra_size(), 1);
    EXPECT_EQ(slot.use_extra_data()[0], 77);
    // Written again, the record takes the standard field size.
    EXPECT_EQ(slot.get_serialized_size(), 76 + 8 + 1);
  }
}

TEST(ProgramSlot, BytesAfterTheNameAndAfterTheRecordAreIgnored) {
  ByteBuilder record;
  record.u32(0).u16(16).u16(1).u32(0).text(std::string("ab\0junkjunk", 11), 16).f32(0.5f).raw({1, 2, 3});
  ProgramSlot slot;
  ASSERT_EQ(slot.unserialize(record.bytes.data(), record.size()), 0);
  EXPECT_EQ(slot.get_name(), "ab");
  EXPECT_EQ(slot.get_extra_size(), 0);
  EXPECT_EQ(slot.get_value(0), 0.5f);
}

TEST(ProgramSlot, RefusesRecordsThatReachPastTheBlock) {
  const ProgramSlot original = make_slot(9, 4, 2);
  const std::vector<uint8_t> before = image_of(original);

  ByteBuilder good;
  good.u32(1).u16(8).u16(2).u32(3).text("name", 8).f32(0.1f).f32(0.2f).raw({1, 2, 3});
  // Every cut of a valid record is refused and leaves the slot as it was.
  for (int size = 0; size < good.size(); ++size) {
    ProgramSlot slot = original;
    EXPECT_NE(slot.unserialize(good.bytes.data(), size), 0) << size;
    EXPECT_EQ(image_of(slot), before) << size;
  }
  ProgramSlot slot = original;
  EXPECT_EQ(slot.unserialize(good.bytes.data(), good.size()), 0);

  struct Bad {
    uint16_t field, values;
    uint32_t extra;
  };
  const Bad bad[] = {{200, 0, 0}, {0, 40, 0}, {0, 0, 100}, {0, 0, 0xFFFFFFFFu}, {0xFFFF, 0xFFFF, 0xFFFFFFF0u}};
  for (const Bad& b : bad) {
    ByteBuilder record;
    record.u32(5).u16(b.field).u16(b.values).u32(b.extra).text("", 40);
    ProgramSlot target = original;
    EXPECT_NE(target.unserialize(record.bytes.data(), record.size()), 0) << b.field << " " << b.values;
    EXPECT_EQ(image_of(target), before);
  }
  ProgramSlot target = original;
  EXPECT_NE(target.unserialize(nullptr, 100), 0);
  EXPECT_EQ(image_of(target), before);
}

TEST(ProgramSlot, WriterRefusesMoreValuesThanTheRecordCounts) {
  ProgramSlot slot;
  slot.set_nbr_values(70000);
  std::vector<uint8_t> block(static_cast<size_t>(slot.get_serialized_size()));
  EXPECT_NE(slot.serialize(block.data()), 0);
}
