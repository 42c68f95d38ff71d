// Host state chunks, write arbitration, automation threshold and suspend/resume.
#include <gtest/gtest.h>

#include <cstring>
#include <random>
#include <vector>

#include "host/instance_factory.h"
#include "host/vst2_plugin.h"
#include "presets/bank_manager.h"
#include "support/mock_host.h"

namespace {

class PluginState : public ::testing::Test {
 protected:
  void SetUp() override {
    effect_ = plugcore::create_instance(&MockHost::callback);
    ASSERT_NE(effect_, nullptr);
    open_and_resume(effect_, 44100.0f, 512);
  }
  void TearDown() override { close_instance(effect_); }

  plugcore::Vst2Plugin& plugin() {
    return *dynamic_cast<plugcore::Vst2Plugin*>(static_cast<AudioEffect*>(effect_->object));
  }
  std::vector<float> all_params() {
    std::vector<float> v;
    for (int i = 0; i < 40; ++i) {
      v.push_back(effect_->getParameter(effect_, i));
    }
    return v;
  }
  std::vector<uint8_t> chunk(bool preset) {
    void* data = nullptr;
    const intptr_t size = dispatch(effect_, effGetChunk, preset ? 1 : 0, 0, &data);
    EXPECT_GT(size, 0);
    const uint8_t* bytes = static_cast<const uint8_t*>(data);
    return std::vector<uint8_t>(bytes, bytes + size);
  }
  intptr_t set_chunk(std::vector<uint8_t> bytes, bool preset) {
    return dispatch(effect_, effSetChunk, preset ? 1 : 0, static_cast<intptr_t>(bytes.size()), bytes.data());
  }

  MockHost host_;
  AEffect* effect_ = nullptr;
};

TEST_F(PluginState, BankChunkIsTheBankBlock) {
  const std::vector<uint8_t> bank = chunk(false);
  ASSERT_EQ(bank.size(), 1896u);  // 8 records of 236 bytes behind an 8-byte block header
  EXPECT_EQ(bank[3], 8);          // program count, big-endian
  EXPECT_EQ(bank[6] * 256 + bank[7], 236);
  const std::vector<uint8_t> program = chunk(true);
  EXPECT_EQ(program.size(), 236u);
}

TEST_F(PluginState, ChunkBufferIsReusedUntilSuspend) {
  void* first = nullptr;
  void* second = nullptr;
  dispatch(effect_, effGetChunk, 0, 0, &first);
  dispatch(effect_, effGetChunk, 0, 0, &second);
  EXPECT_EQ(first, second);
}

TEST_F(PluginState, BankChunkRoundTripRestoresEveryProgram) {
  dispatch(effect_, effSetProgram, 0, 5);
  effect_->setParameter(effect_, 2, 0.125f);
  const std::vector<uint8_t> saved = chunk(false);
  const std::vector<float> saved_params = all_params();

  effect_->setParameter(effect_, 2, 0.75f);
  dispatch(effect_, effSetProgram, 0, 1);
  effect_->setParameter(effect_, 12, 0.0f);

  dispatch(effect_, effSetProgram, 0, 5);
  ASSERT_EQ(set_chunk(saved, false), 1);
  EXPECT_EQ(all_params(), saved_params);
  EXPECT_EQ(chunk(false), saved);
}

TEST_F(PluginState, ProgramChunkChangesOnlyTheCurrentProgram) {
  dispatch(effect_, effSetProgram, 0, 2);
  const std::vector<uint8_t> program2 = chunk(true);
  dispatch(effect_, effSetProgram, 0, 4);
  const std::vector<uint8_t> bank_before = chunk(false);
  ASSERT_EQ(set_chunk(program2, true), 1);
  dispatch(effect_, effSetProgram, 0, 2);
  const std::vector<float> p2 = all_params();
  dispatch(effect_, effSetProgram, 0, 4);
  EXPECT_EQ(all_params(), p2);
  // Programs other than 4 are untouched.
  const std::vector<uint8_t> bank_after = chunk(false);
  ASSERT_EQ(bank_after.size(), bank_before.size());
  for (size_t i = 0; i < bank_after.size(); ++i) {
    const size_t record = i < 8 ? 99 : (i - 8) / 236;
    if (record != 4) {
      ASSERT_EQ(bank_after[i], bank_before[i]) << "byte " << i;
    }
  }
}

TEST_F(PluginState, BadChunksAreRefusedAndChangeNothing) {
  dispatch(effect_, effSetProgram, 0, 3);
  const std::vector<float> before = all_params();
  const std::vector<uint8_t> good_bank = chunk(false);
  const std::vector<uint8_t> good_program = chunk(true);

  // Truncated anywhere: the reader is bounded by the size the host hands over.
  for (size_t cut : {size_t(0), size_t(4), size_t(11), size_t(100), good_bank.size() - 1}) {
    std::vector<uint8_t> shortened(good_bank.begin(), good_bank.begin() + cut);
    shortened.resize(cut);
    EXPECT_EQ(set_chunk(shortened.empty() ? std::vector<uint8_t>{0} : shortened, false), 0) << cut;
  }
  for (size_t cut : {size_t(11), size_t(80), good_program.size() - 1}) {
    EXPECT_EQ(set_chunk(std::vector<uint8_t>(good_program.begin(), good_program.begin() + cut), true), 0) << cut;
  }
  // Counts that point past the data.
  std::vector<uint8_t> huge_count = good_bank;
  huge_count[0] = 0x7F;
  EXPECT_EQ(set_chunk(huge_count, false), 0);
  std::vector<uint8_t> seven_programs = good_bank;
  seven_programs[3] = 7;
  seven_programs.resize(8 + 7 * 236);
  EXPECT_EQ(set_chunk(seven_programs, false), 0);
  // A program of another value count would leave parameters undefined.
  std::vector<uint8_t> ten_values = good_program;
  ten_values[6] = 0;
  ten_values[7] = 10;
  EXPECT_EQ(set_chunk(ten_values, true), 0);

  std::mt19937 random(7);
  for (int round = 0; round < 200; ++round) {
    std::vector<uint8_t> noise(random() % 600 + 1);
    for (auto& b : noise) {
      b = static_cast<uint8_t>(random());
    }
    set_chunk(noise, round % 2 == 0);  // may be accepted only if well formed; must not crash
  }
  // Whatever noise was accepted must have been whole programs of 40 values; restore and compare.
  ASSERT_EQ(set_chunk(good_bank, false), 1);
  EXPECT_EQ(all_params(), before);
}

TEST_F(PluginState, HostWritesAreShutOutBehindFresherEditorWrites) {
  // An editor gesture (priority 200) holds the parameter for half a second.
  ASSERT_TRUE(plugin().set_param_automated(3, 0.5f, 200));
  ASSERT_EQ(host_.automations.size(), 1u);
  EXPECT_EQ(host_.automations[0].index, 3);
  EXPECT_FLOAT_EQ(host_.automations[0].value, 0.5f);
  effect_->setParameter(effect_, 3, 0.9f);  // host automation, priority 100: refused
  EXPECT_FLOAT_EQ(effect_->getParameter(effect_, 3), 0.5f);
  // Equal or higher priority always passes.
  EXPECT_TRUE(plugin().set_param(3, 0.7f, 200));
  EXPECT_FLOAT_EQ(effect_->getParameter(effect_, 3), 0.7f);
  // Another parameter is free.
  effect_->setParameter(effect_, 4, 0.3f);
  EXPECT_FLOAT_EQ(effect_->getParameter(effect_, 4), 0.3f);
  // Host writes among themselves always pass.
  effect_->setParameter(effect_, 4, 0.6f);
  EXPECT_FLOAT_EQ(effect_->getParameter(effect_, 4), 0.6f);
  // A released lock frees the parameter at once.
  plugin().release_param(3, 200);
  effect_->setParameter(effect_, 3, 0.1f);
  EXPECT_FLOAT_EQ(effect_->getParameter(effect_, 3), 0.1f);
}

TEST_F(PluginState, AcceptedWritesMirrorIntoTheCurrentProgram) {
  dispatch(effect_, effSetProgram, 0, 1);
  effect_->setParameter(effect_, 7, 0.5f);
  dispatch(effect_, effSetProgram, 0, 0);
  dispatch(effect_, effSetProgram, 0, 1);
  EXPECT_FLOAT_EQ(effect_->getParameter(effect_, 7), 0.5f);
}

TEST_F(PluginState, AutomationThresholdFollowsTheHostsCapacity) {
  // 38 parameters have priority 0, the two switches priority 1.
  host_.automatable = 38;
  dispatch(effect_, effMainsChanged, 0, 0);
  dispatch(effect_, effMainsChanged, 0, 1);
  EXPECT_EQ(dispatch(effect_, effCanBeAutomated, 0), 0);
  EXPECT_EQ(dispatch(effect_, effCanBeAutomated, 1), 0);
  EXPECT_EQ(dispatch(effect_, effCanBeAutomated, 2), 1);
  EXPECT_EQ(dispatch(effect_, effCanBeAutomated, 40), 1);
  host_.automatable = 40;
  dispatch(effect_, effMainsChanged, 0, 1);
  EXPECT_EQ(dispatch(effect_, effCanBeAutomated, 0), 1);
  // A host answering 0 keeps the last threshold.
  host_.automatable = 38;
  dispatch(effect_, effMainsChanged, 0, 1);
  host_.automatable = 0;
  dispatch(effect_, effMainsChanged, 0, 1);
  EXPECT_EQ(dispatch(effect_, effCanBeAutomated, 1), 0);
}

TEST_F(PluginState, ResumeAsksForMidiAndSuspendDropsTheChunk) {
  const int before = host_.want_midi_calls;
  dispatch(effect_, effMainsChanged, 0, 1);
  EXPECT_EQ(host_.want_midi_calls, before + 1);
  void* data = nullptr;
  EXPECT_GT(dispatch(effect_, effGetChunk, 0, 0, &data), 0);
  dispatch(effect_, effMainsChanged, 0, 0);
  EXPECT_GT(dispatch(effect_, effGetChunk, 0, 0, &data), 0);  // a fresh buffer after suspend
}

}  // namespace
