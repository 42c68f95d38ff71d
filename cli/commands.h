// The subcommands of the command-line host. Each takes the arguments after
// its name, prints its results on standard output and returns the exit status;
// failures are thrown (basic::UsageError for command-line mistakes).
#pragma once

#include <string>

namespace basic {
class ArgReader;
}

namespace plugcore {

int run_info(basic::ArgReader& args);
int run_render(basic::ArgReader& args);
int run_demo(basic::ArgReader& args);
int run_bench(basic::ArgReader& args);
int run_bank(basic::ArgReader& args);
int run_validate(basic::ArgReader& args);
int run_snapshot(basic::ArgReader& args);
int run_edit(basic::ArgReader& args);

// Help texts: the overview for an empty name, else the command's own; empty
// when there is no such command.
std::string help_text(const std::string& command);

}  // namespace plugcore
