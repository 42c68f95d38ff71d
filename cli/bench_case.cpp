#include "cli/bench_case.h"

#include <stdexcept>

#include "cli/command_args.h"

namespace plugcore {

BenchCase parse_bench_case(const std::string& text, const BenchCase& defaults) {
  const size_t colon = text.find(':');
  BenchCase result = defaults;
  result.settings = ParamSettings{};
  result.name = text.substr(0, colon);
  if (result.name.empty()) {
    throw std::runtime_error("--case needs a name before ':', got \"" + text + "\"");
  }
  if (colon == std::string::npos) {
    return result;
  }
  std::string rest = text.substr(colon + 1);
  size_t start = 0;
  while (start <= rest.size()) {
    size_t comma = rest.find(',', start);
    if (comma == std::string::npos) comma = rest.size();
    const std::string item = rest.substr(start, comma - start);
    start = comma + 1;
    if (item.empty()) continue;
    const auto key_value = split_assignment(item, "--case " + result.name);
    const std::string& key = key_value.first;
    const std::string& value = key_value.second;
    if (key == "plugin") {
      result.plugin_path = value;
    } else if (key == "program") {
      result.settings.program = basic::parse_int(value, "program", 0, 1000000);
    } else if (key == "set") {
      result.settings.texts.push_back(split_assignment(value, "set"));
    } else if (key == "norm") {
      result.settings.norms.push_back(parse_norm_assignment(value));
    } else if (key == "block") {
      result.block = basic::parse_int(value, "block", 1, 65536);
    } else if (key == "mode") {
      if (value != "replacing" && value != "adding") {
        throw std::runtime_error("mode expects replacing or adding, got \"" + value + "\"");
      }
      result.mode = value == "adding" ? ProcessMode::adding : ProcessMode::replacing;
    } else {
      throw std::runtime_error("--case " + result.name + ": unknown key \"" + key + "\"");
    }
  }
  return result;
}

}  // namespace plugcore
