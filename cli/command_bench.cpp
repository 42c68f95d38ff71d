// brakmorph bench: CPU cost of processing, one or more configurations side by
// side, runs interleaved so machine noise touches every configuration alike.
#include <algorithm>
#include <cstdio>
#include <iostream>
#include <memory>
#include <sstream>

#include "cli/bench_case.h"
#include "cli/command_args.h"
#include "cli/command_common.h"
#include "cli/commands.h"
#include "cli/hosted_plugin.h"
#include "cli/platform_services.h"
#include "cli/render_loop.h"

namespace plugcore {
namespace {

struct BenchSetup {
  std::vector<BenchCase> cases;
  double seconds = 2.0;
  double rate = 48000.0;
  int runs = 5;
};

std::string base_name(const std::string& path) {
  const size_t slash = path.find_last_of("/\\");
  return slash == std::string::npos ? path : path.substr(slash + 1);
}

BenchSetup parse(basic::ArgReader& args) {
  BenchSetup setup;
  BenchCase base;
  base.name = "base";
  base.plugin_path = default_plugin_path();
  std::vector<std::string> case_texts;
  std::vector<std::string> compares;
  while (!args.done()) {
    const std::string option = args.next();
    if (take_setting_option(option, args, base.settings)) {
      continue;
    } else if (option == "--plugin") {
      base.plugin_path = args.value(option);
    } else if (option == "--seconds") {
      setup.seconds = basic::parse_double(args.value(option), option, 0.01, 600.0);
    } else if (option == "--rate") {
      setup.rate = basic::parse_double(args.value(option), option, 1000.0, 768000.0);
    } else if (option == "--block") {
      base.block = basic::parse_int(args.value(option), option, 1, 65536);
    } else if (option == "--runs") {
      setup.runs = basic::parse_int(args.value(option), option, 1, 101);
    } else if (option == "--case") {
      case_texts.push_back(args.value(option));
    } else if (option == "--compare") {
      compares.push_back(args.value(option));
    } else {
      throw basic::UsageError("bench: unknown option " + option);
    }
  }
  if (case_texts.empty()) {
    setup.cases.push_back(base);
  }
  for (const std::string& text : case_texts) {
    try {
      BenchCase entry = parse_bench_case(text, base);
      setup.cases.push_back(entry);
    } catch (const basic::UsageError&) {
      throw;
    } catch (const std::runtime_error& error) {
      throw basic::UsageError(error.what());
    }
  }
  for (const std::string& path : compares) {
    BenchCase entry;
    entry.name = base_name(path);
    entry.plugin_path = path;
    entry.block = base.block;
    setup.cases.push_back(entry);
  }
  return setup;
}

// Deterministic stereo noise around -12 dBFS, the same for every case.
std::vector<std::vector<float>> bench_noise(size_t frames) {
  std::vector<std::vector<float>> noise(2, std::vector<float>(frames));
  uint32_t state = 0xB3C4u;
  for (size_t n = 0; n < frames; ++n) {
    for (auto& channel : noise) {
      state = state * 1664525u + 1013904223u;
      channel[n] = 0.25f * (static_cast<float>(state >> 8) / 8388608.0f - 1.0f);
    }
  }
  return noise;
}

struct RunningCase {
  std::unique_ptr<HostedPlugin> plugin;
  std::unique_ptr<RenderLoop> loop;
  std::vector<double> cpu_seconds;
};

double median(std::vector<double> values) {
  std::sort(values.begin(), values.end());
  const size_t middle = values.size() / 2;
  return values.size() % 2 == 1 ? values[middle] : 0.5 * (values[middle - 1] + values[middle]);
}

}  // namespace

int run_bench(basic::ArgReader& args) {
  const BenchSetup setup = parse(args);
  const size_t frames = static_cast<size_t>(setup.seconds * setup.rate + 0.5);
  const auto noise = bench_noise(frames);

  std::vector<RunningCase> running(setup.cases.size());
  for (size_t i = 0; i < setup.cases.size(); ++i) {
    const BenchCase& entry = setup.cases[i];
    running[i].plugin = std::make_unique<HostedPlugin>(entry.plugin_path, setup.rate, entry.block);
    apply_settings(*running[i].plugin, entry.settings);
    running[i].loop = std::make_unique<RenderLoop>(*running[i].plugin, entry.block, entry.mode);
    running[i].plugin->resume();
    // Warm-up: caches, lazily built tables and denormal-prone start states.
    running[i].loop->run_discarding(noise[0].data(), noise[1].data(),
                                    std::min(frames, static_cast<size_t>(setup.rate / 4)));
  }
  for (int run = 0; run < setup.runs; ++run) {
    // Rotating the order keeps any one case from always following another.
    for (size_t k = 0; k < running.size(); ++k) {
      RunningCase& current = running[(k + static_cast<size_t>(run)) % running.size()];
      const double start = sys::thread_cpu_seconds();
      current.loop->run_discarding(noise[0].data(), noise[1].data(), frames);
      current.cpu_seconds.push_back(sys::thread_cpu_seconds() - start);
    }
  }

  std::ostringstream out;
  char line[512];
  std::snprintf(line, sizeof(line), "%d runs of %.2f s stereo noise at %.0f Hz, median CPU time\n",
                setup.runs, setup.seconds, setup.rate);
  out << line;
  std::snprintf(line, sizeof(line), "%-24s %6s %12s %12s %10s\n", "case", "block", "x realtime",
                "ns/frame", "cost");
  out << line;
  const double reference = std::max(median(running[0].cpu_seconds), 1e-9);
  for (size_t i = 0; i < running.size(); ++i) {
    const double cpu = std::max(median(running[i].cpu_seconds), 1e-9);
    std::snprintf(line, sizeof(line), "%-24s %6d %12.1f %12.1f %9.2fx\n",
                  setup.cases[i].name.c_str(), setup.cases[i].block, setup.seconds / cpu,
                  cpu * 1e9 / static_cast<double>(frames), cpu / reference);
    out << line;
  }
  std::cout << out.str();
  for (auto& entry : running) {
    entry.plugin->suspend();
  }
  return 0;
}

}  // namespace plugcore
