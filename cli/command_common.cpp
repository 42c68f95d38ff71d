#include "cli/command_common.h"

#include "cli/command_args.h"
#include "cli/level_stats.h"

namespace plugcore {

bool take_setting_option(const std::string& option, basic::ArgReader& args,
                         ParamSettings& settings) {
  if (option == "--program") {
    settings.program = basic::parse_int(args.value(option), option, 0, 1000000);
  } else if (option == "--set") {
    const std::string text = args.value(option);
    try {
      settings.texts.push_back(split_assignment(text, option));
    } catch (const std::runtime_error& error) {
      throw basic::UsageError(error.what());
    }
  } else if (option == "--norm") {
    const std::string text = args.value(option);
    try {
      settings.norms.push_back(parse_norm_assignment(text));
    } catch (const std::runtime_error& error) {
      throw basic::UsageError(error.what());
    }
  } else {
    return false;
  }
  return true;
}

std::string level_line(const std::string& path, const std::vector<std::vector<float>>& channels) {
  const basic::LevelStats stats = basic::measure_levels(channels);
  return path + ": peak " + basic::format_dbfs(stats.peak) + " dBFS, RMS " +
         basic::format_dbfs(stats.rms) + " dBFS";
}

}  // namespace plugcore
