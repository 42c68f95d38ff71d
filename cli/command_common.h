// Option handling and output lines shared by several subcommands.
#pragma once

#include <string>
#include <vector>

#include "cli/param_lookup.h"

namespace basic {
class ArgReader;
}

namespace plugcore {

// Takes --program, --set and --norm into settings; false for any other option.
bool take_setting_option(const std::string& option, basic::ArgReader& args,
                         ParamSettings& settings);

// "PATH: peak -6.02 dBFS, RMS -18.40 dBFS"
std::string level_line(const std::string& path, const std::vector<std::vector<float>>& channels);

}  // namespace plugcore
