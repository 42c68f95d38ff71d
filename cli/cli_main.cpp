// brakmorph: the command-line VST 2 host. Dispatches to the subcommands and
// turns every failure into one line on standard error and a non-zero status.
#include <cstdio>
#include <exception>
#include <string>
#include <vector>

#include "cli/command_args.h"
#include "cli/commands.h"

namespace {

using CommandFunction = int (*)(basic::ArgReader&);

struct Command {
  const char* name;
  CommandFunction run;
};

const Command kCommands[] = {
    {"info", plugcore::run_info},   {"render", plugcore::run_render},
    {"demo", plugcore::run_demo},   {"bench", plugcore::run_bench},
    {"bank", plugcore::run_bank},   {"validate", plugcore::run_validate},
    {"snapshot", plugcore::run_snapshot}, {"edit", plugcore::run_edit},
};

bool wants_help(const std::vector<std::string>& args) {
  for (const std::string& arg : args) {
    if (arg == "--help" || arg == "-h") return true;
  }
  return false;
}

}  // namespace

int main(int argc, char** argv) {
  std::vector<std::string> args(argv + 1, argv + argc);
  if (args.empty() || args[0] == "--help" || args[0] == "-h" || args[0] == "help") {
    const std::string topic = args.size() > 1 ? args[1] : "";
    const std::string text = plugcore::help_text(topic);
    std::fputs(text.empty() ? plugcore::help_text("").c_str() : text.c_str(), stdout);
    return args.empty() ? 2 : 0;
  }
  const std::string name = args[0];
  args.erase(args.begin());
  for (const Command& command : kCommands) {
    if (name != command.name) continue;
    if (wants_help(args)) {
      std::fputs(plugcore::help_text(name).c_str(), stdout);
      return 0;
    }
    try {
      basic::ArgReader reader(args);
      return command.run(reader);
    } catch (const basic::UsageError& error) {
      std::fprintf(stderr, "brakmorph %s: %s (see brakmorph %s --help)\n", name.c_str(),
                   error.what(), name.c_str());
      return 2;
    } catch (const std::exception& error) {
      std::fprintf(stderr, "brakmorph %s: %s\n", name.c_str(), error.what());
      return 1;
    }
  }
  std::fprintf(stderr, "brakmorph: unknown command %s (see brakmorph --help)\n", name.c_str());
  return 2;
}
