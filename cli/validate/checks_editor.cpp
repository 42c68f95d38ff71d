// The editor the way hosts treat it: opened, idled and closed over and over
// in a real parent window while automation and audio run on other threads,
// and two instances' editors open at once. An editor must make its window
// inside the parent and take it away again on close. Skipped without a
// desktop or when the plug-in declares no editor.
#include <atomic>
#include <memory>
#include <random>
#include <string>

#include "cli/editor_parent.h"
#include "cli/validate/check_groups.h"
#include "cli/validate/editor_session.h"
#include "cli/validate/plugin_driver.h"
#include "cli/validate/test_signal.h"
#include "cli/validate/worker_threads.h"

namespace plugcore {
namespace {

constexpr double kRate = 48000.0;
constexpr int kBlock = 256;
constexpr int kCycles = 50;
constexpr int kIdlesPerCycle = 3;
constexpr int kIdlesTogether = 10;
constexpr const char* kCycleCheck = "editor open/idle/close cycles with automation and audio";
constexpr const char* kTwoCheck = "editor two at once";

// Empty when the editor is usable here, else the reason to skip.
std::string skip_reason(HostedPlugin& plugin) {
  const std::string desktop = editor_desktop_unavailable();
  if (!desktop.empty()) return desktop;
  if ((plugin.flags() & effFlagsHasEditor) == 0) return "the plug-in declares no editor";
  return "";
}

std::string size_text(const EditorSize& size) {
  return std::to_string(size.width) + "x" + std::to_string(size.height);
}

// One open, a few idles and the close, with the parent's children checked
// on the way; empty when all went right.
std::string one_cycle(HostedPlugin& plugin, EditorParentInterface& parent, const EditorSize& size) {
  {
    EditorSession editor(plugin, parent);
    for (int i = 0; i < kIdlesPerCycle; ++i) editor.idle();
    if (parent.child_count() < 1) return "the editor made no window in the parent";
    const EditorSize open_size = query_editor_size(plugin);
    if (open_size.width != size.width || open_size.height != size.height) {
      return "the size changed from " + size_text(size) + " to " + size_text(open_size) + " while open";
    }
  }
  const int left = parent.child_count();
  if (left != 0) return std::to_string(left) + " window(s) left in the parent after effEditClose";
  return "";
}

void check_cycles(const ValidateOptions& options, CheckRecorder& recorder) {
  PluginDriver driver(options.plugin_path, kRate, kBlock);
  HostedPlugin& plugin = driver.plugin();
  const std::string skip = skip_reason(plugin);
  if (!skip.empty()) {
    recorder.skip(kCycleCheck, skip);
    return;
  }
  const EditorSize size = query_editor_size(plugin);
  const int cycles = scaled_count(options, kCycles);

  std::atomic<bool> done{false};
  std::string ui_failure;
  std::string audio_failure;
  long automation_writes = 0;
  long blocks = 0;
  AEffect* effect = plugin.effect();
  // The parent belongs to the thread that opens the editor in it: on Windows
  // a child window made by another thread waits for the parent's thread to
  // answer its messages.
  auto ui = [&] {
    try {
      std::unique_ptr<EditorParentInterface> parent = create_editor_parent(size.width, size.height, "validate");
      for (int cycle = 0; cycle < cycles && ui_failure.empty(); ++cycle) {
        const std::string problem = one_cycle(plugin, *parent, size);
        if (!problem.empty()) ui_failure = "cycle " + std::to_string(cycle + 1) + ": " + problem;
      }
    } catch (const std::exception& error) {
      ui_failure = error.what();
    }
    done.store(true);
  };
  auto automation = [&] {
    BatteryRandom random(options.seed);
    std::uniform_real_distribution<float> value(0.0f, 1.0f);
    while (!done.load()) {
      for (int index = 0; index < effect->numParams; ++index) {
        effect->setParameter(effect, index, value(random));
        ++automation_writes;
      }
    }
  };
  auto audio = [&] {
    const float bound = db_to_amplitude(80.0);
    long position = 0;
    while (!done.load() && audio_failure.empty()) {
      for (int channel = 0; channel < 2; ++channel) {
        fill_test_signal(driver.input(channel), kBlock, channel, position, kRate);
      }
      driver.process(kBlock, ProcessMode::replacing);
      position += kBlock;
      ++blocks;
      const std::string problem = driver.check_outputs(kBlock, bound);
      if (!problem.empty()) audio_failure = "block " + std::to_string(blocks) + ": " + problem;
    }
  };
  sys::run_in_parallel({ui, automation, audio});
  std::string failure = ui_failure;
  if (failure.empty() && !audio_failure.empty()) failure = "audio during the cycles: " + audio_failure;
  recorder.verdict(kCycleCheck, failure,
                   std::to_string(cycles) + " cycles in a " + size_text(size) + " parent, " +
                       std::to_string(automation_writes) + " automation writes and " +
                       std::to_string(blocks) + " blocks meanwhile");
}

void check_two_at_once(const ValidateOptions& options, CheckRecorder& recorder) {
  PluginDriver first(options.plugin_path, kRate, kBlock);
  const std::string skip = skip_reason(first.plugin());
  if (!skip.empty()) {
    recorder.skip(kTwoCheck, skip);
    return;
  }
  PluginDriver second(options.plugin_path, kRate, kBlock);
  HostedPlugin* plugins[2] = {&first.plugin(), &second.plugin()};
  std::unique_ptr<EditorParentInterface> parents[2];
  for (int i = 0; i < 2; ++i) {
    const EditorSize size = query_editor_size(*plugins[i]);
    parents[i] = create_editor_parent(size.width, size.height, "validate " + std::to_string(i + 1));
  }
  std::string failure;
  {
    EditorSession one(*plugins[0], *parents[0]);
    EditorSession two(*plugins[1], *parents[1]);
    for (int i = 0; i < kIdlesTogether; ++i) {
      one.idle();
      two.idle();
    }
    for (int i = 0; i < 2 && failure.empty(); ++i) {
      if (parents[i]->child_count() < 1) failure = "editor " + std::to_string(i + 1) + " made no window";
    }
  }
  for (int i = 0; i < 2 && failure.empty(); ++i) {
    if (parents[i]->child_count() != 0) {
      failure = "editor " + std::to_string(i + 1) + " left its window after effEditClose";
    }
  }
  recorder.verdict(kTwoCheck, failure, "both open in their own parents, idled together, both closed");
}

}  // namespace

void run_editor_checks(const ValidateOptions& options, CheckRecorder& recorder) {
  guarded(recorder, kCycleCheck, [&] { check_cycles(options, recorder); });
  guarded(recorder, kTwoCheck, [&] { check_two_at_once(options, recorder); });
}

}  // namespace plugcore
