// Instances made and destroyed: many in a row, several alive (and processing)
// at once, and the refusal of a host that gives no version.
#include <cstring>
#include <exception>
#include <memory>
#include <string>
#include <vector>

#include "cli/dynamic_module_interface.h"
#include "cli/validate/check_groups.h"
#include "cli/validate/plugin_driver.h"
#include "cli/validate/test_signal.h"
#include "cli/validate/worker_threads.h"

namespace plugcore {
namespace {

constexpr int kBlock = 512;
constexpr double kRate = 44100.0;

using EntryFunction = AEffect*(VST2_CALL*)(Vst2HostCallback);

// A host too old to say which version it speaks: every question answers 0.
intptr_t VST2_CALL versionless_host(AEffect*, int32_t, int32_t, intptr_t, void*, float) {
  return 0;
}

void feed_blocks(PluginDriver& driver, int blocks, long& position) {
  for (int block = 0; block < blocks; ++block) {
    for (int channel = 0; channel < 2; ++channel) {
      fill_test_signal(driver.input(channel), kBlock, channel, position, kRate);
    }
    driver.process(kBlock, ProcessMode::replacing);
    position += kBlock;
  }
}

void check_sequence(const ValidateOptions& options, CheckRecorder& recorder) {
  const char* name = "lifecycle.sequence";
  const int count = scaled_count(options, 100);
  for (int i = 0; i < count; ++i) {
    PluginDriver driver(options.plugin_path, kRate, kBlock);
    long position = 0;
    feed_blocks(driver, 2, position);
    const std::string problem = driver.check_outputs(kBlock, db_to_amplitude(80.0));
    if (!problem.empty()) {
      recorder.fail(name, "instance " + std::to_string(i + 1) + ": " + problem);
      return;
    }
  }
  recorder.pass(name, std::to_string(count) + " instances opened, run and closed one after another");
}

void check_parallel(const ValidateOptions& options, CheckRecorder& recorder) {
  const char* name = "lifecycle.parallel";
  constexpr int kInstances = 8;
  std::vector<std::unique_ptr<PluginDriver>> drivers;
  for (int i = 0; i < kInstances; ++i) {
    drivers.push_back(std::make_unique<PluginDriver>(options.plugin_path, kRate, kBlock));
  }
  // Each instance renders the same input on its own thread; instances that
  // share state would disagree.
  const auto input = fixed_input(kBlock * scaled_count(options, 16), kRate);
  std::vector<std::vector<std::vector<float>>> outputs(kInstances);
  std::vector<std::function<void()>> jobs;
  for (int i = 0; i < kInstances; ++i) {
    jobs.push_back([&, i] {
      outputs[static_cast<size_t>(i)] = render_blocks(*drivers[static_cast<size_t>(i)], input, kBlock,
                                                      ProcessMode::replacing);
    });
  }
  sys::run_in_parallel(jobs);
  for (int i = 1; i < kInstances; ++i) {
    const std::string difference = first_difference(outputs[0], outputs[static_cast<size_t>(i)]);
    if (!difference.empty()) {
      recorder.fail(name, "instance " + std::to_string(i + 1) +
                              " processing beside the others differs from instance 1: " + difference);
      return;
    }
  }
  drivers.clear();
  recorder.pass(name, std::to_string(kInstances) +
                          " instances alive and processing at once on their own threads agree");
}

void check_versionless_host(const ValidateOptions& options, CheckRecorder& recorder) {
  const char* name = "lifecycle.host_version_0";
  std::string error;
  auto module = sys::open_dynamic_module(options.plugin_path, error);
  if (!module) {
    recorder.fail(name, "cannot load: " + error);
    return;
  }
  void* entry = module->find_symbol("VSTPluginMain");
  if (entry == nullptr) entry = module->find_symbol("main");
  if (entry == nullptr) {
    recorder.fail(name, "exports neither VSTPluginMain nor main");
    return;
  }
  AEffect* effect = reinterpret_cast<EntryFunction>(entry)(versionless_host);
  if (effect == nullptr) {
    recorder.pass(name, "entry gave null to a host whose version query answers 0");
    return;
  }
  if (effect->magic == kVstMagic && effect->dispatcher != nullptr) {
    effect->dispatcher(effect, effClose, 0, 0, nullptr, 0.0f);
  }
  recorder.fail(name, "entry returned an instance to a host whose version query answers 0");
}

}  // namespace

void run_lifecycle_checks(const ValidateOptions& options, CheckRecorder& recorder) {
  guarded(recorder, "lifecycle.sequence", [&] { check_sequence(options, recorder); });
  guarded(recorder, "lifecycle.parallel", [&] { check_parallel(options, recorder); });
  guarded(recorder, "lifecycle.host_version_0", [&] { check_versionless_host(options, recorder); });
}

}  // namespace plugcore
