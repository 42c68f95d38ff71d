// brakmorph edit: the editor in a top-level window for trying it by hand,
// while a second thread plays a file through the plug-in in a loop at the
// pace of real time (the output is dropped) so the meters move.
#include <atomic>
#include <chrono>
#include <iostream>
#include <thread>

#include "cli/audio_file.h"
#include "cli/command_args.h"
#include "cli/command_common.h"
#include "cli/commands.h"
#include "cli/demo_signal.h"
#include "cli/validate/editor_session.h"
#include "cli/hosted_plugin.h"

namespace plugcore {
namespace {

constexpr int kIdlePeriodMs = 20;
constexpr int kBlock = 512;

struct EditOptions {
  std::string plugin_path = default_plugin_path();
  std::string in_path;
  ParamSettings settings;
  double seconds = 0.0;  // 0: until the window is closed
};

EditOptions parse(basic::ArgReader& args) {
  EditOptions options;
  while (!args.done()) {
    const std::string option = args.next();
    if (take_setting_option(option, args, options.settings)) {
      continue;
    } else if (option == "--plugin") {
      options.plugin_path = args.value(option);
    } else if (option == "--in") {
      options.in_path = args.value(option);
    } else if (option == "--seconds") {
      options.seconds = basic::parse_double(args.value(option), option, 0.0, 86400.0);
    } else {
      throw basic::UsageError("edit: unknown option " + option);
    }
  }
  return options;
}

// Plays source through the plug-in block by block, each block due one block
// length after the one before, until stop is raised. Returns the block count.
long play_in_real_time(HostedPlugin& plugin, const std::vector<std::vector<float>>& source,
                       double rate, const std::atomic<bool>& stop) {
  std::vector<std::vector<float>> in(2, std::vector<float>(kBlock));
  std::vector<std::vector<float>> out(2, std::vector<float>(kBlock));
  float* inputs[2] = {in[0].data(), in[1].data()};
  float* outputs[2] = {out[0].data(), out[1].data()};
  const size_t frames = source[0].size();
  const std::vector<float>& left = source[0];
  const std::vector<float>& right = source.size() > 1 ? source[1] : source[0];
  const auto block_time = std::chrono::duration_cast<std::chrono::steady_clock::duration>(
      std::chrono::duration<double>(kBlock / rate));
  auto due = std::chrono::steady_clock::now();
  size_t position = 0;
  long blocks = 0;
  while (!stop.load(std::memory_order_relaxed)) {
    for (int i = 0; i < kBlock; ++i) {
      in[0][static_cast<size_t>(i)] = left[position];
      in[1][static_cast<size_t>(i)] = right[position];
      position = position + 1 < frames ? position + 1 : 0;  // the file loops
    }
    plugin.process(inputs, outputs, kBlock, ProcessMode::replacing, 2);
    ++blocks;
    due += block_time;
    std::this_thread::sleep_until(due);
  }
  return blocks;
}

}  // namespace

int run_edit(basic::ArgReader& args) {
  const EditOptions options = parse(args);
  std::vector<std::vector<float>> source;
  double rate = 48000.0;
  if (options.in_path.empty()) {
    basic::StereoSignal demo = basic::make_demo_signal(rate);
    source.push_back(std::move(demo.left));
    source.push_back(std::move(demo.right));
  } else {
    basic::AudioData data = basic::read_audio_file(options.in_path);
    rate = data.sample_rate;
    source = std::move(data.channels);
  }
  if (source.empty() || source[0].empty()) throw std::runtime_error("edit: the input holds no audio");

  HostedPlugin plugin(options.plugin_path, rate, kBlock);
  apply_settings(plugin, options.settings);
  plugin.resume();
  const EditorSize size = query_editor_size(plugin);
  const std::unique_ptr<EditorParentInterface> parent =
      create_editor_parent(size.width, size.height, plugin.effect_name());

  std::atomic<bool> stop{false};
  long blocks = 0;
  const auto start = std::chrono::steady_clock::now();
  std::thread audio([&] { blocks = play_in_real_time(plugin, source, rate, stop); });
  // The player ends before the editor closes and before the plug-in goes,
  // whichever way this block is left.
  struct PlayerStop {
    std::atomic<bool>& stop;
    std::thread& player;
    ~PlayerStop() {
      stop.store(true, std::memory_order_relaxed);
      if (player.joinable()) player.join();
    }
  };
  {
    EditorSession editor(plugin, *parent);
    PlayerStop player_stop{stop, audio};
    editor.run_for(options.seconds, kIdlePeriodMs);
  }
  const double elapsed = std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
  std::cout << "edit: " << blocks << " blocks of " << kBlock << " frames played in " << elapsed
            << " s\n";
  return 0;
}

}  // namespace plugcore
