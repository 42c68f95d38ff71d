#include <gtest/gtest.h>

#include <stdexcept>
#include <thread>
#include <vector>

#include "params/param_priority.h"

using plugcore::ParamPriority;
using plugcore::ParamPriorityList;

namespace {

constexpr int kHost = 100;
constexpr int kMidi = 125;
constexpr int kPreset = 150;
constexpr int kMouse = 200;
constexpr int kGlide = 50;

}  // namespace

TEST(ParamPriority, StartsFreeAndAnyWriterGetsThrough) {
  ParamPriority record;
  EXPECT_EQ(record.get_priority(), 0);
  EXPECT_DOUBLE_EQ(record.get_hold(), 0.5);
  EXPECT_TRUE(record.test(0.0, kGlide));
  EXPECT_TRUE(record.take(0.0, kGlide));
  EXPECT_EQ(record.get_priority(), kGlide);
}

TEST(ParamPriority, SamePriorityWritesCloseTogetherBothSucceed) {
  ParamPriority record;
  EXPECT_TRUE(record.take(10.0, kHost));
  EXPECT_TRUE(record.take(10.1, kHost));
  EXPECT_DOUBLE_EQ(record.get_time(), 10.1);
}

TEST(ParamPriority, LowerWriterShutOutForHoldAfterHigherWrite) {
  ParamPriority record;
  ASSERT_TRUE(record.take(20.0, kMouse));
  EXPECT_FALSE(record.test(20.3, kHost));
  EXPECT_FALSE(record.take(20.3, kHost));
  // The refused take changed nothing.
  EXPECT_EQ(record.get_priority(), kMouse);
  EXPECT_DOUBLE_EQ(record.get_time(), 20.0);
  // The boundary itself is still held; just after it the lower writer wins.
  EXPECT_FALSE(record.test(20.5, kHost));
  EXPECT_TRUE(record.take(20.6, kHost));
  EXPECT_EQ(record.get_priority(), kHost);
  EXPECT_DOUBLE_EQ(record.get_time(), 20.6);
}

TEST(ParamPriority, HigherOrEqualWriterAlwaysGetsThroughAndRefreshesTime) {
  ParamPriority record;
  ASSERT_TRUE(record.take(1.0, kMidi));
  EXPECT_TRUE(record.take(1.1, kPreset));
  EXPECT_TRUE(record.take(1.2, kPreset));  // ties go to the newcomer
  EXPECT_DOUBLE_EQ(record.get_time(), 1.2);
  // The refreshed time restarts the hold for lower writers.
  EXPECT_FALSE(record.take(1.65, kMidi));
  EXPECT_TRUE(record.take(1.75, kMidi));
}

TEST(ParamPriority, ReleaseOnlyByTheHolder) {
  ParamPriority record;
  ASSERT_TRUE(record.take(5.0, kMouse));
  record.release(kHost);
  EXPECT_EQ(record.get_priority(), kMouse);
  EXPECT_FALSE(record.test(5.1, kHost));
  record.release(kMouse);
  EXPECT_EQ(record.get_priority(), 0);
  EXPECT_TRUE(record.take(5.1, kHost));
}

TEST(ParamPriority, GlideAfterMouseIsRefusedUntilHoldThenMouseReleases) {
  ParamPriority record;
  ASSERT_TRUE(record.take(0.0, kMouse));
  EXPECT_FALSE(record.take(0.03, kGlide));
  record.release(kMouse);
  EXPECT_TRUE(record.take(0.06, kGlide));
}

TEST(ParamPriority, CopyKeepsTheState) {
  ParamPriority record;
  ASSERT_TRUE(record.take(3.0, kPreset));
  ParamPriority copy(record);
  EXPECT_EQ(copy.get_priority(), kPreset);
  EXPECT_DOUBLE_EQ(copy.get_time(), 3.0);
  EXPECT_FALSE(copy.test(3.2, kHost));
}

TEST(ParamPriorityList, ResizeGivesFreeRecordsAndChecksIndex) {
  ParamPriorityList list;
  EXPECT_EQ(list.size(), 0);
  list.resize(40);
  ASSERT_EQ(list.size(), 40);
  ASSERT_TRUE(list.use(7).take(1.0, kMouse));
  EXPECT_FALSE(list.use(7).test(1.1, kHost));
  EXPECT_TRUE(list.use(8).test(1.1, kHost));  // records are independent
  list.resize(41);
  EXPECT_EQ(list.use(7).get_priority(), kMouse);  // growing keeps existing records
  EXPECT_EQ(list.use(40).get_priority(), 0);
  EXPECT_THROW(list.use(41), std::runtime_error);
  EXPECT_THROW(list.use(-1), std::runtime_error);
}

TEST(ParamPriority, ConcurrentWritersLeaveAConsistentHolder) {
  // Writers of two priorities race on one record; afterwards the holder is
  // one of them and a release by the holder frees it.
  ParamPriority record;
  std::vector<std::thread> threads;
  for (int t = 0; t < 4; ++t) {
    threads.emplace_back([&record, t] {
      const int p = (t % 2 == 0) ? kHost : kMouse;
      for (int i = 0; i < 2000; ++i) {
        record.take(i * 0.001, p);
        if (i % 7 == 0) {
          record.release(p);
        }
      }
    });
  }
  for (std::thread& thread : threads) {
    thread.join();
  }
  const int holder = record.get_priority();
  EXPECT_TRUE(holder == 0 || holder == kHost || holder == kMouse);
  record.release(holder);
  EXPECT_EQ(record.get_priority(), 0);
}
