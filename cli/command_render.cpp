// brakmorph render: one signal through one configured instance into a file.
#include <iostream>

#include "cli/audio_file.h"
#include "cli/command_args.h"
#include "cli/command_common.h"
#include "cli/commands.h"
#include "cli/demo_signal.h"
#include "cli/hosted_plugin.h"
#include "cli/midi_schedule.h"
#include "cli/pending_output.h"
#include "cli/platform_services.h"
#include "cli/progress_bar.h"
#include "cli/raw_audio.h"
#include "cli/render_loop.h"

namespace plugcore {
namespace {

struct RenderOptions {
  std::string plugin_path = default_plugin_path();
  std::string in_path;
  bool raw_in = false;
  std::string out_path;
  bool raw_out = false;
  ParamSettings settings;
  double rate = 48000.0;
  bool rate_given = false;
  int block = 512;
  ProcessMode mode = ProcessMode::replacing;
  bool mono_in = false;
  bool mono_out = false;
  double tail_seconds = 0.0;
  std::string midi_path;
  std::string settings_path;
};

RenderOptions parse(basic::ArgReader& args) {
  RenderOptions options;
  while (!args.done()) {
    const std::string option = args.next();
    if (take_setting_option(option, args, options.settings)) {
      continue;
    } else if (option == "--plugin") {
      options.plugin_path = args.value(option);
    } else if (option == "--in" || option == "--raw-in") {
      if (!options.in_path.empty()) throw basic::UsageError("render: more than one input given");
      options.in_path = args.value(option);
      options.raw_in = option == "--raw-in";
    } else if (option == "--out" || option == "--raw-out") {
      if (!options.out_path.empty()) throw basic::UsageError("render: more than one output given");
      options.out_path = args.value(option);
      options.raw_out = option == "--raw-out";
    } else if (option == "--rate") {
      options.rate = basic::parse_double(args.value(option), option, 1000.0, 768000.0);
      options.rate_given = true;
    } else if (option == "--block") {
      options.block = basic::parse_int(args.value(option), option, 1, 65536);
    } else if (option == "--mode") {
      const std::string mode = args.value(option);
      if (mode == "replacing") {
        options.mode = ProcessMode::replacing;
      } else if (mode == "adding") {
        options.mode = ProcessMode::adding;
      } else {
        throw basic::UsageError("--mode expects replacing or adding, got \"" + mode + "\"");
      }
    } else if (option == "--mono-in") {
      options.mono_in = true;
    } else if (option == "--mono-out") {
      options.mono_out = true;
    } else if (option == "--midi") {
      options.midi_path = args.value(option);
    } else if (option == "--settings") {
      options.settings_path = args.value(option);
    } else if (option == "--tail") {
      options.tail_seconds = basic::parse_double(args.value(option), option, 0.0, 3600.0);
    } else {
      throw basic::UsageError("render: unknown option " + option);
    }
  }
  if (options.out_path.empty()) {
    throw basic::UsageError("render: --out is required");
  }
  if (options.rate_given && !options.in_path.empty() && !options.raw_in) {
    throw basic::UsageError("render: --rate applies only to the demo signal and raw input");
  }
  return options;
}

}  // namespace

int run_render(basic::ArgReader& args) {
  const RenderOptions options = parse(args);

  // Source channels: one or two, at the source's own rate.
  std::vector<std::vector<float>> source;
  double rate = options.rate;
  if (options.in_path.empty()) {
    basic::StereoSignal demo = basic::make_demo_signal(rate);
    source.push_back(std::move(demo.left));
    source.push_back(std::move(demo.right));
  } else if (options.raw_in) {
    source = basic::read_raw_float(options.in_path, 2);
  } else {
    basic::AudioData data = basic::read_audio_file(options.in_path);
    rate = data.sample_rate;
    source = std::move(data.channels);
  }
  const size_t tail = static_cast<size_t>(options.tail_seconds * rate + 0.5);
  for (auto& channel : source) channel.resize(channel.size() + tail, 0.0f);
  const size_t frames = source[0].size();
  // A mono source feeds both pins unless the second is left unconnected.
  const float* left = source[0].data();
  const float* right = options.mono_in ? nullptr : source[source.size() > 1 ? 1 : 0].data();

  HostedPlugin plugin(options.plugin_path, rate, options.block, options.mono_in ? 1 : 2,
                      options.mono_out ? 1 : 2);
  apply_settings(plugin, options.settings);
  if (!options.settings_path.empty()) {
    load_plugin_settings(plugin, options.settings_path);
  }
  RenderLoop loop(plugin, options.block, options.mode);
  std::vector<std::vector<float>> output;
  {
    basic::ProgressBar bar("rendering", sys::stderr_is_terminal());
    plugin.resume();
    if (options.midi_path.empty()) {
      loop.run(left, right, frames, output, [&bar](double fraction) { bar.update(fraction); });
    } else {
      MidiSchedule midi(basic::read_midi_file(options.midi_path), rate);
      render_with_midi(loop, midi, plugin, left, right, frames, static_cast<size_t>(options.block), output,
                       [&bar](double fraction) { bar.update(fraction); });
      if (midi.remaining() > 0) {
        std::cerr << "render: " << midi.remaining() << " MIDI events after the end of the signal were not sent\n";
      }
    }
    plugin.suspend();
  }

  basic::PendingOutput pending(options.out_path);
  if (options.raw_out) {
    basic::write_raw_float(pending.temp_path(), output);
  } else {
    basic::write_float_wav(pending.temp_path(), rate, output);
  }
  pending.commit();
  std::cout << level_line(options.out_path, output) << "\n";
  return 0;
}

}  // namespace plugcore
