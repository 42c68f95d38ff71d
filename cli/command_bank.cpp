// brakmorph bank show: a bank file's programs as the plug-in itself displays them.
#include <iostream>
#include <sstream>

#include "cli/bank_file_check.h"
#include "cli/command_args.h"
#include "cli/commands.h"
#include "cli/hosted_plugin.h"

namespace plugcore {

int run_bank(basic::ArgReader& args) {
  if (args.done()) {
    throw basic::UsageError("bank: expected an action (show)");
  }
  const std::string action = args.next();
  if (action != "show") {
    throw basic::UsageError("bank: unknown action " + action + " (expected show)");
  }
  std::string file;
  std::string plugin_path = default_plugin_path();
  while (!args.done()) {
    const std::string option = args.next();
    if (option == "--plugin") {
      plugin_path = args.value(option);
    } else if (option.rfind("--", 0) == 0 || !file.empty()) {
      throw basic::UsageError("bank show: unexpected argument " + option);
    } else {
      file = option;
    }
  }
  if (file.empty()) {
    throw basic::UsageError("bank show: expected a bank file");
  }

  std::vector<uint8_t> block;
  int status = read_bank_file_block(file, block);
  if (status != kBankOk) {
    throw std::runtime_error("bank " + file + ": " + bank_status_text(status) + " (code " +
                             std::to_string(status) + ")");
  }
  HostedPlugin plugin(plugin_path, 48000.0, 512);
  // isPreset 0: the whole bank block, without the file header.
  if (plugin.dispatch(effSetChunk, 0, static_cast<intptr_t>(block.size()), block.data()) == 0) {
    status = kBankRefusedBlock;
    throw std::runtime_error("bank " + file + ": " + bank_status_text(status) + " (code " +
                             std::to_string(status) + ")");
  }
  std::ostringstream out;
  out << file << ": " << plugin.num_programs() << " programs\n";
  for (int program = 0; program < plugin.num_programs(); ++program) {
    plugin.set_program(program);
    out << "program " << program << ": " << plugin.program_name(program) << "\n";
    for (int param = 0; param < plugin.num_params(); ++param) {
      std::string label = plugin.param_label(param);
      out << "  " << param << "  " << plugin.param_name(param) << " = "
          << plugin.param_display(param) << (label.empty() ? "" : " " + label) << "\n";
    }
  }
  std::cout << out.str();
  return 0;
}

}  // namespace plugcore
