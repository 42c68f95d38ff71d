// brakmorph validate: the host-grade validation battery on one plug-in.
#include <cstdio>
#include <iostream>
#include <sstream>

#include "cli/command_args.h"
#include "cli/commands.h"
#include "cli/hosted_plugin.h"
#include "cli/validate/battery.h"

namespace plugcore {
namespace {

std::vector<std::string> split_list(const std::string& text) {
  std::vector<std::string> items;
  std::stringstream in(text);
  std::string item;
  while (std::getline(in, item, ',')) {
    if (!item.empty()) items.push_back(item);
  }
  return items;
}

}  // namespace

int run_validate(basic::ArgReader& args) {
  ValidateOptions options;
  options.plugin_path = default_plugin_path();
  options.strictness = 10;
  bool json = false;
  while (!args.done()) {
    const std::string option = args.next();
    if (option == "--plugin") {
      options.plugin_path = args.value(option);
    } else if (option == "--strictness") {
      options.strictness = basic::parse_int(args.value(option), option, 1, 10);
    } else if (option == "--seed") {
      options.seed = static_cast<uint32_t>(basic::parse_int(args.value(option), option, 0, 2147483647));
    } else if (option == "--only") {
      options.only = split_list(args.value(option));
    } else if (option == "--json") {
      json = true;
    } else {
      throw basic::UsageError("validate: unknown option " + option);
    }
  }
  // A module that cannot be loaded at all is one failure, not one per check.
  { HostedPlugin probe(options.plugin_path, 44100.0, 512); }
  // Text lines appear as the checks finish; JSON comes whole at the end.
  const CheckRecorder recorder = run_battery(options, [json](const CheckResult& result) {
    if (json) return;
    std::fputs(result_line(result).c_str(), stdout);
    std::fflush(stdout);
  });
  const std::string closing = json ? battery_json(options, recorder) : battery_summary(recorder);
  std::fputs(closing.c_str(), stdout);
  std::fflush(stdout);
  return battery_status(recorder);
}

}  // namespace plugcore
