// Real-time safety: the audio entries called with everything a host varies
// between blocks (parameters, programs, block sizes) while the calls they
// make are counted. Any allocation, lock or blocking system call fails.
#include <string>

#include "cli/validate/call_probe.h"
#include "cli/validate/check_groups.h"
#include "cli/validate/plugin_driver.h"
#include "cli/validate/test_signal.h"

namespace plugcore {
namespace {

constexpr double kRate = 48000.0;
constexpr int kMaxBlock = 4096;

void check_audio_path(const ValidateOptions& options, CheckRecorder& recorder, ProcessMode mode) {
  const std::string name = mode == ProcessMode::replacing ? "realtime.process_replacing"
                                                          : "realtime.process";
  const std::string missing = sys::call_probe_missing();
  if (!missing.empty()) {
    recorder.skip(name, missing);
    return;
  }
  PluginDriver driver(options.plugin_path, kRate, kMaxBlock);
  if (!driver.plugin().supports(mode)) {
    recorder.skip(name, "the plug-in has no such entry");
    return;
  }
  BatteryRandom random(options.seed + 29);
  sys::AudioCallTally total;
  long position = 0;
  const int blocks = scaled_count(options, 200);
  std::string first;
  for (int block = 0; block < blocks; ++block) {
    if (block % 10 == 0) driver.randomize_parameters(random);
    if (block % 25 == 5 && driver.plugin().num_programs() > 0) {
      driver.plugin().set_program(block % driver.plugin().num_programs());
    }
    if (block % 50 == 49) driver.restart();
    const int frames = 1 + static_cast<int>(random() % kMaxBlock);
    for (int channel = 0; channel < 2; ++channel) {
      fill_test_signal(driver.input(channel), frames, channel, position, kRate);
    }
    sys::call_probe_arm();
    driver.process(frames, mode);
    const sys::AudioCallTally tally = sys::call_probe_disarm();
    position += frames;
    if (tally.total() > 0 && first.empty()) first = "first in block " + std::to_string(block);
    total.allocations += tally.allocations;
    total.frees += tally.frees;
    total.locks += tally.locks;
    total.system_calls += tally.system_calls;
  }
  const std::string counts = std::to_string(total.allocations) + " allocations, " +
                             std::to_string(total.frees) + " frees, " + std::to_string(total.locks) +
                             " locks, " + std::to_string(total.system_calls) + " system calls";
  if (total.total() > 0) {
    recorder.fail(name, counts + " in " + std::to_string(blocks) + " blocks (" + first + ")");
  } else {
    recorder.pass(name, counts + " in " + std::to_string(blocks) + " blocks with parameter and program changes between them");
  }
}

}  // namespace

void run_realtime_checks(const ValidateOptions& options, CheckRecorder& recorder) {
  guarded(recorder, "realtime.process_replacing",
          [&] { check_audio_path(options, recorder, ProcessMode::replacing); });
  guarded(recorder, "realtime.process", [&] { check_audio_path(options, recorder, ProcessMode::adding); });
}

}  // namespace plugcore
