// brakmorph_validate: the validation battery alone, for the Windows builds,
// where the full command-line host (with its audio-file library) is not
// built. Takes the options of `brakmorph validate`.
#include <cstdio>
#include <exception>
#include <string>
#include <vector>

#include "cli/command_args.h"
#include "cli/commands.h"
#include "cli/hosted_plugin.h"

namespace plugcore {

// Without --plugin, the plug-in is looked for beside this program.
std::string default_plugin_path() { return "Brakmorph.dll"; }

}  // namespace plugcore

int main(int argc, char** argv) {
  std::vector<std::string> args(argv + 1, argv + argc);
  for (const std::string& arg : args) {
    if (arg == "--help" || arg == "-h") {
      std::fputs(plugcore::help_text("validate").c_str(), stdout);
      return 0;
    }
  }
  try {
    basic::ArgReader reader(args);
    return plugcore::run_validate(reader);
  } catch (const basic::UsageError& error) {
    std::fprintf(stderr, "brakmorph_validate: %s\n", error.what());
    return 2;
  } catch (const std::exception& error) {
    std::fprintf(stderr, "brakmorph_validate: %s\n", error.what());
    return 1;
  }
}
