// The plug-in's audio entry points, run over many block sizes, programs and
// settings, must not allocate, lock or make a blocking system call. The
// counter is armed only around processReplacing / process; everything the
// harness does to set up a case happens unarmed.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <memory>
#include <string>
#include <vector>

#include "realtime/call_counter.h"
#include "realtime/quiet_host.h"

namespace {

constexpr float kSampleRate = 48000.0f;
constexpr int kMaxBlock = 4096;
constexpr int kBlockSizes[] = {1, 255, 256, 257, 4096};
constexpr size_t kSignalFrames = 3 * kMaxBlock + 1000;

enum class Entry { replacing, adding };

// One named group of parameter writes applied on top of a program.
struct Setting {
  const char* parameter;
  double normalized;
};

struct Configuration {
  const char* name;
  std::vector<Setting> settings;
  bool vary_curves;  // give each band a different distortion curve per program
};

// Normalised values from the parameters' own mappings.
double split_norm(double hertz) { return std::log2(hertz / 20.0) / 10.0; }

const std::vector<Configuration>& configurations() {
  static const std::vector<Configuration> list = {
      {"as programmed", {}, false},
      {"oversampling", {{"Oversampling", 1.0}}, false},
      {"feedback", {{"Fdbk Amnt", 0.5}, {"Fdbk Freq", 0.4}}, false},
      {"tone", {{"Tone Shape", 0.8}, {"Tone Freq", 0.3}}, false},
      {"stereo boost", {{"Stereo Boost", 1.0}, {"Stereo Phase", 0.6}}, false},
      {"four bands",
       {{"B1 Upper Freq", split_norm(200.0)},
        {"B2 Upper Freq", split_norm(1000.0)},
        {"B3 Upper Freq", split_norm(5000.0)}},
       true},
      {"everything",
       {{"Oversampling", 1.0},
        {"Fdbk Amnt", 0.5},
        {"Tone Shape", 0.8},
        {"Stereo Boost", 1.0},
        {"Stereo Phase", 0.6},
        {"B1 Upper Freq", split_norm(200.0)},
        {"B2 Upper Freq", split_norm(1000.0)},
        {"B3 Upper Freq", split_norm(5000.0)},
        {"B1 Dist Amnt", 0.7},
        {"B4 Dist Amnt", 0.9}},
       true},
  };
  return list;
}

// Two channels of a sine pair with noise from a fixed-seed generator.
std::vector<std::vector<float>> test_signal() {
  std::vector<std::vector<float>> channels(2, std::vector<float>(kSignalFrames));
  uint32_t state = 12345u;
  for (size_t i = 0; i < kSignalFrames; ++i) {
    state = state * 1664525u + 1013904223u;
    const double noise = (static_cast<double>(state >> 8) / 16777216.0 - 0.5) * 0.2;
    const double t = static_cast<double>(i) / kSampleRate;
    channels[0][i] = static_cast<float>(0.5 * std::sin(2.0 * M_PI * 110.0 * t) + noise);
    channels[1][i] = static_cast<float>(0.4 * std::sin(2.0 * M_PI * 1650.0 * t) - noise);
  }
  return channels;
}

class AudioPathTest : public ::testing::Test {
 protected:
  void SetUp() override {
    host_ = std::make_unique<plugcore::QuietHost>(BRAKMORPH_TEST_PLUGIN, kSampleRate, kMaxBlock);
    ASSERT_TRUE(host_->error().empty()) << host_->error();
    ASSERT_EQ(host_->effect()->numInputs, 2);
    ASSERT_EQ(host_->effect()->numOutputs, 2);
    ASSERT_NE(host_->effect()->processReplacing, nullptr);
    ASSERT_NE(host_->effect()->process, nullptr);
    signal_ = test_signal();
    outputs_.assign(2, std::vector<float>(kMaxBlock));
    host_->resume();
  }

  void TearDown() override { host_.reset(); }

  // Frames per case: enough blocks for a state to build up, a few thousand at least.
  static size_t frames_for(int block) {
    return std::max<size_t>(4 * static_cast<size_t>(block), 1024);
  }

  struct RunResult {
    sys::CallCounts counts;
    bool finite = true;
    double peak = 0.0;
  };

  // Runs frames frames in blocks of block through one entry, armed.
  RunResult run(Entry entry, int block, size_t frames) {
    AEffect* effect = host_->effect();
    float* outputs[2] = {outputs_[0].data(), outputs_[1].data()};
    float* inputs[2] = {nullptr, nullptr};
    RunResult result;
    size_t position = 0;
    double tempo = 100.0;
    for (size_t done = 0; done < frames; done += static_cast<size_t>(block)) {
      if (position + static_cast<size_t>(block) > kSignalFrames) {
        position = 0;
      }
      inputs[0] = signal_[0].data() + position;
      inputs[1] = signal_[1].data() + position;
      std::memset(outputs[0], 0, sizeof(float) * static_cast<size_t>(block));
      std::memset(outputs[1], 0, sizeof(float) * static_cast<size_t>(block));
      // A moving tempo makes the plug-in forward it inside the armed span.
      tempo += 0.25;
      plugcore::QuietHost::set_tempo(tempo);
      sys::arm_call_counter();
      if (entry == Entry::replacing) {
        effect->processReplacing(effect, inputs, outputs, block);
      } else {
        effect->process(effect, inputs, outputs, block);
      }
      const sys::CallCounts counts = sys::disarm_call_counter();
      add(result.counts, counts);
      for (int channel = 0; channel < 2; ++channel) {
        for (int i = 0; i < block; ++i) {
          const float value = outputs[channel][i];
          if (!std::isfinite(value)) {
            result.finite = false;
          } else {
            result.peak = std::max(result.peak, std::fabs(static_cast<double>(value)));
          }
        }
      }
      position += static_cast<size_t>(block);
    }
    return result;
  }

  static void add(sys::CallCounts& sum, const sys::CallCounts& more) {
    sum.operator_new += more.operator_new;
    sum.operator_delete += more.operator_delete;
    sum.c_alloc += more.c_alloc;
    sum.c_free += more.c_free;
    sum.mutex_lock += more.mutex_lock;
    sum.system_call += more.system_call;
  }

  void apply(const Configuration& configuration, int program) {
    for (const Setting& setting : configuration.settings) {
      const int index = host_->find_param(setting.parameter);
      ASSERT_GE(index, 0) << "no parameter named " << setting.parameter;
      host_->effect()->setParameter(host_->effect(), index,
                                    static_cast<float>(setting.normalized));
    }
    if (configuration.vary_curves) {
      for (int band = 0; band < 4; ++band) {
        const std::string name = "B" + std::to_string(band + 1) + " Dist Type";
        const int index = host_->find_param(name);
        ASSERT_GE(index, 0) << "no parameter named " << name;
        const int curve = (program * 4 + band) % 13;  // all 13 curves over the programs
        host_->effect()->setParameter(host_->effect(), index, static_cast<float>(curve / 12.0));
      }
    }
  }

  std::unique_ptr<plugcore::QuietHost> host_;
  std::vector<std::vector<float>> signal_;
  std::vector<std::vector<float>> outputs_;
};

TEST_F(AudioPathTest, CounterSeesThePluginsOwnAllocations) {
  // A fresh resume drops the chunk buffer, so the next chunk must be built
  // on the heap: if this is not counted, the plug-in's allocator calls do not
  // reach the counter and every zero below would mean nothing.
  host_->suspend();
  host_->resume();
  void* chunk = nullptr;
  sys::arm_call_counter();
  const intptr_t size = host_->dispatch(effGetChunk, 0, 0, &chunk);
  const sys::CallCounts counts = sys::disarm_call_counter();
  ASSERT_GT(size, 0);
  ASSERT_NE(chunk, nullptr);
  EXPECT_GT(counts.allocations(), 0) << sys::describe_calls(counts);
}

TEST_F(AudioPathTest, NoAllocationLockOrSystemCallInAnyProgramOrSetting) {
  const int programs = host_->effect()->numPrograms;
  ASSERT_GT(programs, 0);
  plugcore::QuietHost::reset_callback_counts();
  sys::CallCounts total;
  std::vector<std::string> faults;
  long cases = 0;
  for (int program = 0; program < programs; ++program) {
    for (const Configuration& configuration : configurations()) {
      // Unarmed: select the program (which restores all its values), then the
      // extra settings; the next armed block recomputes what they changed.
      host_->dispatch(effSetProgram, 0, program);
      apply(configuration, program);
      if (HasFatalFailure()) {
        return;
      }
      double case_peak = 0.0;
      for (Entry entry : {Entry::replacing, Entry::adding}) {
        for (int block : kBlockSizes) {
          const RunResult result = run(entry, block, frames_for(block));
          ++cases;
          add(total, result.counts);
          case_peak = std::max(case_peak, result.peak);
          const std::string where = "program " + std::to_string(program) + ", " +
                                    configuration.name + ", block " + std::to_string(block) +
                                    (entry == Entry::replacing ? ", processReplacing" : ", process");
          if (result.counts.total() != 0 && faults.size() < 20) {
            faults.push_back(where + ": " + sys::describe_calls(result.counts));
          }
          EXPECT_TRUE(result.finite) << where << ": non-finite output";
        }
      }
      EXPECT_GT(case_peak, 1e-4) << "program " << program << ", " << configuration.name
                                 << ": silent output, the audio path did not run";
      // A reset requested between cases is carried out by the next armed block.
      host_->suspend();
      host_->resume();
    }
  }
  for (const std::string& fault : faults) {
    ADD_FAILURE() << fault;
  }
  EXPECT_EQ(total.total(), 0) << "over " << cases << " cases: " << sys::describe_calls(total);
  // The counted spans included the plug-in's calls back into the host.
  EXPECT_GT(plugcore::QuietHost::callback_count(audioMasterGetTime), 0);
}

TEST_F(AudioPathTest, SampleRateChangesKeepTheAudioPathQuiet) {
  const Configuration& everything = configurations().back();
  for (float rate : {44100.0f, 96000.0f, 192000.0f, 22050.0f}) {
    host_->suspend();
    host_->dispatch(effSetSampleRate, 0, 0, nullptr, rate);
    host_->resume();
    host_->dispatch(effSetProgram, 0, 3);
    apply(everything, 3);
    for (int block : {64, 4096}) {
      const RunResult result = run(Entry::replacing, block, 3 * kMaxBlock);
      EXPECT_EQ(result.counts.total(), 0)
          << "rate " << rate << ", block " << block << ": " << sys::describe_calls(result.counts);
      EXPECT_TRUE(result.finite) << "rate " << rate;
      EXPECT_GT(result.peak, 1e-4) << "rate " << rate;
    }
  }
}

TEST_F(AudioPathTest, ParameterChangesBetweenBlocksAreAppliedWithoutAllocating) {
  // Automation between every block: each armed block recomputes filters,
  // curves and the feedback line from freshly written values.
  AEffect* effect = host_->effect();
  const int params = effect->numParams;
  ASSERT_GT(params, 0);
  uint32_t state = 99u;
  sys::CallCounts total;
  for (int step = 0; step < 400; ++step) {
    for (int write = 0; write < 4; ++write) {
      state = state * 1664525u + 1013904223u;
      const int index = static_cast<int>(state % static_cast<uint32_t>(params));
      const float value = static_cast<float>((state >> 8) & 0xffff) / 65535.0f;
      effect->setParameter(effect, index, value);
    }
    const RunResult result = run(step % 2 == 0 ? Entry::replacing : Entry::adding, 257, 257);
    add(total, result.counts);
    ASSERT_TRUE(result.finite) << "step " << step;
  }
  EXPECT_EQ(total.total(), 0) << sys::describe_calls(total);
}

}  // namespace
