// Audio under every condition a host can create: sample rates from 8 kHz to
// 384 kHz, block sizes from 1 to 8192 changing from block to block, replacing
// and adding, one or two pins connected, any parameter values; and recovery
// from input that is not finite.
#include <algorithm>
#include <cmath>
#include <cstring>
#include <limits>
#include <string>
#include <vector>

#include "cli/validate/check_groups.h"
#include "cli/validate/plugin_driver.h"
#include "cli/validate/test_signal.h"

namespace plugcore {
namespace {

const double kRates[] = {8000, 22050, 44100, 48000, 96000, 192000, 384000};
const int kBlocks[] = {1, 2, 3, 64, 255, 256, 257, 1000, 4096, 8192};
constexpr int kMaxBlock = 8192;
constexpr double kBoundDb = 80.0;  // for input at 0 dBFS

struct Layout {
  int inputs;
  int outputs;
  const char* name;
};
const Layout kLayouts[] = {{2, 2, "stereo"}, {1, 1, "mono"}};

void fill_inputs(PluginDriver& driver, int frames, long position, double rate) {
  for (int channel = 0; channel < 2; ++channel) {
    fill_test_signal(driver.input(channel), frames, channel, position, rate);
  }
}

// One rate, both modes, both layouts; blocks of every size in a shuffled
// order with new random parameters before some of them.
std::string run_rate(const ValidateOptions& options, double rate, BatteryRandom& random, long& frames_done) {
  const float bound = db_to_amplitude(kBoundDb);
  PluginDriver driver(options.plugin_path, rate, kMaxBlock);
  for (const Layout& layout : kLayouts) {
    for (ProcessMode mode : {ProcessMode::replacing, ProcessMode::adding}) {
      if (!driver.plugin().supports(mode)) continue;
      const char* mode_name = mode == ProcessMode::replacing ? "replacing" : "adding";
      driver.reconfigure(rate, kMaxBlock, layout.inputs, layout.outputs);
      std::vector<int> blocks(std::begin(kBlocks), std::end(kBlocks));
      const int passes = scaled_count(options, 2);
      long position = 0;
      for (int pass = 0; pass < passes; ++pass) {
        std::shuffle(blocks.begin(), blocks.end(), random);
        for (int frames : blocks) {
          if (random() % 3 == 0) driver.randomize_parameters(random);
          fill_inputs(driver, frames, position, rate);
          if (mode == ProcessMode::adding) {
            for (int channel = 0; channel < driver.output_count(); ++channel) {
              std::memset(driver.output_for_writing(channel), 0, sizeof(float) * static_cast<size_t>(frames));
            }
          }
          driver.process(frames, mode);
          position += frames;
          const std::string problem = driver.check_outputs(frames, bound);
          if (!problem.empty()) {
            return std::to_string(static_cast<int>(rate)) + " Hz, " + layout.name + ", " + mode_name +
                   ", block of " + std::to_string(frames) + ": " + problem;
          }
        }
      }
      frames_done += position;
      // Announcing each block size on its own, the way hosts that change
      // their buffer do, then a block of exactly that size.
      for (int frames : kBlocks) {
        if (frames > 1000 && options.strictness < 8) continue;
        driver.reconfigure(rate, frames, layout.inputs, layout.outputs);
        fill_inputs(driver, frames, position, rate);
        if (mode == ProcessMode::adding) {
          for (int channel = 0; channel < driver.output_count(); ++channel) {
            std::memset(driver.output_for_writing(channel), 0, sizeof(float) * static_cast<size_t>(frames));
          }
        }
        driver.process(frames, mode);
        position += frames;
        const std::string problem = driver.check_outputs(frames, bound);
        if (!problem.empty()) {
          return std::to_string(static_cast<int>(rate)) + " Hz, " + layout.name + ", " + mode_name +
                 ", announced block size " + std::to_string(frames) + ": " + problem;
        }
      }
    }
  }
  return "";
}

void check_rates_and_blocks(const ValidateOptions& options, CheckRecorder& recorder) {
  BatteryRandom random(options.seed);
  for (double rate : kRates) {
    const std::string name = "audio.rate_" + std::to_string(static_cast<int>(rate));
    try {
      long frames = 0;
      const std::string problem = run_rate(options, rate, random, frames);
      recorder.verdict(name, problem,
                       std::to_string(frames) + " frames in blocks of 1..8192, replacing and adding, "
                       "mono and stereo, random parameters: finite and within +80 dBFS");
    } catch (const std::exception& error) {
      recorder.fail(name, error.what());
    }
  }
}

// The accumulating entry must add exactly what the replacing one writes.
void check_adding_matches_replacing(const ValidateOptions& options, CheckRecorder& recorder) {
  const char* name = "audio.adding_adds";
  constexpr double kRate = 48000.0;
  constexpr int kBlock = 300;
  PluginDriver replacing(options.plugin_path, kRate, kBlock);
  PluginDriver adding(options.plugin_path, kRate, kBlock);
  if (!replacing.plugin().supports(ProcessMode::replacing) ||
      !adding.plugin().supports(ProcessMode::adding)) {
    recorder.skip(name, "the plug-in offers only one of the two entries");
    return;
  }
  const float kOffset = 0.25f;
  double worst = 0.0;
  long position = 0;
  for (int block = 0; block < scaled_count(options, 20); ++block) {
    for (PluginDriver* driver : {&replacing, &adding}) fill_inputs(*driver, kBlock, position, kRate);
    for (int channel = 0; channel < adding.output_count(); ++channel) {
      std::fill(adding.output_for_writing(channel), adding.output_for_writing(channel) + kBlock, kOffset);
    }
    replacing.process(kBlock, ProcessMode::replacing);
    adding.process(kBlock, ProcessMode::adding);
    position += kBlock;
    for (int channel = 0; channel < replacing.connected_outputs(); ++channel) {
      for (int n = 0; n < kBlock; ++n) {
        const double expected = static_cast<double>(replacing.output(channel)[n]) + kOffset;
        const double error = std::fabs(adding.output(channel)[n] - expected);
        if (!(error <= 1e-5 * std::max(1.0, std::fabs(expected)))) {
          recorder.fail(name, "output " + std::to_string(channel) + " sample " + std::to_string(position - kBlock + n) +
                                  ": adding gave " + std::to_string(adding.output(channel)[n]) +
                                  " onto " + std::to_string(kOffset) + ", replacing wrote " +
                                  std::to_string(replacing.output(channel)[n]));
          return;
        }
        worst = std::max(worst, error);
      }
    }
  }
  recorder.pass(name, "process adds to the outputs what processReplacing writes (largest error " +
                          std::to_string(worst) + ")");
}

// A block of NaN, infinities or denormals, then ordinary input: the block
// after the bad one must already be finite.
void check_non_finite_recovery(const ValidateOptions& options, CheckRecorder& recorder) {
  const char* name = "audio.non_finite_recovery";
  constexpr double kRate = 44100.0;
  constexpr int kBlock = 512;
  struct Poison {
    const char* name;
    float value;
  };
  const Poison poisons[] = {{"NaN", std::numeric_limits<float>::quiet_NaN()},
                            {"+inf", std::numeric_limits<float>::infinity()},
                            {"-inf", -std::numeric_limits<float>::infinity()},
                            {"denormal", std::numeric_limits<float>::denorm_min() * 3.0f}};
  BatteryRandom random(options.seed + 7);
  PluginDriver driver(options.plugin_path, kRate, kBlock);
  const float bound = db_to_amplitude(kBoundDb);
  long position = 0;
  const int rounds = scaled_count(options, 3);
  for (int round = 0; round < rounds; ++round) {
    if (round > 0) driver.randomize_parameters(random);
    for (const Poison& poison : poisons) {
      for (bool whole_block : {false, true}) {
        fill_inputs(driver, kBlock, position, kRate);
        driver.process(kBlock, ProcessMode::replacing);
        position += kBlock;
        fill_inputs(driver, kBlock, position, kRate);
        for (int channel = 0; channel < 2; ++channel) {
          float* samples = driver.input(channel);
          if (whole_block) {
            std::fill(samples, samples + kBlock, poison.value);
          } else {
            samples[kBlock / 3] = poison.value;
          }
        }
        driver.process(kBlock, ProcessMode::replacing);
        position += kBlock;
        fill_inputs(driver, kBlock, position, kRate);
        driver.process(kBlock, ProcessMode::replacing);
        position += kBlock;
        const std::string problem = driver.check_outputs(kBlock, bound);
        if (!problem.empty()) {
          recorder.fail(name, std::string("the block after ") + (whole_block ? "a block of " : "one sample of ") +
                                  poison.name + ": " + problem);
          return;
        }
      }
    }
  }
  recorder.pass(name, "NaN, +inf, -inf and denormal input: the next block is finite and bounded");
}

}  // namespace

void run_audio_checks(const ValidateOptions& options, CheckRecorder& recorder) {
  check_rates_and_blocks(options, recorder);
  guarded(recorder, "audio.adding_adds", [&] { check_adding_matches_replacing(options, recorder); });
  guarded(recorder, "audio.non_finite_recovery", [&] { check_non_finite_recovery(options, recorder); });
}

}  // namespace plugcore
