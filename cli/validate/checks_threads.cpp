// One instance met by several threads at once, as hosts do: audio on one,
// automation on another, the user interface reading values and texts (and
// switching programs) on a third. Run under a race detector these checks
// show unsynchronised sharing; on their own they show wrong answers.
#include <atomic>
#include <cmath>
#include <string>
#include <vector>

#include "cli/validate/check_groups.h"
#include "cli/validate/guarded_buffer.h"
#include "cli/validate/plugin_driver.h"
#include "cli/validate/test_signal.h"
#include "cli/validate/worker_threads.h"

namespace plugcore {
namespace {

constexpr double kRate = 48000.0;
constexpr int kBlock = 256;

// Written by one thread each, read after all have joined.
struct ThreadFindings {
  std::string audio;
  std::string automation;
  std::string reader;
  long blocks = 0;
  std::atomic<long> writes{0};
  std::atomic<long> reads{0};
};

// The audio thread keeps going until the others have each done some work,
// however the threads get scheduled, so the threads really meet.
bool others_have_run(const ThreadFindings& found) {
  return found.writes.load() >= 2 && found.reads.load() >= 2;
}

void audio_job(PluginDriver& driver, int blocks, std::atomic<bool>& done, ThreadFindings& found) {
  const float bound = db_to_amplitude(80.0);
  long position = 0;
  constexpr int kMostBlocks = 1000000;
  for (int block = 0; block < kMostBlocks && (block < blocks || !others_have_run(found)); ++block) {
    for (int channel = 0; channel < 2; ++channel) {
      fill_test_signal(driver.input(channel), kBlock, channel, position, kRate);
    }
    driver.process(kBlock, ProcessMode::replacing);
    position += kBlock;
    ++found.blocks;
    const std::string problem = driver.check_outputs(kBlock, bound);
    if (!problem.empty() && found.audio.empty()) {
      found.audio = "block " + std::to_string(block) + ": " + problem;
    }
  }
  done.store(true);
}

void automation_job(AEffect* effect, uint32_t seed, std::atomic<bool>& done, ThreadFindings& found) {
  BatteryRandom random(seed);
  while (!done.load()) {
    for (int index = 0; index < effect->numParams; ++index) {
      effect->setParameter(effect, index, static_cast<float>(random() % 10001u) / 10000.0f);
    }
    ++found.writes;
  }
}

std::string read_texts(AEffect* effect, int index) {
  for (int32_t opcode : {effGetParamName, effGetParamLabel, effGetParamDisplay}) {
    GuardedBuffer buffer(24);
    effect->dispatcher(effect, opcode, index, 0, buffer.data(), 0.0f);
    const std::string problem = buffer.text_problem();
    if (!problem.empty()) {
      return "opcode " + std::to_string(opcode) + " parameter " + std::to_string(index) + ": " + problem;
    }
  }
  return "";
}

void reader_job(AEffect* effect, std::atomic<bool>& done, ThreadFindings& found) {
  while (!done.load()) {
    for (int index = 0; index < effect->numParams; ++index) {
      const float value = effect->getParameter(effect, index);
      if (!(value >= 0.0f && value <= 1.0f) && found.reader.empty()) {
        found.reader = "getParameter(" + std::to_string(index) + ") gave " + std::to_string(value) +
                       " while automation ran";
      }
      const std::string problem = read_texts(effect, index);
      if (!problem.empty() && found.reader.empty()) found.reader = problem;
    }
    ++found.reads;
  }
}

void program_job(AEffect* effect, uint32_t seed, std::atomic<bool>& done, ThreadFindings& found) {
  BatteryRandom random(seed);
  while (!done.load()) {
    if (effect->numPrograms > 0) {
      const int program = static_cast<int>(random() % static_cast<uint32_t>(effect->numPrograms));
      effect->dispatcher(effect, effSetProgram, 0, program, nullptr, 0.0f);
      GuardedBuffer name(24);
      effect->dispatcher(effect, effGetProgramName, 0, 0, name.data(), 0.0f);
      const std::string problem = name.text_problem();
      if (!problem.empty() && found.automation.empty()) found.automation = "program name: " + problem;
    }
    ++found.writes;
  }
}

std::string findings_problem(const ThreadFindings& found) {
  if (!found.audio.empty()) return "audio thread: " + found.audio;
  if (!found.automation.empty()) return "writing thread: " + found.automation;
  if (!found.reader.empty()) return "reading thread: " + found.reader;
  return "";
}

void check_automation(const ValidateOptions& options, CheckRecorder& recorder) {
  const char* name = "threads.automation";
  PluginDriver driver(options.plugin_path, kRate, kBlock);
  AEffect* effect = driver.plugin().effect();
  std::atomic<bool> done(false);
  ThreadFindings found;
  const int blocks = scaled_count(options, 400);
  sys::run_in_parallel({[&] { audio_job(driver, blocks, done, found); },
                        [&] { automation_job(effect, options.seed, done, found); },
                        [&] { reader_job(effect, done, found); }});
  recorder.verdict(name, findings_problem(found),
                   std::to_string(found.blocks) + " blocks processed while " +
                       std::to_string(found.writes.load()) + " rounds of writes to every parameter and " +
                       std::to_string(found.reads.load()) + " rounds reading every value and text ran beside");
}

void check_program_switching(const ValidateOptions& options, CheckRecorder& recorder) {
  const char* name = "threads.program_switch";
  PluginDriver driver(options.plugin_path, kRate, kBlock);
  AEffect* effect = driver.plugin().effect();
  if (effect->numPrograms < 2) {
    recorder.skip(name, "fewer than two programs");
    return;
  }
  std::atomic<bool> done(false);
  ThreadFindings found;
  const int blocks = scaled_count(options, 300);
  sys::run_in_parallel({[&] { audio_job(driver, blocks, done, found); },
                        [&] { program_job(effect, options.seed + 1, done, found); },
                        [&] { reader_job(effect, done, found); }});
  recorder.verdict(name, findings_problem(found),
                   std::to_string(found.blocks) + " blocks processed while programs were switched " +
                       std::to_string(found.writes.load()) + " times from another thread");
}

}  // namespace

void run_thread_checks(const ValidateOptions& options, CheckRecorder& recorder) {
  guarded(recorder, "threads.automation", [&] { check_automation(options, recorder); });
  guarded(recorder, "threads.program_switch", [&] { check_program_switching(options, recorder); });
}

}  // namespace plugcore
