// The guard bytes around host buffers: what counts as an overrun and as an
// unterminated text.
#include <gtest/gtest.h>

#include <cstring>

#include "cli/validate/guarded_buffer.h"

namespace {

using plugcore::GuardedBuffer;

TEST(GuardedBuffer, TerminatedTextWithinCapacityIsFine) {
  GuardedBuffer buffer(24);
  std::strcpy(buffer.text(), "23 characters long text");  // 23 + terminator = 24
  EXPECT_EQ(buffer.text_problem(), "");
}

TEST(GuardedBuffer, UntouchedBufferIsFineButFullUnterminatedIsNot) {
  GuardedBuffer untouched(24);
  EXPECT_TRUE(untouched.untouched());
  EXPECT_EQ(untouched.text_problem(), "");

  GuardedBuffer full(24);
  std::memset(full.text(), 'x', 24);  // fills the capacity exactly, no terminator
  EXPECT_NE(full.text_problem().find("not terminated"), std::string::npos);
}

TEST(GuardedBuffer, AnyByteBeyondCapacityIsAnOverrun) {
  GuardedBuffer buffer(24);
  std::strcpy(buffer.text(), "24 characters long text!");  // terminator lands on byte 24
  EXPECT_NE(buffer.overrun().find("byte 24"), std::string::npos);
  EXPECT_NE(buffer.text_problem(), "");

  GuardedBuffer far(8);
  far.text()[8 + GuardedBuffer::kGuard - 1] = 0;
  EXPECT_NE(far.overrun(), "");
}

TEST(GuardedBuffer, ZeroedStructureFields) {
  GuardedBuffer buffer(64, true);
  EXPECT_TRUE(buffer.untouched());
  std::memset(buffer.text() + 8, 'y', 16);
  EXPECT_FALSE(buffer.untouched());
  EXPECT_NE(buffer.field_problem(8, 16, "label"), "");
  EXPECT_EQ(buffer.field_problem(8, 17, "label"), "");  // byte 24 is still zero
  EXPECT_EQ(buffer.overrun(), "");
}

}  // namespace
