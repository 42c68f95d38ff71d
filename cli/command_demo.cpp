// brakmorph demo: the demo signal through every program of a plug-in.
#include <filesystem>
#include <iostream>

#include "cli/audio_file.h"
#include "cli/command_args.h"
#include "cli/command_common.h"
#include "cli/commands.h"
#include "cli/demo_signal.h"
#include "cli/hosted_plugin.h"
#include "cli/pending_output.h"
#include "cli/render_loop.h"

namespace plugcore {
namespace {
constexpr double kDemoTailSeconds = 0.5;  // lets feedback and filters ring out
}

int run_demo(basic::ArgReader& args) {
  std::string plugin_path = default_plugin_path();
  std::string out_dir = "out/demo";
  double rate = 48000.0;
  int block = 512;
  while (!args.done()) {
    const std::string option = args.next();
    if (option == "--plugin") {
      plugin_path = args.value(option);
    } else if (option == "--out-dir") {
      out_dir = args.value(option);
    } else if (option == "--rate") {
      rate = basic::parse_double(args.value(option), option, 1000.0, 768000.0);
    } else if (option == "--block") {
      block = basic::parse_int(args.value(option), option, 1, 65536);
    } else {
      throw basic::UsageError("demo: unknown option " + option);
    }
  }
  std::error_code error;
  std::filesystem::create_directories(out_dir, error);
  if (error) {
    throw std::runtime_error("cannot create directory " + out_dir + ": " + error.message());
  }

  basic::StereoSignal signal = basic::make_demo_signal(rate);
  const size_t tail = static_cast<size_t>(kDemoTailSeconds * rate + 0.5);
  signal.left.resize(signal.left.size() + tail, 0.0f);
  signal.right.resize(signal.right.size() + tail, 0.0f);

  int programs = 0;
  {
    HostedPlugin probe(plugin_path, rate, block);
    programs = probe.num_programs();
  }
  // A plug-in without programs still gets one render of its start-up state.
  const int renders = programs > 0 ? programs : 1;
  for (int program = 0; program < renders; ++program) {
    // A fresh instance per program, so no program inherits another's state.
    HostedPlugin plugin(plugin_path, rate, block);
    std::string name;
    if (programs > 0) {
      plugin.set_program(program);
      name = plugin.program_name(program);
    }
    RenderLoop loop(plugin, block, ProcessMode::replacing);
    std::vector<std::vector<float>> output;
    plugin.resume();
    loop.run(signal.left.data(), signal.right.data(), signal.left.size(), output);
    plugin.suspend();

    const std::string path = out_dir + "/program-" + std::to_string(program) + ".wav";
    basic::PendingOutput pending(path);
    basic::write_float_wav(pending.temp_path(), rate, output);
    pending.commit();
    std::cout << level_line(path, output) << (name.empty() ? "" : "  (" + name + ")") << "\n";
  }
  return 0;
}

}  // namespace plugcore
